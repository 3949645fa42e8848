// `orbit run` and `orbit dump`: the files that they take and write. What they make of scripts is in tests/scripts.
#include "Dump.h"
#include "OrbitText.h"
#include "Run.h"
#include "ScriptFile.h"
#include "orbit/ToolFixture.h"

namespace {

class ScriptTool : public ::testing::Test {
 protected:
  int Captured(const std::function<int(FILE* pOut, FILE* pErrors)>& run) {
    const Printed printed = Capture(run);
    out = printed.out;
    errors = printed.errors;
    return printed.iResult;
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

// Nothing in them is lost or told as a fault; the scripts of tests/scripts and of the language's page dump themselves.
TEST_F(ScriptTool, TheGoodScriptsAreUnderstoodAlikeFromTheirDumps) {
  for (const char* szName : GOOD_SCRIPTS) {
    const std::string text = TestFolder::ReadFile(SourcePath(szName));
    m_folder.Write("script.txt", text);
    EXPECT_EQ(Dump({"script.txt", "dump.txt", false}), 0) << szName;
    EXPECT_EQ(errors, "") << szName;
    EXPECT_EQ(Dump({"dump.txt", "again.txt", false}), 0) << szName;
    EXPECT_EQ(m_folder.Read("again.txt"), m_folder.Read("dump.txt")) << szName;
    EXPECT_GT(m_folder.Read("dump.txt").size(), text.size() * 9 / 10) << szName;
  }
}

}  // namespace
