// The kinds of one line that the system draws: what their flags and words turn into, and their lines written back.
#include <cstring>

#include "ControlReader.h"
#include "controls/MenuKinds.h"
#include "controls/SimpleKinds.h"

namespace {

const uint32_t BASE = STYLE_CONTROL_DEFAULT;
const uint32_t STILL = STYLE_CONTROL_DEFAULT & ~STYLE_TABSTOP;
const uint32_t UP_DOWN = STILL | STYLE_UDS_SETBUDDYINT | STYLE_UDS_ARROWKEYS | STYLE_UDS_NOTHOUSANDS;

struct KindRow {
  const char* szLine;  // as it is written back
  const char* szWindowClass;
  const char* szSource;
  uint32_t dwStyle;
};

TEST(SimpleKinds, LinesStylesAndWhatTheyName) {
  const KindRow rows[] = {
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
      {"ANIMATION 'a' IDA_COPY 1 2 3 4,TRANSPARENT,BORDER,PLAY", "SysAnimate32", "IDA_COPY",
       STILL | STYLE_ACS_TRANSPARENT | STYLE_BORDER},
      {"CURSOR 'b' \"my hand.cur\" 0 0 0 0", nullptr, "my hand.cur", BASE},
      {"WAVE ding.wav 0 0 0 0,PLAY,CONTINUOUS", nullptr, "ding.wav", BASE},
  };
  for (const KindRow& row : rows) {
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

TEST(SimpleKinds, PartsOfTheStatusBarAreItsItems) {
  const std::string line = "STATUS_BAR 's' \"12, HIDE\" \"\" \"<%n%> \\\"x\\\"\" 0 0 0 0";
  ControlReader reader(line);
  CNCharArray texts;
  ASSERT_TRUE(reader.Read().Control().bItemTexts(texts));
  ASSERT_EQ(texts.Size(), 3);
  EXPECT_STREQ(texts[2], "<%n%> \"x\"");
  EXPECT_EQ(reader.Dump(), line);
  EXPECT_EQ(reader.Control().m_dwStyle, STILL);
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

TEST(SimpleKinds, KeysHaveNames) {
  const struct {
    const char* szText;
    int iKey;
    unsigned uModifiers;
    const char* szWritten;
  } rows[] = {
      {"a", 'A', 0, "A"},
      {"ctrl+SHIFT+f12", 0x7B, KEY_CTRL | KEY_SHIFT, "Ctrl+Shift+F12"},
      {"Alt+7", '7', KEY_ALT, "Alt+7"},
      {"Delete", 0x2E, 0, "Del"},
      {"Ctrl+#186", 186, KEY_CTRL, "Ctrl+#186"},
      {"F25", 0, 0, ""},
      {"Ctrl+", 0, KEY_CTRL, ""},
      {"#256", 0, 0, ""},
  };
  for (const auto& row : rows) {
    KeyChord chord;
    EXPECT_EQ(bReadKey(row.szText, row.szText + strlen(row.szText), chord), row.iKey != 0) << row.szText;
    EXPECT_EQ(chord.iKey, row.iKey) << row.szText;
    EXPECT_EQ(chord.uModifiers, row.uModifiers) << row.szText;
    CNString csText;
    WriteKey(chord, csText);
    EXPECT_STREQ(csText.Text(), row.szWritten);
  }
}

}  // namespace
