// `orbit run` and `orbit dump`: the files that they take and write. What they make of scripts is in tests/scripts.
#include <functional>
#include <map>
#include <random>
#include <sstream>

#include "Dump.h"
#include "OrbitText.h"
#include "Run.h"
#include "ScriptFile.h"
#include "orbit/SourceTree.h"
#include "support/TestFolder.h"

namespace {

class ScriptTool : public ::testing::Test {
 protected:
  int Captured(const std::function<int(FILE* pOut, FILE* pErrors)>& run) {
    FILE* const pOut = OsOpenStream("out", "wb");
    FILE* const pErrors = OsOpenStream("errors", "wb");
    const int iExit = run(pOut, pErrors);
    fclose(pOut);
    fclose(pErrors);
    out = m_folder.Read("out");
    errors = m_folder.Read("errors");
    return iExit;
  }
  int Run(const std::string& script, const std::vector<std::string>& steps = {}) {
    return Captured([&](FILE* pOut, FILE* pErrors) { return RunScript({script, {}, {}, steps}, pOut, pErrors); });
  }
  int Dump(const DumpJob& job) {
    return Captured([&](FILE* pOut, FILE* pErrors) { return DumpScript(job, pOut, pErrors); });
  }
  static std::string Page(const std::string& caption) {
    return "DIALOG1 'a' \"" + caption + "\" 0 0 10 10\nBEGIN\nEND\nEND_DIALOG1\n";
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
  std::string out, errors;
};

TEST_F(ScriptTool, FilesOfBothEncodings) {
  const std::string utf8 = "Gre\xc5\xa1ka \xc4\x8c", cp1250 = "Gre\x9aka \xc8", mark = "\xef\xbb\xbf";
  const struct {
    std::string bytes, shown;
    bool bNote;
  } CASES[] = {
      {Page(cp1250), utf8, false},
      {Page(utf8), utf8, true},
      {mark + Page(utf8), utf8, true},
      {mark + Page("plain"), "plain", true},
      {Page("plain"), "plain", false},
      {Page("\xc5"), "\xc4\xb9", false},                          // an unfinished UTF-8 character is none
      {Page("\x9a\xc5\xa1"), "\xc5\xa1\xc4\xb9\xcb\x87", false},  // one letter that is no UTF-8 decides for all
      {Page("\xe2\x98\x83"), "?", true},
      {Page(std::string("a\0b", 3)), "a b", false},
  };
  for (const auto& test : CASES) {
    m_folder.Write("script.txt", test.bytes);
    EXPECT_EQ(Run("script.txt"), 0);
    EXPECT_EQ(out, "dialog 1 'a' \"" + test.shown + "\"\n") << test.bytes;
    EXPECT_EQ(errors.rfind("note: script.txt is UTF-8", 0) == 0, test.bNote) << errors;
  }
}

TEST_F(ScriptTool, FilesThatCannotBeRead) {
  m_folder.MakeFolder("folder");
  for (const std::string name : {"missing.txt", "folder"}) {
    EXPECT_EQ(Run(name, {"next"}), 9);
    EXPECT_EQ(out, "message \"Error\" \"Error - could not open file! (" + name + ")\" -> ok\n");
    EXPECT_EQ(Dump({name, "", false}), 9);
    EXPECT_EQ(out, "");
    EXPECT_EQ(errors, "message \"Error\" \"Error - could not open file! (" + name + ")\" -> ok\n");
  }
  EXPECT_EQ(Run(""), 1);
  EXPECT_EQ(out, "");
}

// The engine takes an argument with the word DIALOG for the script itself; a file may have such a name all the same.
TEST_F(ScriptTool, FilesWithAnyName) {
  m_folder.Write("MY_DIALOGS.txt", Page("a"));
  m_folder.Write("\x9a.txt", Page("b"));
  EXPECT_EQ(Run("MY_DIALOGS.txt"), 0);
  EXPECT_EQ(out, "dialog 1 'a' \"a\"\n");
  EXPECT_EQ(Run("\xc5\xa1.txt"), 0);
  EXPECT_EQ(out, "dialog 1 'a' \"b\"\n");
  m_folder.Write("NO_DIALOG.txt", "INIT\nEND_INIT\n");
  EXPECT_EQ(Run("NO_DIALOG.txt"), 46);
}

TEST_F(ScriptTool, TheLogIsWrittenOnlyWhereItIs) {
  m_folder.Write("script.txt", Page("<%none%>"));
  EXPECT_EQ(Run("script.txt"), 0);
  EXPECT_EQ(m_log.Lines(), std::vector<std::string>{"ERROR: COrbitWizard::iReplaceVarWithText -> !none"});
  bOsDeleteFile("execution.log");
  EXPECT_EQ(Run("script.txt"), 0);
  EXPECT_FALSE(m_folder.Exists("execution.log"));
}

TEST_F(ScriptTool, DumpsGoToFilesInCodePage1250) {
  const std::string script = "DIALOG1 'a' \"Gre\x9aka\" 0 0 10 10\nBEGIN\nEND\nEND_DIALOG1\n";
  m_folder.Write("script.txt", script);
  EXPECT_EQ(Dump({"script.txt", "dump.txt", true}), 0);
  EXPECT_EQ(out, "");
  EXPECT_EQ(errors.rfind("loaded 1 dialogs in ", 0), 0u);
  EXPECT_EQ(m_folder.Read("dump.txt"), script);
  EXPECT_EQ(Dump({"dump.txt", "", false}), 0);
  EXPECT_EQ(out, ToUtf8(script.c_str()));
  EXPECT_EQ(errors, "");
  m_folder.MakeFolder("folder");
  EXPECT_THROW(Dump({"script.txt", "folder", false}), OrbitError);
  m_folder.Write("bad.txt", "DIALOG1\n");
  EXPECT_EQ(Dump({"bad.txt", "dump.txt", false}), 1);
  EXPECT_EQ(m_folder.Read("dump.txt"), script);  // a script that does not load writes nothing
}

TEST_F(ScriptTool, TheEnginesOwnVariableIsDumpedWhenTheScriptSetsIt) {
  m_folder.Write("script.txt", "INIT\nwin_ver = \"mine\"\nEND_INIT\n" + Page(""));
  EXPECT_EQ(Dump({"script.txt", "", false}), 0);
  EXPECT_EQ(out.rfind("INIT\n  win_ver = \"mine\"\nEND_INIT\n", 0), 0u) << out;
}

// The carried scripts, those that test themselves, and the examples of the language's page, which carry their line.
std::map<std::string, std::string> AllScripts() {
  std::map<std::string, std::string> scripts;
  for (const char* szFolder : {"src/installer/scripts", "tests/scripts"})
    for (const auto& entry : std::filesystem::directory_iterator(SourcePath(szFolder)))
      if (entry.path().extension() == ".txt")
        scripts[FromPath(entry.path().filename())] = TestFolder::ReadFile(FromPath(entry.path()));
  std::istringstream page(TestFolder::ReadFile(SourcePath("docs/script-language.md")));
  std::string* pExample = nullptr;
  int iLine = 1;
  for (std::string line; std::getline(page, line); iLine++) {
    if (line.rfind("```", 0) == 0)
      pExample = line == "```orbit" ? &scripts["script-language.md:" + std::to_string(iLine)] : nullptr;
    else if (pExample)
      *pExample += line + "\n";
  }
  return scripts;
}

TEST_F(ScriptTool, EveryScriptOfTheTreeIsUnderstoodAlikeFromItsDump) {
  int iLoaded = 0;
  for (const auto& [name, text] : AllScripts()) {
    m_folder.Write("script.txt", text);
    if (Dump({"script.txt", "", false})) continue;
    iLoaded++;
    const std::string first = out, firstErrors = errors;
    m_folder.Write("dump.txt", first);
    EXPECT_EQ(Dump({"dump.txt", "", false}), 0) << name;
    EXPECT_EQ(out, first) << name;
    if (name == "exit.txt" || name == "please_wait.txt" || name == "installer.txt") {
      EXPECT_EQ(firstErrors, "") << name;
      EXPECT_GT(first.size(), text.size() * 9 / 10) << name;
    }
  }
  EXPECT_GT(iLoaded, 60);
}

// Scripts put together at random from what the loader looks for: the dump loads without a fault, and is its own dump.
TEST_F(ScriptTool, DumpsOfRandomScriptsAreTheirOwnDumps) {
  std::vector<std::string> pieces;
  std::istringstream words(
      "BUTTON |TEXT_FIELD |LIST_FIELD |MESSAGE_BOX |END_MESSAGE_BOX\n|FRAME |END_FRAME\n|GROUP\n|GROUP\n|"
      "END_GROUP\n|CHECK_BOX 'a'\n|CHECK_BOX 'b'\n|CHECK_BOX 'a' 1\n|TABLE_START\n{x\n}\n|START_BEFORE_DRAWING\n|"
      "START_ACTION\n|FINISH_ACTION\n|START_AFTER_DRAWING\n|TOOLTIP_TIME '7'\n|TOOLTIP_TIME|BEGIN\n|END\n|END\n|"
      "END |CONTINUE\n|IF (a) THEN b = \"c\"\n|    {\n|  }\n|\n|\n| |  |\t|'n'|\"text\"|\"|'|\\|,|CENTER|MODELESS|"
      "FLAT|POPUP |DIALOG_SYS |12 |3|-4 |//|> x\n|x = \"y\"\n|Arial|\"Arial\" 15 500\n");
  for (std::string word; std::getline(words, word, '|');) pieces.push_back(word);
  std::mt19937 random(7);
  int iLoaded = 0;
  for (int iRound = 0; iRound < 400; iRound++) {
    std::string script = iRound % 3 ? "" : "INIT\na = \"1\"\n";
    for (unsigned n = random() % 4; n > 0 && !(iRound % 3); n--)
      script += "v" + std::to_string(random() % 3) + " = \"" + pieces[random() % pieces.size()] + "\\\\\\n\"\n";
    if (iRound % 3 == 0) script += "END_INIT\n";
    for (unsigned nDialogs = random() % 3 + 1; nDialogs > 0; nDialogs--) {
      script += "DIALOG1 ";
      for (unsigned n = random() % 6; n > 0; n--) script += pieces[random() % pieces.size()];
      script += random() % 2 ? "\n\"Arial\" 15\nBEGIN\n" : "\nBEGIN\n";
      for (unsigned n = random() % 30; n > 0; n--) script += pieces[random() % pieces.size()];
      script += random() % 4 ? "\nEND\nCONTINUE\nEND_DIALOG1\n" : "\nEND_DIALOG1\n";
    }
    m_folder.Write("script.txt", script);
    if (Dump({"script.txt", "", false})) continue;
    iLoaded++;
    const std::string first = out;
    m_folder.Write("dump.txt", first);
    ASSERT_EQ(Dump({"dump.txt", "", false}), 0) << script << "\n-----\n" << first << errors;
    ASSERT_EQ(out, first) << script;
  }
  EXPECT_GT(iLoaded, 100);
}

}  // namespace
