// The kinds of one line: what their words and flags turn into, and their lines written back.
#include <cstring>

#include "ControlReader.h"
#include "controls/SimpleKinds.h"

namespace {

const uint32_t BASE = STYLE_CONTROL_DEFAULT;
const uint32_t STILL = STYLE_CONTROL_DEFAULT & ~STYLE_TABSTOP;

TEST(ControlKinds, WindowStyles) {
  EXPECT_EQ(BASE, 0x54010000u);
  const uint32_t LIST = BASE | STYLE_LBS_NOTIFY;
  const struct {
    const char* szLine;
    uint32_t dwStyle;
  } rows[] = {
      {"BUTTON 'b' \"x\" 1 2 3 4,DEFAULT,FOCUS", BASE | STYLE_BS_DEFPUSHBUTTON},
      {"BUTTON 'b' \"x\" 1 2 3 4,MULTILINE,CENTER,DISABLE",
       BASE | STYLE_BS_MULTILINE | STYLE_BS_VCENTER | STYLE_DISABLED},
      {"BUTTON 'b' \"x\" 1 2 3 4,HIDE,HIDE", BASE & ~STYLE_VISIBLE},
      {"BUTTON 'b' \"x\" 1 2 3 4,BACKGROUND(1,2,3)", BASE | STYLE_BS_OWNERDRAW},
      {"TEXT_FIELD 't' \"x\" 1 2 3 4,ACENTER", STILL | STYLE_SS_CENTER},
      {"TEXT_FIELD 't' \"x\" 1 2 3 4,ARIGHT,FRAME", STILL | STYLE_SS_RIGHT | STYLE_BORDER},
      {"TEXT_FIELD 't' \"x\" 1 2 3 4,LINK", BASE | STYLE_SS_NOTIFY},
      {"CHECK_BOX 'c' 1 2 3 4", BASE | STYLE_BS_AUTOCHECKBOX},
      {"CHECK_BOX 'c' 1 2 3 4,RADIO_BUTTON,MULTILINE", BASE | STYLE_BS_AUTORADIOBUTTON | STYLE_BS_MULTILINE},
      {"EDIT_FIELD 'e' 1 2 3 4", BASE | STYLE_ES_AUTOHSCROLL},
      {"EDIT_FIELD 'e' 1 2 3 4,READ_ONLY,V_SCROLL,MULTILINE,AUTOVSCROLL",
       BASE | STYLE_ES_READONLY | STYLE_VSCROLL | STYLE_ES_MULTILINE | STYLE_ES_AUTOVSCROLL},
      {"PROGRESS_BAR 'p' 1 2 3 4,SMOOTH,VERTICAL", STILL | STYLE_PBS_SMOOTH | STYLE_PBS_VERTICAL},
      {"IMAGE 'i' x.bmp 1 2 3 4,CUSTOM", STILL},
      {"LIST_FIELD 'l' \"a\" 1 2 3 4,SORT,MULTIPLE_SEL,SCROLL", LIST | STYLE_LBS_SORT | STYLE_LBS_MULTIPLESEL},
      // the scroll-bar words and their interplay
      {"LIST_FIELD 'l' \"a\" 1 2 3 4", LIST | STYLE_VSCROLL | STYLE_HSCROLL},
      {"LIST_FIELD 'l' \"a\" 1 2 3 4,SCROLL", LIST},
      {"LIST_FIELD 'l' \"a\" 1 2 3 4,NO_VSCROLL", LIST | STYLE_VSCROLL},
      {"LIST_FIELD 'l' \"a\" 1 2 3 4,NO_HSCROLL", LIST | STYLE_HSCROLL},
      {"LIST_FIELD 'l' \"a\" 1 2 3 4,NO_SCROLL", LIST | STYLE_LBS_DISABLENOSCROLL},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szLine);
    ASSERT_EQ(reader.Read().Count(), 1) << row.szLine;
    EXPECT_EQ(reader.Control().m_dwStyle, row.dwStyle) << row.szLine;
  }
}

TEST(ControlKinds, ButtonsTakeTheNavigationIdentifiers) {
  ControlReader reader(
      "BUTTON 'n' \"x\" ID_NEXT 1 2 3 4\nBUTTON 'b' \"x\" ID_BACK 1 2 3 4\nBUTTON 'c' \"x\" ID_CANCEL 1 2 3 4\n"
      "BUTTON 'e' \"x\" ID_EXIT,1 2 3 4\nBUTTON 'f' \"x\" ID_FOO 1 2 3 4\nEDIT_FIELD 'g' 1 2 3 4");
  reader.Read();
  const int iIDs[] = {101, 102, 103, 104, 501, 502};
  for (int i = 0; i < 6; i++) EXPECT_EQ(reader.Control(i).m_iID, iIDs[i]) << i;
  EXPECT_EQ(reader.As<CNButton>(0).m_iNavigationID, 101);
  EXPECT_EQ(reader.As<CNButton>(4).m_iNavigationID, 0);
  EXPECT_EQ(reader.dialog.GetBaseControl(103), &reader.Control(2));
  EXPECT_EQ(reader.dialog.GetBaseControl("g"), &reader.Control(5));
}

TEST(ControlKinds, OwnerDrawnButtons) {
  ControlReader gradient(
      "BUTTON 'b' \"x\" 1 2 3 4, ALIGN_TOP, MARGIN_TOP(7), GRADIENT, TOP(1,2,3), BOTTOM(4,5,6), BOTTOMRESIZABLE");
  const CNButton& button = gradient.Read().As<CNButton>();
  EXPECT_TRUE(button.m_bOwnerDrawn && button.m_bGradient);
  EXPECT_EQ(button.m_Top.blue, 3);
  EXPECT_EQ(button.m_Bottom.red, 4);
  for (const char* szLine :
       {"BUTTON 'b' \"x\" 1 2 3 4, DEFAULT, IDB_GO2", "BUTTON 'b' \"x\" IDB_GO2 1 2 3 4, DEFAULT"}) {
    ControlReader picture(szLine);
    const CNButton& drawn = picture.Read().As<CNButton>();
    EXPECT_EQ(TextOf(drawn.m_csPicture), "IDB_GO2");
    EXPECT_TRUE(drawn.m_bOwnerDrawn && drawn.m_bDefault);
    EXPECT_EQ(drawn.m_iSize[0], 1);
    EXPECT_EQ(ControlReader(picture.Dump()).Read().Dump(), picture.Dump());
  }
}

TEST(ControlKinds, PicturesAreWordsOrCaptions) {
  const char* rows[][2] = {
      {"IMAGE 'i' \"my picture.bmp\" 1 2 3 4", "my picture.bmp"},
      {"IMAGE 'i' 7up.bmp 1 2 3 4", "7up.bmp"},
      {"IMAGE 'i' \"alt\" IDB_X 1 2 3 4", "IDB_X"},
      {"IMAGE 'i' 1 2 3 4", "(null)"},
  };
  for (auto& row : rows) {
    ControlReader reader(row[0]);
    const CNImage& image = reader.Read().As<CNImage>();
    EXPECT_EQ(TextOf(image.m_csPicture), row[1]);
    EXPECT_EQ(image.m_iSize[0], 1) << row[0];
    EXPECT_STREQ(image.szWindowClass(), "STATIC");
    EXPECT_EQ(ControlReader(reader.Dump()).Read().Dump(), reader.Dump());
  }
  ControlReader custom("IMAGE 'img' IDB_PLUMO 0 0 0 0,CUSTOM,STRETCH,TRANSPARENT(204,204,205)");
  const CNImage& image = custom.Read().As<CNImage>();
  EXPECT_TRUE(image.m_bCustom && image.m_bStretch);
  EXPECT_EQ(image.m_Transparent.blue, 205);
  EXPECT_STREQ(image.szWindowClass(), "BitmapClass");
}

TEST(ControlKinds, MessageBoxes) {
  ControlReader reader("MESSAGE_BOX 'm' \"Error!\"\n> one\n\nnoise\n  >\"two\"\n>three \"3\"\nEND_MESSAGE_BOX");
  EXPECT_EQ(TextOf(reader.Read().As<CNMessageBox>().m_csText), "one\ntwo\nthree \"3\"");
  EXPECT_EQ(reader.Control().m_iID, 0);
  const struct {
    const char* szFlags;
    MessageButtons buttons;
    MessageIcon icon;
  } rows[] = {
      {"", MessageButtons::Ok, MessageIcon::None},
      {", MB_OKCANCEL, MB_ICONERROR", MessageButtons::OkCancel, MessageIcon::Error},
      {", MB_YESNOCANCEL", MessageButtons::YesNoCancel, MessageIcon::None},
      {", MB_ICONQUESTION, MB_YESNO", MessageButtons::YesNo, MessageIcon::Question},
      {" 0 0 0 0, MB_RETRYCANCEL,MB_ICONEXCLAMATION", MessageButtons::RetryCancel, MessageIcon::Exclamation},
      {" 0 0 0 0, MB_CANCELTRYCONTINUE", MessageButtons::CancelTryContinue, MessageIcon::None},
      {", MB_ABORTRETRYIGNORE,MB_ICONINFORMATION", MessageButtons::AbortRetryIgnore, MessageIcon::Information},
  };
  for (const auto& row : rows) {
    ControlReader box(std::string("MESSAGE_BOX 'm' \"x\"") + row.szFlags + "\n>t\nEND_MESSAGE_BOX");
    EXPECT_EQ(box.Read().As<CNMessageBox>().m_Buttons, row.buttons) << row.szFlags;
    EXPECT_EQ(box.As<CNMessageBox>().m_Icon, row.icon) << row.szFlags;
  }
}

const uint32_t UP_DOWN = STILL | STYLE_UDS_SETBUDDYINT | STYLE_UDS_ARROWKEYS | STYLE_UDS_NOTHOUSANDS;

TEST(SimpleKinds, LinesStylesAndWhatTheyName) {
  const struct {
    const char* szLine;  // as it is written back
    const char* szWindowClass;
    const char* szSource;
    uint32_t dwStyle;
  } rows[] = {
      {"RICH_EDIT 'r' \"a\" 1 2 3 4", "RichEdit20A", "a", BASE | STYLE_ES_AUTOHSCROLL},
      {"RICH_EDIT 'r' \"Licence.RTF\" 1 2 3 4,V_SCROLL,READ_ONLY", "RichEdit20A", "Licence.RTF",
       BASE | STYLE_VSCROLL | STYLE_ES_READONLY | STYLE_ES_MULTILINE},
      {"RICH_EDIT 'r' 1 2 3 4,MULTILINE,H_SCROLL,AUTOVSCROLL,AUTOHSCROLL,CENTER,FLAT,REMEMBER", "RichEdit20A", "",
       BASE | STYLE_ES_MULTILINE | STYLE_HSCROLL | STYLE_ES_AUTOVSCROLL | STYLE_ES_AUTOHSCROLL | STYLE_ES_CENTER |
           STYLE_BORDER},
      {"TRACKBAR 't' \"-5 20\" 1 2 3 4,TICK,VERTICAL", "msctls_trackbar32", "-5 20",
       BASE | STYLE_TBS_AUTOTICKS | STYLE_TBS_VERTICAL},
      {"TRACKBAR 't' (0 9) 1 2 3 4,NO_TICK", "msctls_trackbar32", "(0 9)",
       BASE | STYLE_TBS_AUTOTICKS | STYLE_TBS_NOTICKS},
      {"UP_DOWN 'u' (0,100,5) 1 2 3 4,ALIGNRIGHT,HORIZONTAL", "msctls_updown32", "(0,100,5)",
       UP_DOWN | STYLE_UDS_ALIGNRIGHT | STYLE_UDS_HORIZONTAL},
      {"UP_DOWN 'u' 1 2 3 4,ALIGNLEFT", "msctls_updown32", "", UP_DOWN | STYLE_UDS_ALIGNLEFT},
      {"DATE_PICKER 'd' \"2026-11-21\" 1 2 3 4", "SysDateTimePick32", "2026-11-21", BASE},
      {"DATE_PICKER 'd' 1 2 3 4,TIME", "SysDateTimePick32", "", BASE | STYLE_DTS_TIMEFORMAT},
      {"MONTHCALENDAR 'm' 1 2 3 4,MULTISELECT,WEEKNUMBERS", "SysMonthCal32", "",
       BASE | STYLE_MCS_MULTISELECT | STYLE_MCS_WEEKNUMBERS},
      {"IPADDRESS 'i' \"10.0.0.1\" 1 2 3 4,DISABLE", "SysIPAddress32", "10.0.0.1", BASE | STYLE_DISABLED},
      {"HOTKEY 'h' \"A\" CTRL SHIFT 1 2 3 4", "msctls_hotkey32", "CTRL SHIFT", BASE},
      {"PAGER 'p' \"child\" 1 2 3 4", "SysPager", "child", STILL | STYLE_PGS_HORIZONTAL},
      {"PAGER 'p' \"child\" 1 2 3 4,VERTICAL", "SysPager", "child", STILL},
      {"ANIMATION 'a' clip1.avi 1 2 3 4,TRANSPARENT,BORDER,PLAY", "SysAnimate32", "clip1.avi",
       STILL | STYLE_ACS_TRANSPARENT | STYLE_BORDER},
      {"CURSOR 'b' \"my hand.cur\" 0 0 0 0", nullptr, "my hand.cur", BASE},
      {"WAVE ding.wav 0 0 0 0,PLAY,CONTINUOUS", nullptr, "ding.wav", BASE},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szLine);
    ASSERT_EQ(reader.ReadTight().Count(), 1) << row.szLine;
    EXPECT_EQ(reader.Dump(), row.szLine);
    EXPECT_STREQ(reader.Control().szWindowClass(), row.szWindowClass) << row.szLine;
    EXPECT_EQ(reader.Control().m_iID, row.szWindowClass ? 501 : 0) << row.szLine;
    EXPECT_STREQ(reader.As<CNSimpleControl>().szSource(), row.szSource);
    EXPECT_EQ(reader.Control().m_dwStyle, row.dwStyle) << row.szLine;
    EXPECT_EQ(reader.sink.shown, std::vector<std::string>());
  }
}

TEST(SimpleKinds, NumbersOfATextWhateverStandsBetween) {
  const struct {
    const char* szText;
    std::vector<int> numbers;
  } rows[] = {
      {"", {}},  {"(-5, +100,-7)", {-5, 100, -7}}, {"2026-11-21", {2026, 11, 21}},
      {"-", {}}, {"1.2.3.4", {1, 2, 3}},           {"99999999999x", {100000000}},
  };
  for (const auto& row : rows) {
    int numbers[3] = {};
    const int nNumbers = iNumbersOf(row.szText, numbers, 3);
    EXPECT_EQ(std::vector<int>(numbers, numbers + nNumbers), row.numbers) << row.szText;
  }
}

}  // namespace
