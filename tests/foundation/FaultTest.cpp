// Every call of the system that an operation makes fails once: the result is a documented one, nothing leaks and
// nothing that was there is lost.
#include "support/Faults.h"

#include "foundation/CNConfigFile.h"
#include "foundation/CNSystem.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

#ifdef ORBIT_FAULTS

using Lines = std::vector<std::string>;

namespace {

const char* const OLD_SETTINGS = "003\r\na=1\r\nb=2\r\nc=3";
const std::set<OsCall> REPLACING = {OsCall::Open, OsCall::Read, OsCall::Write, OsCall::Close, OsCall::Rename};

class FaultTest : public testing::Test {
 protected:
  // The result of one operation under the plan.
  template <class Operation>
  int iUnder(const FaultPlan& plan, Operation operation) {
    m_log.Clear();
    Faults faults(plan);
    return operation();
  }
  // One fault alone leaves the log writable: a failure has told exactly one line, a success none.
  void ExpectOneLine(const FaultPlan& plan, bool bFailed) const {
    EXPECT_TRUE(plan.mode != FaultMode::One || m_log.Lines().size() == (bFailed ? 1 : 0));
  }
  void ExpectDocumented(int iResult) const {
    EXPECT_TRUE(iResult == 0 || iResult == FILE_COULD_NOT_BE_OPEN || iResult == FUNCTION_ERROR) << iResult;
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(FaultTest, SettingsAreChangedWholeOrNotAtAll) {
  using Change = int (*)(CNConfigFile&);
  const Change write = [](CNConfigFile& config) { return config.iWriteConfigString("b", "new"); };
  const Change remove = [](CNConfigFile& config) { return config.iRemoveConfigString("a"); };
  // More than one block of the file's buffer.
  const std::string value(4000, 'v'), old = "003\r\nx=" + value + "\r\ny=" + value + "\r\nz=" + value;
  const struct {
    std::string before, after;
    Change change;
  } rows[] = {{OLD_SETTINGS, "003\r\na=1\r\nb=new\r\nc=3", write},
              {OLD_SETTINGS, "002\r\nb=2\r\nc=3", remove},
              {"", "001\r\nb=new", write},
              {old, "004" + old.substr(3) + "\r\nb=new", write}};
  for (const auto& row : rows)
    ForEveryFault(REPLACING, [&](const FaultPlan& plan) {
      m_folder.Write("config.ini", row.before);
      m_folder.Write("config.ini.new", "a file of the user's");
      const int iResult = iUnder(plan, [&] {
        CNConfigFile config("config.ini");
        return row.change(config);
      });
      ExpectDocumented(iResult);
      EXPECT_EQ(m_folder.Read("config.ini"), iResult ? row.before : row.after);
      ExpectOneLine(plan, iResult);
      const Lines names = {"config.ini", "config.ini.new", "execution.log"};
      EXPECT_TRUE(plan.mode != FaultMode::One || m_folder.Names() == names) << "left beside the file";
      CNConfigFile later("config.ini");
      EXPECT_EQ(row.change(later), 0);
      EXPECT_EQ(m_folder.Read("config.ini"), row.after) << "what was left behind does no harm";
      EXPECT_EQ(m_folder.Read("config.ini.new"), "a file of the user's");
      for (const std::string& name : m_folder.Names())
        if (name.find(".tmp") != std::string::npos) bOsDeleteFile(name.c_str());
    });
}

TEST_F(FaultTest, SettingsAreReadRightOrNotAtAllAndMadeOnlyWhereThereAreNone) {
  ForEveryFault({OsCall::Open, OsCall::Read, OsCall::Close}, [&](const FaultPlan& plan) {
    m_folder.Write("config.ini", OLD_SETTINGS);
    CNString csFound, csMissing;
    const int iResult = iUnder(plan, [&] {
      CNConfigFile config("config.ini");
      const int iFound = config.iReadConfigString("c", csFound);
      return iFound ? iFound : config.iReadConfigString("d", csMissing);
    });
    ExpectDocumented(iResult);
    EXPECT_STREQ(iResult ? "3" : csFound.Text(), "3");
    ExpectOneLine(plan, iResult);
    EXPECT_EQ(m_folder.Read("config.ini"), OLD_SETTINGS);
  });
  ForEveryFault({OsCall::Open}, [&](const FaultPlan& plan) {
    bOsDeleteFile("config.ini");
    iUnder(plan, [] { return CNConfigFile(nullptr), 0; });
    EXPECT_TRUE(!m_folder.Exists("config.ini") || m_folder.Read("config.ini").empty());
  });
}

TEST_F(FaultTest, TheLogKeepsWhatItHas) {
  const std::string before = "\n[1, Sat Nov 14 12:30:11 2026] before";
  ForEveryFault({OsCall::Open, OsCall::Seek, OsCall::Write, OsCall::Close}, [&](const FaultPlan& plan) {
    m_folder.Write("execution.log", before);
    {
      Faults faults(plan);
      EXPECT_EQ(iLogReturn(SYNTAX_ERROR, "ERROR: %s", std::string(9000, 'e').c_str()), SYNTAX_ERROR);
      EXPECT_EQ(LogPrintf("second"), nullptr);
    }
    EXPECT_EQ(m_log.Raw().substr(0, before.size()), before);
    LogPrintf("after");
    EXPECT_EQ(m_log.Lines().back(), "after");
  });
}

TEST_F(FaultTest, AFileIsCopiedOrReported) {
  const std::string content(250000, 'c');
  m_folder.Write("from", content);
  ForEveryFault({OsCall::Open, OsCall::Read, OsCall::Write, OsCall::Close}, [&](const FaultPlan& plan) {
    m_folder.Write("to", std::string(400000, 'o'));
    const bool bCopied = iUnder(plan, [] { return CNSystem::CopyFile("from", "to"); });
    EXPECT_TRUE(m_folder.Read("from") == content);
    EXPECT_TRUE(!bCopied || m_folder.Read("to") == content);
    ExpectOneLine(plan, !bCopied);
  });
}

TEST_F(FaultTest, AListThatStopsEarlyIsReported) {
  m_folder.MakeFolder("list/a");
  m_folder.MakeFolder("list/b");
  int nStopped = 0;
  ForEveryFault({OsCall::List, OsCall::ListNext}, [&](const FaultPlan& plan) {
    CNStringArray names;
    if (const int iResult = iUnder(plan, [&] { return CNSystem::ListFolders("list", &names); })) {
      EXPECT_EQ(iResult, FUNCTION_ERROR);
      if (plan.mode != FaultMode::One) return;
      nStopped++;
      EXPECT_EQ(m_log.Lines(), Lines{"ERROR CNSystem::ListFolders dwError= 5"});
    } else {
      EXPECT_EQ(names.Size(), plan.iCall == 1 ? 0 : 2);
    }
  });
  EXPECT_EQ(nStopped, 5) << "two names, the dots and the end";
}

TEST_F(FaultTest, AFolderIsRemovedOrReportedAndKeptWhileAProgramIsInUse) {
  const auto remove = [] { return CNSystem::iDeleteFolderAndSubFolders("gone"); };
  ForEveryFault({OsCall::Open, OsCall::DeleteFile, OsCall::DeleteFolder, OsCall::ListNext}, [&](const FaultPlan& plan) {
    m_folder.MakeFolder("gone/sub");
    m_folder.Write("gone/sub/file", "f");
    m_folder.Write("gone/Run.EXE", "program");
    const int iResult = iUnder(plan, remove);
    EXPECT_TRUE(iResult == 0 || iResult == FUNCTION_ERROR) << iResult;
    EXPECT_EQ(m_folder.Exists("gone"), iResult != 0);
    ExpectOneLine(plan, iResult);
  });
  m_folder.MakeFolder("gone/sub");
  m_folder.Write("gone/sub/library.dll", "in use");
  m_folder.Write("gone/other", "");
  OsFaultHook = [](OsCall call) { return call == OsCall::Open; };
  EXPECT_EQ(remove(), FUNCTION_ERROR);
  OsFaultHook = nullptr;
  EXPECT_EQ(m_folder.Names("gone"), (Lines{"other", "sub"}));
  EXPECT_EQ(m_folder.Names("gone/sub"), Lines{"library.dll"});
}

#endif
