// Where the window goes: as numbers, and as real windows whose place outlives the program.
#include "../support/TestFolder.h"
#include "Page.h"
#include "foundation/CNConfigFile.h"
#include "window/Placement.h"

static const RECT NONE = {};
static const char AS_WRITTEN[] = "40 50 300 200";

TEST(Placement, OfADialogFollowsItsWords) {
  const RECT work = {0, 0, 1000, 700}, present = {30, 40, 130, 90}, sized = {5, 6, 605, 506};
  const struct {
    const char* szHeader;
    FormerPlace former;
    const char* szPlace;
  } ROWS[] = {
      {"200 210 540 440, NO_LOGPIXELS", {present, sized}, "200 210 540 440"},
      {"200 210 540 440, CENTER, INHERIT_POSITION", {NONE, NONE}, "230 130 540 440"},
      {"200 210 540 440, CENTER, INHERIT_POSITION", {present, sized}, "30 40 540 440"},
      {"200 210 540 440, INHERIT_SIZE", {present, NONE}, "30 40 100 50"},
      {"200 210 540 440, INHERIT_SIZE", {present, sized}, "5 6 600 500"},  // as the last dialog with the word left it
      {"200 210 540 440, INHERIT_SIZE, INHERIT_POSITION", {present, sized}, "30 40 600 500"},
      {"200 210 540 440, INHERIT_SIZE, CENTER", {NONE, NONE}, "230 130 540 440"},
      {"0 0 1200 800, CENTER", {NONE, NONE}, "0 0 1200 800"},  // the caption stays within reach
  };
  for (const auto& row : ROWS) {
    Page page(DialogKind::DialogSys, row.szHeader, "");
    EXPECT_EQ(PlaceText(PlaceDialog(page.info, row.former, work)), row.szPlace) << row.szHeader;
  }
  EXPECT_EQ(PlaceText(MovedInto({-500, 800, -300, 900}, work)), "0 600 200 100");
  EXPECT_EQ(PlaceText(MovedInto({900, -20, 2100, 880}, work)), "0 0 1200 900") << "too large: the corner wins";
}

TEST(Placement, OfABackgroundPictureFollowsItsWord) {
  const struct {
    const char* szFlag;
    const char* szPlace;
  } ROWS[] = {
      {"PICTURE(a.bmp)", "40 30 20 10"},
      {"PICTURE(a.bmp,center)", "40 30 20 10"},
      {"PICTURE(a.bmp, left_up)", "0 0 20 10"},
      {"PICTURE(a.bmp,left_down)", "0 60 20 10"},
      {"PICTURE(a.bmp,right_up)", "80 0 20 10"},
      {"PICTURE(a.bmp,right_down), CENTER", "80 60 20 10"},
      {"PICTURE(a.bmp,change_position, 7, 9)", "7 9 20 10"},
  };
  for (const auto& row : ROWS) {
    Page page(DialogKind::DialogSys, (std::string("0 0 100 70, ") + row.szFlag).c_str(), "");
    EXPECT_STREQ(page.info.m_csPicture.Text(), "a.bmp");
    EXPECT_EQ(PlaceText(PlacePicture(page.info, {100, 70}, {20, 10})), row.szPlace) << row.szFlag;
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
    const char* szPlace;
  } ROWS[] = {
      {"60 70 460 370", "60 70 400 300"},
      {"-5 -6 400 300", "-5 -6 405 306"},
      {"0 0 5 5", AS_WRITTEN},
      {"9 9 9 9", AS_WRITTEN},
      {"3000 3000 4000 4000", AS_WRITTEN},
      {"400 300 60 70", AS_WRITTEN},
      {"60 70 460", AS_WRITTEN},
      {"", AS_WRITTEN},
  };
  for (const auto& row : ROWS) {
    Settings settings;
    settings.Write("Position", row.szPosition);
    Page page(DialogKind::Window, SIZED, "");
    Screen screen(nullptr, settings.path.c_str());
    screen.Show(page);
    EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())), row.szPlace) << row.szPosition;
  }
  // Of a screen that is gone: its caption would be out of reach.
  Settings settings;
  settings.Write("Position", "2000 1500 2400 1800");
  Page page(DialogKind::Window, SIZED, "");
  Screen screen(nullptr, settings.path.c_str());
  screen.Show(page);
  const RECT work = WorkAreaOf(screen.hWindow());
  EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())),
            PlaceText({work.right - 400, work.bottom - 300, work.right, work.bottom}));
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
    EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())), "1 2 500 400");
    screen.Show(sized);
    EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())), "70 80 320 240") << "what the user had made of it before";
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
  EXPECT_EQ(PlaceText(AreaOf(next.hWindow())), "70 80 320 240");
  ShowWindow(next.hWindow(), SW_MINIMIZE);
  next.view->CloseWindow();
  EXPECT_EQ(settings.Read("Maximized"), "");
  EXPECT_EQ(settings.Read("Position"), "70 80 390 320") << "the place of an icon is none";
}
