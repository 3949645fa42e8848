// Where the window goes: as numbers, and as real windows whose place outlives the program.
#include "../support/TestFolder.h"
#include "Page.h"
#include "foundation/CNConfigFile.h"
#include "window/Placement.h"

static std::ostream& operator<<(std::ostream& out, const RECT& area) {
  return out << area.left << " " << area.top << " " << area.right << " " << area.bottom;
}
static bool operator==(const RECT& a, const RECT& b) { return EqualRect(&a, &b); }

static const RECT NONE = {};

TEST(Placement, OfADialogFollowsItsWords) {
  const RECT work = {0, 0, 1000, 700}, present = {30, 40, 130, 90}, sized = {5, 6, 605, 506};
  const struct {
    const char* szHeader;
    FormerPlace former;
    RECT place;
  } ROWS[] = {
      {"200 210 540 440, NO_LOGPIXELS", {present, sized}, {200, 210, 740, 650}},
      {"200 210 540 440, CENTER, INHERIT_POSITION", {NONE, NONE}, {230, 130, 770, 570}},
      {"200 210 540 440, CENTER, INHERIT_POSITION", {present, sized}, {30, 40, 570, 480}},
      {"200 210 540 440, INHERIT_SIZE", {present, NONE}, present},
      {"200 210 540 440, INHERIT_SIZE", {present, sized}, sized},  // as the last dialog with the word left it
      {"200 210 540 440, INHERIT_SIZE, INHERIT_POSITION", {present, sized}, {30, 40, 630, 540}},
      {"200 210 540 440, INHERIT_SIZE, CENTER", {NONE, NONE}, {230, 130, 770, 570}},
      {"0 0 1200 800, CENTER", {NONE, NONE}, {0, 0, 1200, 800}},  // the caption stays within reach
  };
  for (const auto& row : ROWS) {
    Page page(DialogKind::DialogSys, row.szHeader, "");
    EXPECT_EQ(PlaceDialog(page.info, row.former, work), row.place) << row.szHeader;
  }
  EXPECT_EQ(MovedInto({-500, 800, -300, 900}, work), (RECT{0, 600, 200, 700}));
  EXPECT_EQ(MovedInto({900, -20, 2100, 880}, work), (RECT{0, 0, 1200, 900})) << "too large: the corner wins";
}

TEST(Placement, OfABackgroundPictureFollowsItsWord) {
  const struct {
    const char* szFlag;
    RECT place;
  } ROWS[] = {
      {"PICTURE(a.bmp)", {40, 30, 60, 40}},
      {"PICTURE(a.bmp,center)", {40, 30, 60, 40}},
      {"PICTURE(a.bmp, left_up)", {0, 0, 20, 10}},
      {"PICTURE(a.bmp,left_down)", {0, 60, 20, 70}},
      {"PICTURE(a.bmp,right_up)", {80, 0, 100, 10}},
      {"PICTURE(a.bmp,right_down), CENTER", {80, 60, 100, 70}},
      {"PICTURE(a.bmp,change_position, 7, 9)", {7, 9, 27, 19}},
  };
  for (const auto& row : ROWS) {
    Page page(DialogKind::DialogSys, (std::string("0 0 100 70, ") + row.szFlag).c_str(), "");
    EXPECT_STREQ(page.info.m_csPicture.Text(), "a.bmp");
    EXPECT_EQ(PlacePicture(page.info, {100, 70}, {20, 10}), row.place) << row.szFlag;
  }
}

namespace {

const char SIZED[] = "40 50 300 200, INHERIT_SIZE, NO_LOGPIXELS";

struct Settings {
  TestFolder folder;
  std::string path = folder.Path("config.ini");

  void Write(const char* szKey, const char* szValue) { CNConfigFile(path.c_str()).iWriteConfigString(szKey, szValue); }
  std::string Read(const char* szKey) {
    CNString csValue;
    CNConfigFile(path.c_str()).iReadConfigString(szKey, csValue);
    return csValue.Text();
  }
};

}  // namespace

TEST(Placement, IsReadFromTheLastRunUnlessItIsAbsurd) {
  const struct {
    const char* szPosition;
    RECT place;
  } ROWS[] = {
      {"60 70 460 370", {60, 70, 460, 370}},
      {"-5 -6 400 300", {-5, -6, 400, 300}},
      {"0 0 5 5", {40, 50, 340, 250}},
      {"9 9 9 9", {40, 50, 340, 250}},
      {"3000 3000 4000 4000", {40, 50, 340, 250}},
      {"400 300 60 70", {40, 50, 340, 250}},
      {"60 70 460", {40, 50, 340, 250}},
      {"", {40, 50, 340, 250}},
  };
  for (const auto& row : ROWS) {
    Settings settings;
    settings.Write("Position", row.szPosition);
    Page page(DialogKind::Window, SIZED, "");
    Screen screen(nullptr, settings.path.c_str());
    screen.Show(page);
    EXPECT_EQ(AreaOf(screen.hWindow()), row.place) << row.szPosition;
  }
  // Of a screen that is gone: its caption would be out of reach.
  Settings settings;
  settings.Write("Position", "2000 1500 2400 1800");
  Page page(DialogKind::Window, SIZED, "");
  Screen screen(nullptr, settings.path.c_str());
  screen.Show(page);
  const RECT work = WorkAreaOf(screen.hWindow());
  EXPECT_EQ(AreaOf(screen.hWindow()), (RECT{work.right - 400, work.bottom - 300, work.right, work.bottom}));
}

TEST(Placement, IsWrittenWhenTheWindowRestsAndWhenItCloses) {
  Settings settings;
  Page sized(DialogKind::Window, SIZED, ""), fixed(DialogKind::Window, "1 2 500 400, NO_LOGPIXELS", "");
  {
    Screen screen(nullptr, settings.path.c_str());
    screen.Show(fixed);
    EXPECT_FALSE(settings.folder.Exists("config.ini")) << "only a dialog that inherits its size is remembered";
    screen.Show(sized);
    SetWindowPos(screen.hWindow(), nullptr, 70, 80, 320, 240, SWP_NOZORDER);
    SendMessageW(screen.hWindow(), WM_TIMER, 1, 0);  // it rests
    EXPECT_EQ(settings.Read("Position"), "70 80 390 320");
    EXPECT_EQ(settings.Read("LastDialogSize"), "70,80,320,240");
    EXPECT_EQ(settings.Read("Maximized"), "");
    ShowWindow(screen.hWindow(), SW_MAXIMIZE);
    screen.Show(fixed);
    EXPECT_EQ(AreaOf(screen.hWindow()), (RECT{1, 2, 501, 402}));
    screen.Show(sized);
    EXPECT_EQ(AreaOf(screen.hWindow()), (RECT{70, 80, 390, 320})) << "what the user had made of it before";
    ShowWindow(screen.hWindow(), SW_MAXIMIZE);
    screen.view->CloseWindow();
  }
  EXPECT_EQ(settings.Read("Maximized"), "1");
  EXPECT_EQ(settings.Read("RestoredPosition"), "70 80 390 320");
  Screen next(nullptr, settings.path.c_str());
  next.Show(sized);
  EXPECT_TRUE(IsZoomed(next.hWindow()));
  next.Show(sized);
  EXPECT_TRUE(IsZoomed(next.hWindow())) << "the next page inherits it";
  ShowWindow(next.hWindow(), SW_RESTORE);
  EXPECT_EQ(AreaOf(next.hWindow()), (RECT{70, 80, 390, 320}));
  ShowWindow(next.hWindow(), SW_MINIMIZE);
  next.view->CloseWindow();
  EXPECT_EQ(settings.Read("Maximized"), "");
  EXPECT_EQ(settings.Read("Position"), "70 80 390 320") << "the place of an icon is none";
}
