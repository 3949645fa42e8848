#include <chrono>

#include "WizardFixture.h"

namespace {

class Loader : public WizardTest {
 protected:
  int iLoad(const std::string& script) { return wizard.iLoadMainList(script.c_str()); }
  const std::string dialog = Dialog("d", "", "CONTINUE\n");
  // Loads a script with one block of variables and a dialog.
  int iLoadVariables(const std::string& lines) { return iLoad("INIT\n" + lines + "END_INIT\n" + dialog); }
};

TEST_F(Loader, ValuesOfVariables) {
  const struct {
    const char *line, *value;
  } CASES[] = {
      {R"(v = "plain")", "plain"},
      {R"(  v=""  )", ""},
      {"\tv\t=\t\"a\tb\"\t", "a\tb"},
      {R"(v = "a\nb\rc\td\"e")", "a\nb\rc\td\"e"},
      {R"(v = "Tavola\\Plumo")", "Tavola\\Plumo"},
      {R"(v = "\q\x")", "\\\\"},
      {"v = \"first\"\n  > \" \" \n > \"second\"", "first second"},
      {"v = \"a\" > \"b\"\n\n>\"c\"", "abc"},
      {R"(v = "http://example.org//x")", "http://example.org//x"},
      {R"(v = "a = b > c")", "a = b > c"},
      {R"(v = "DIALOG END_DIALOG")", "DIALOG END_DIALOG"},
      {"v = \"cr\"\r", "cr"},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iLoadVariables(std::string(test.line) + "\n"), 0) << test.line;
    EXPECT_EQ(wizard.Value("v"), test.value) << test.line;
    EXPECT_EQ(wizard.DialogCount(), 1) << test.line;
  }
  EXPECT_EQ(Events(), Lines{});
}

TEST_F(Loader, CommentsAndBlankLinesInTheBlockOfVariables) {
  EXPECT_EQ(iLoad("// say \"INIT\nINIT\n \t // a \"comment\nv = \"1\"\n\n//w = \"2\"\nEND_INIT\n" + dialog), 0);
  EXPECT_EQ(wizard.Value("v"), "1");
  EXPECT_EQ(wizard.Variables().pFind("w"), nullptr);
}

TEST_F(Loader, BadBlocksOfVariables) {
  const struct {
    const char* text;
    const char* message;
    Lines lines;
  } CASES[] = {
      {"INIT\nv = \"1\"\n",
       "message Syntax Error|missing INIT or END_INIT -> 1",
       {"ERROR: COrbitWizard::iLoadMainList -> !ptrBeginInit || !ptrEndInit -> return FUNCTION_ERROR"}},
      {"v = \"1\"\nEND_INIT\n",
       "message Syntax Error|missing INIT or END_INIT -> 1",
       {"ERROR: COrbitWizard::iLoadMainList -> !ptrBeginInit || !ptrEndInit -> return FUNCTION_ERROR"}},
      {"INIT\n// one\nv = \"1\"\nw = \"2\" // two\nEND_INIT\n",
       "message syntax error|U  u liniji 4,nedostaje navodnik! -> 1",
       {"ERROR: COrbitWizard::iLoadMainList -> return FUNCTION_ERROR"}},
      {"INIT\nv = \"1\\\"\nEND_INIT\n",
       "message syntax error|U  u liniji 2,nedostaje navodnik! -> 1",
       {"ERROR: COrbitWizard::iLoadMainList -> return FUNCTION_ERROR"}},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iLoad(test.text + dialog), FUNCTION_ERROR) << test.text;
    EXPECT_EQ(Events(), Lines{test.message}) << test.text;
    EXPECT_EQ(Logged(), test.lines) << test.text;
  }
}

TEST_F(Loader, ArgumentsThatAreNoScript) {
  EXPECT_EQ(wizard.iLoadMainList(nullptr), PRECONDITIONS_NOT_VALID);
  EXPECT_EQ(iLoad(""), PRECONDITIONS_NOT_VALID);
  const std::string line =
      "ERROR: COrbitWizard::iLoadMainList -> !szFileName | !*szFileName -> return PRECONDITIONS_NOT_VALID";
  EXPECT_EQ(Logged(), (Lines{line, line}));
  EXPECT_EQ(iLoad("no such file"), FUNCTION_ERROR);
  EXPECT_EQ(Events(), Lines{"message Error|Error - could not open file! (no such file) -> 1"});
  EXPECT_EQ(Logged().size(), 1u);
  folder.Write("empty.txt", "");
  folder.Write("words.txt", "INIT\nEND_INIT\n");
  EXPECT_EQ(iLoad("empty.txt"), SYNTAX_ERROR);
  EXPECT_EQ(iLoad("words.txt"), SYNTAX_ERROR);
  EXPECT_EQ(iLoad("// DIALOG1\n"), SYNTAX_ERROR);
  EXPECT_EQ(Logged(), Lines(3, "ERROR: COrbitWizard::iLoadMainList -> !m_Dialogs.Size() -> return SYNTAX_ERROR"));
}

TEST_F(Loader, FaultsInAFileNameItAndTheirLine) {
  folder.Write("setup.txt", "// one\r\n" + Dialog("a", "// four\n\n BUTTON 'b' \"Go\" ID_NEXTT 1 1 1 1\n", ""));
  EXPECT_EQ(iLoad("setup.txt"), 0);
  EXPECT_EQ(Events(), Lines{"message syntax error|U datoteci setup.txt, u liniji 7,pogresan ID, ili verzija Bafunpraik "
                            "ne podrzava taj ID -> 1"});
}

TEST_F(Loader, BlocksThatDoNotClose) {
  const struct {
    std::string text;
    const char* message;
    int dialogs;
  } CASES[] = {
      {"DIALOG1 'a' \"a\" 0 0 1 1\nx\nBEGIN\nEND\n", "END_DIALOG and DIALOG mismatch in dialog number 2.", 0},
      {dialog + "DIALOG2\n\nBEGIN\nEND\n", "END_DIALOG and DIALOG mismatch in dialog number 3.", 1},
      {dialog + "END_DIALOG", "END_DIALOG and DIALOG mismatch in dialog number 3.", 1},
      {"DIALOG1 'a' \"a\" 0 0 1 1\n\"Arial\" 15\nEND\nEND_DIALOG", "Missing BEGIN in dialog number 2.", 1},
      {dialog + "DIALOG2\nEND_DIALOG2", "Missing BEGIN in dialog number 3.", 2},
  };
  for (const auto& test : CASES) {
    wizard.exitCode = -1;
    EXPECT_EQ(iLoad(test.text), SYNTAX_ERROR) << test.text;
    EXPECT_EQ(wizard.exitCode, 1) << test.text;
    EXPECT_EQ(Events(), Lines{std::string("message Critcal Error!|") + test.message + "\nProgram will exit. -> 1"});
    EXPECT_EQ(wizard.DialogCount(), test.dialogs) << test.text;
    EXPECT_EQ(Logged().size(), 1u) << test.text;
  }
}

TEST_F(Loader, Headers) {
  const struct {
    const char *header, *kind, *name, *caption;
    DialogKind value;
  } CASES[] = {
      {"DIALOG1 WINDOW 'n' \"c\" 1 2 3 4", "WINDOW", "n", "c", DialogKind::Window},
      {"DIALOG12 DIALOG_SYS 'n' \"c\"", "DIALOG_SYS", "n", "c", DialogKind::DialogSys},
      {"DIALOG1 FLAT_BORDER \"c\"", "FLAT_BORDER", "", "c", DialogKind::FlatBorder},
      {"DIALOG1 FLATTER 'n' \"c\"", "FLAT", "n", "c", DialogKind::Flat},
      {"DIALOG1 POPUP 'n' \"c\"", "POPUP", "n", "c", DialogKind::Popup},
      {"DIALOG1 FLOATING 'n' \"c\"", "FLOAT", "n", "c", DialogKind::Float},
      {"DIALOG1 DIALOG 'n' \"c\"", "DIALOG", "n", "c", DialogKind::Dialog},
      {"DIALOG1 'POPUPS' \" Exit Setup\" 1 2 3 4", "DIALOG", "POPUPS", " Exit Setup", DialogKind::Dialog},
      {"DIALOG \"It's <%v%>\"", "DIALOG", "", "It's <%v%>", DialogKind::Dialog},
  };
  for (const auto& test : CASES) {
    ASSERT_EQ(iLoad(std::string(test.header) + "\nArial\nBEGIN\nEND\nEND_DIALOG"), 0) << test.header;
    const DialogInfo* pDialog = wizard.GetDialog(1);
    EXPECT_EQ(pDialog->m_Kind, test.value) << test.header;
    EXPECT_STREQ(pDialog->m_csKind.Text(), test.kind) << test.header;
    EXPECT_STREQ(pDialog->m_csName.Text(), test.name) << test.header;
    EXPECT_STREQ(pDialog->m_csCaption.Text(), test.caption) << test.header;
    // The two last have no kind word: they can be closed.
    const bool bSystemMenu = test.value == DialogKind::DialogSys || &test >= CASES + 7;
    const bool bDialog = strncmp(test.kind, "DIALOG", 6) == 0;
    EXPECT_EQ(bDialog && (pDialog->m_dwStyle & STYLE_SYSMENU), bSystemMenu) << test.header;
  }
  EXPECT_EQ(Events(), Lines{});
}

TEST_F(Loader, FontsAndToolTipTime) {
  const struct {
    const char *lines, *face;
    int height, weight, time;
  } CASES[] = {
      {"\"Arial\" 15 500", "Arial", 15, 500, -1},
      {"\"Arial\" -11 700", "Arial", -11, 700, -1},
      {"\"Arial\" 15 500 3\nTOOLTIP_TIME '2500'", "Arial", 15, 500, 2500},
      {"  \"MS Sans Serif\"", "MS Sans Serif", 0, 0, -1},
      {" Times New Roman ", "Times New Roman", 0, 0, -1},
      {"// no font\n", "", 0, 0, -1},
  };
  for (const auto& test : CASES) {
    ASSERT_EQ(iLoad(std::string("DIALOG1 \"c\"\n") + test.lines + "\nBEGIN\nEND\nEND_DIALOG1"), 0);
    const DialogInfo* pDialog = wizard.GetDialog(1);
    EXPECT_STREQ(pDialog->m_Font.csFace.Text(), test.face);
    EXPECT_EQ(pDialog->m_Font.iHeight, test.height) << test.lines;
    EXPECT_EQ(pDialog->m_Font.iWeight, test.weight) << test.lines;
    EXPECT_EQ(pDialog->m_Font.iCharSet, 238);
    EXPECT_EQ(pDialog->m_iToolTipTime, test.time) << test.lines;
  }
  DialogFont font;
  font.csFace = "Tahoma";
  font.iHeight = 11;
  font.iCharSet = 0;
  wizard.SetFontOverride(font);
  ASSERT_EQ(iLoad(dialog), 0);
  EXPECT_STREQ(wizard.GetDialog(1)->m_Font.csFace.Text(), "Tahoma");
  EXPECT_EQ(wizard.GetDialog(1)->m_Font.iHeight, 11);
  EXPECT_EQ(wizard.GetDialog(1)->m_Font.iWeight, 0);
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

TEST_F(Loader, BodiesNamesAndModeless) {
  ASSERT_EQ(iLoad("DIALOG9 'a' \"A\" 0 0 1 1,MODELESS\nArial\nBEGIN\n TEXT_FIELD 'END' \"END\" 0 0 1 1\n"
                  "GROUP\nEND_GROUP\n EDIT_FIELD 'e' 1 1 1 1\nEND\nIF (a) THEN EXIT\nCONTINUE\nEND_DIALOG9\n"
                  "DIALOG9 'b' \"B\"\nArial\nBEGIN\nEND\nEND_DIALOG9\n" +
                  Dialog("a", "", "")),
            0);
  ASSERT_EQ(wizard.DialogCount(), 3);
  EXPECT_EQ(wizard.GetDialog(1)->m_Controls.Size(), 2);
  EXPECT_STREQ(wizard.GetDialog(1)->m_csFlow.Text(), "IF (a) THEN EXIT\nCONTINUE\nEND_DIALOG");
  EXPECT_STREQ(wizard.GetDialog(2)->m_csFlow.Text(), "END_DIALOG");
  EXPECT_TRUE(wizard.bModeless());
  int iNumber = 7;
  EXPECT_TRUE(wizard.iGetDialogNumberByName("b", &iNumber));
  EXPECT_EQ(iNumber, 2);
  EXPECT_TRUE(wizard.iGetDialogNumberByName("a", &iNumber));
  EXPECT_EQ(iNumber, 1);  // the first of the name
  EXPECT_FALSE(wizard.iGetDialogNumberByName("c", &iNumber));
  EXPECT_FALSE(wizard.iGetDialogNumberByName("", &iNumber));
  EXPECT_EQ(iNumber, 1);
  EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iLoadMainListBuffer -> Same names for dialog variable name 'a'"});
}

TEST_F(Loader, OneBlockByItself) {
  EXPECT_EQ(wizard.iLoadMainListBuffer(nullptr), PRECONDITIONS_NOT_VALID);
  EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iLoadMainListBuffer -> !szBuffer -> return PRECONDITIONS_NOT_VALID"});
  EXPECT_EQ(wizard.iLoadMainListBuffer(dialog.c_str()), PRECONDITIONS_NOT_VALID);  // no dialog to read it into
  ASSERT_EQ(iLoad(dialog), 0);
  Events();
  EXPECT_EQ(wizard.iLoadMainListBuffer("DIALOG1 'x' \"X\"\r\n\"Arial\"\t12\nBEGIN\n TEXT_FIELD 't 1\nEND\nEND_DIALOG1"),
            0);
  EXPECT_STREQ(wizard.GetDialog(1)->m_csName.Text(), "x");
  EXPECT_EQ(wizard.GetDialog(1)->m_Font.iHeight, 12);
  ASSERT_FALSE(view.events.empty());
  EXPECT_EQ(view.events[0], "message syntax error|U  u liniji 4,nedostaje apostrof! -> 1");
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

// Four times the script may take about four times as long, not sixteen.
TEST_F(Loader, TimeGrowsWithTheLength) {
  const auto seconds = [this](int nDialogs) {
    std::string script = "INIT\n";
    for (int i = 0; i < nDialogs; i++) script += "v" + std::to_string(i) + " = \"value\"\n";
    script += "END_INIT\n";
    for (int i = 0; i < nDialogs; i++)
      script += Dialog("d" + std::to_string(i), " EDIT_FIELD 'e' \"\" 1 2 3 4,BACKGROUND(1,2,3)\n// c\n", "CONTINUE\n");
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(iLoad(script), 0);
    EXPECT_EQ(wizard.DialogCount(), nDialogs);
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
  };
  seconds(100);
  EXPECT_LT(seconds(4000), 10 * seconds(1000) + 0.05);
}

}  // namespace
