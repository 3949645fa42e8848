// Loading beside what scripts (tests/scripts) show: what a dump does not tell, texts that are cut off, and time.
#include <ctime>

#include "WizardFixture.h"

namespace {

class Loader : public WizardTest {
 protected:
  int iLoad(const std::string& script) { return wizard.iLoadMainList(script.c_str()); }
  const std::string dialog = Dialog("d", "", "CONTINUE\n");
};

TEST_F(Loader, FontsAndTheirOverride) {
  const auto font = [&](const std::string& line) {
    EXPECT_EQ(iLoad("DIALOG1 \"c\",MODELESS\n" + line + "\nBEGIN\nEND\nEND_DIALOG1"), 0);
    const DialogFont& read = wizard.GetDialog(1)->m_Font;
    return std::string(read.csFace.Text()) + " " + std::to_string(read.iHeight) + " " + std::to_string(read.iWeight) +
           " " + std::to_string(read.iCharSet);
  };
  EXPECT_EQ(font("\"Arial\" -11 700 3"), "Arial -11 700 238");
  DialogFont forced;
  forced.csFace = "Tahoma";
  forced.iHeight = 11;
  forced.iCharSet = 0;
  wizard.SetFontOverride(forced);
  EXPECT_EQ(font("\"Arial\" 15 500"), "Tahoma 11 0 0");
  EXPECT_TRUE(wizard.bModeless());
}

TEST_F(Loader, CaptionBarsOfOtherHeights) {
  view.captionHeight = 23;
  view.smallCaptionHeight = 16;
  ASSERT_EQ(iLoad(dialog + "DIALOG2 POPUP 'p' \"\" 0 0 100 100\nArial\nBEGIN\nEND\nEND_DIALOG2"), 0);
  EXPECT_TRUE(wizard.GetDialog(1)->m_bHeightAdjusted);
  EXPECT_EQ(wizard.GetDialog(1)->m_iHeightDifference, 4);
  EXPECT_EQ(wizard.GetDialog(1)->m_iSize[3], 104);
  EXPECT_FALSE(wizard.GetDialog(2)->m_bHeightAdjusted);
  EXPECT_EQ(wizard.GetDialog(2)->m_iSize[3], 100);
}

TEST_F(Loader, OneBlockByItself) {
  ASSERT_EQ(iLoad(dialog), 0);
  EXPECT_EQ(wizard.iLoadMainListBuffer("DIALOG1 'x' \"X\"\r\n\"Arial\"\t12\nBEGIN\n TEXT_FIELD 't 1\nEND\nEND_DIALOG1"),
            0);
  EXPECT_STREQ(wizard.GetDialog(1)->m_csName.Text(), "x");
  EXPECT_FALSE(wizard.iGetDialogNumberByName("d", nullptr)) << "it has another name by now";
  EXPECT_EQ(wizard.GetDialog(1)->m_Font.iHeight, 12);
  EXPECT_EQ(Events(), Lines{"message syntax error|U  u liniji 4,nedostaje apostrof! -> 1"});
}

// Cut anywhere, a script must load or be refused, never be read beyond its end.
TEST_F(Loader, EveryBeginningOfAScript) {
  const std::string script =
      "// c\nINIT\nv = \"a\\n\"\n> \"b\"\nEND_INIT\nDIALOG1 POPUP 'n' \"c\" 1 2 3 4,CENTER\n\"Arial\" 15 500\n"
      "TOOLTIP_TIME '5'\nBEGIN\n BUTTON 'b' \"B\" ID_NEXT 1 2 3 4,DEFAULT ACTION: (x)\nMESSAGE_BOX 'm' \"M\"\n> t\n"
      "END_MESSAGE_BOX\nEND\nSWITCH (v)\nCASE (\"ab\") { CONTINUE }\nEND_DIALOG1\n";
  for (size_t n = 1; n <= script.size(); n++) {
    std::unique_ptr<char[]> text(new char[n + 1]);
    memcpy(text.get(), script.c_str(), n);
    text[n] = 0;
    wizard.iLoadMainList(text.get());
  }
  EXPECT_EQ(wizard.DialogCount(), 1);
}

std::string Times(int n, const std::string& text) {
  std::string all;
  while (n-- > 0) all += text;
  return all;
}

// Sixteen times the script takes about sixteen times as long, not 256 times, whatever it is made of. On a machine that
// does much else a measurement may be off: they are repeated until one shows it, or half a minute of them has not.
TEST_F(Loader, TimeGrowsWithTheLength) {
  const struct {
    const char* what;
    std::function<std::string(int n)> script;
  } CASES[] = {
      {"dialogs", [&](int n) { return Times(n, Dialog("d", " EDIT_FIELD 'e' \"\" 1 2 3 4,BACKGROUND(1,2,3)\n", "")); }},
      {"variables", [&](int n) { return "INIT\n" + Times(4 * n, "v = \"value\"\n") + "END_INIT\n" + dialog; }},
      {"blocks without an end",
       [&](int n) { return Dialog("d", Times(n, "GROUP_BOX 'g' 1 2 3 4\nTABLE_START\n{\n"), ""); }},
      {"a group of boxes",
       [&](int n) { return Dialog("d", "GROUP\n" + Times(n / 4, "CHECK_BOX 'c' 1 2 3 4\n") + "END_GROUP\n", ""); }},
      {"one line", [&](int n) { return Dialog("d", "TEXT_FIELD 't' " + Times(10 * n, "TOOLTIP \\\"") + "\n", ""); }},
      {"a text that grows", [&](int n) { return Dialog("d", "", "", Action(Times(n, "v = v + \"<%b%>c\"\n"))); }},
      {"statements on one line",
       [&](int n) { return Dialog("d", "", "", Action(Times(8 * n, "{ x = \"1\" } ") + "\n")); }},
      {"commands for controls",
       [&](int n) {
         return Dialog("d", Times(n, " EDIT_FIELD 'e' 1 1 1 1\n") + " EDIT_FIELD 'z' 1 1 1 1\n", "",
                       Action(Times(n, "DisableControl (z)\n")));
       }},
  };
  for (const auto& test : CASES) {
    const auto seconds = [&](int n) {
      const std::string script = test.script(n);
      const std::clock_t start = std::clock();  // of the processor: other programs run beside the tests
      EXPECT_EQ(iLoad(script), 0);
      wizard.iRunWindow("WizardTestClass", 0);
      Events();
      return double(std::clock() - start) / CLOCKS_PER_SEC;
    };
    wizard.iSetVariable("b", "1");
    view.onIdle = [](HeadlessView&) { return false; };
    double dShort = 1e9, dLong = 1e9;
    const std::time_t start = std::time(nullptr);
    do {
      dShort = std::min(dShort, seconds(500));
      dLong = std::min(dLong, seconds(8000));
    } while (dLong > 80 * dShort + 0.2 && std::time(nullptr) - start < 30);
    EXPECT_LT(dLong, 80 * dShort + 0.2) << test.what;
  }
}

}  // namespace
