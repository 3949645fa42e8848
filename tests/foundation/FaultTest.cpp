// Every call of the system that an operation makes fails once: the result is a documented one, nothing leaks and
// nothing that was there is lost.
#include "support/Faults.h"

#include "foundation/CNConfigFile.h"
#include "foundation/CNStream.h"
#include "foundation/CNSystem.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

#ifdef ORBIT_FAULTS

using Lines = std::vector<std::string>;

namespace {

const char* const OLD_SETTINGS = "003\r\na=1\r\nb=2\r\nc=3";

class FaultTest : public testing::Test {
 protected:
  std::string Path(const char* szName) const { return m_folder.Path(szName); }
  // The settings changed by one operation: done whole or not at all.
  template <class Change>
  int ForEveryFaultOfAChange(const char* szOld, const char* szNew, Change change) {
    return ForEveryFault([&](const FaultPlan& plan) {
      m_folder.Write("config.ini", szOld);
      m_log.Clear();
      int iResult;
      {
        Faults faults(plan);
        CNConfigFile config("config.ini");
        iResult = change(config);
      }
      EXPECT_TRUE(iResult == 0 || iResult == FILE_COULD_NOT_BE_OPEN || iResult == FUNCTION_ERROR) << iResult;
      EXPECT_EQ(m_folder.Read("config.ini"), iResult ? szOld : szNew);
      if (plan.mode == FaultMode::One) {
        EXPECT_EQ(m_log.Lines().size(), iResult ? 1u : 0u);
        EXPECT_EQ(m_folder.Names(), (Lines{"config.ini", "execution.log"})) << "nothing is left beside the file";
      }
      CNConfigFile later("config.ini");
      EXPECT_EQ(change(later), 0);
      EXPECT_EQ(m_folder.Read("config.ini"), szNew) << "what was left behind does no harm";
    });
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(FaultTest, SettingsAreWrittenWholeOrNotAtAll) {
  const auto write = [](CNConfigFile& config) { return config.iWriteConfigString("b", "new"); };
  EXPECT_GT(ForEveryFaultOfAChange(OLD_SETTINGS, "003\r\na=1\r\nb=new\r\nc=3", write), 10);
  // More than one block of the file's buffer.
  const std::string value(4000, 'v');
  const std::string old = "003\r\nx=" + value + "\r\ny=" + value + "\r\nz=" + value;
  EXPECT_GT(ForEveryFaultOfAChange(old.c_str(), ("004" + old.substr(3) + "\r\nb=new").c_str(), write), 11);
}

TEST_F(FaultTest, SettingsAreRemovedWholeOrNotAtAll) {
  const auto remove = [](CNConfigFile& config) { return config.iRemoveConfigString("a"); };
  EXPECT_GT(ForEveryFaultOfAChange(OLD_SETTINGS, "002\r\nb=2\r\nc=3", remove), 10);
}

TEST_F(FaultTest, SettingsAreReadRightOrNotAtAll) {
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    m_folder.Write("config.ini", OLD_SETTINGS);
    m_log.Clear();
    int iResult;
    CNString csFound, csMissing;
    {
      Faults faults(plan);
      const CNConfigFile created("config.ini");
      CNConfigFile config("config.ini");
      iResult = config.iReadConfigString("c", csFound);
      if (!iResult) iResult = config.iReadConfigString("d", csMissing);
    }
    EXPECT_TRUE(iResult == 0 || iResult == FILE_COULD_NOT_BE_OPEN || iResult == FUNCTION_ERROR) << iResult;
    if (!iResult) {
      EXPECT_STREQ(csFound.Text(), "3");
    }
    if (plan.mode == FaultMode::One) {
      EXPECT_EQ(m_log.Lines().size(), iResult ? 1u : 0u);
    }
    EXPECT_EQ(m_folder.Read("config.ini"), OLD_SETTINGS);
  });
  EXPECT_GT(nCalls, 8);
}

TEST_F(FaultTest, TheLogKeepsWhatItHas) {
  const std::string before = "\n[1, Sat Nov 14 12:30:11 2026] before";
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
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
  EXPECT_GT(nCalls, 8);
}

TEST_F(FaultTest, AFileIsCopiedOrReported) {
  const std::string content(250000, 'c');
  m_folder.Write("from", content);
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    m_folder.Write("to", "old");
    m_log.Clear();
    int iCopied;
    {
      Faults faults(plan);
      iCopied = CNSystem::CopyFile("from", "to");
    }
    EXPECT_TRUE(m_folder.Read("from") == content);
    if (iCopied) {
      EXPECT_TRUE(m_folder.Read("to") == content);
    }
    if (plan.mode == FaultMode::One) {
      EXPECT_EQ(m_log.Lines().size(), iCopied ? 0u : 1u);
    }
  });
  EXPECT_GT(nCalls, 9);
}

TEST_F(FaultTest, AListThatStopsEarlyIsReported) {
  m_folder.MakeFolder("list/a");
  m_folder.MakeFolder("list/b");
  int nStopped = 0;
  ForEveryFault([&](const FaultPlan& plan) {
    m_log.Clear();
    CNStringArray names;
    int iResult;
    {
      Faults faults(plan);
      iResult = CNSystem::ListFolders("list", &names);
    }
    if (iResult && plan.mode == FaultMode::One) {
      nStopped++;
      EXPECT_EQ(iResult, FUNCTION_ERROR);
      EXPECT_EQ(m_log.Lines(), Lines{"ERROR CNSystem::ListFolders dwError= 5"});
    }
    if (!iResult) {
      EXPECT_TRUE(names.Size() == 2 || (names.Size() == 0 && plan.iCall == 1)) << names.Size();
    }
  });
  EXPECT_EQ(nStopped, 5) << "two names, the dots and the end";
}

TEST_F(FaultTest, AFolderIsRemovedOrReportedAndKeptWhileAProgramIsInUse) {
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    m_folder.MakeFolder("gone/sub");
    m_folder.Write("gone/sub/file", "f");
    m_folder.Write("gone/Run.EXE", "program");
    m_log.Clear();
    int iResult;
    {
      Faults faults(plan);
      iResult = CNSystem::iDeleteFolderAndSubFolders("gone");
    }
    EXPECT_TRUE(iResult == 0 || iResult == FUNCTION_ERROR) << iResult;
    EXPECT_EQ(m_folder.Exists("gone"), iResult != 0);
    if (iResult && plan.mode == FaultMode::One) {
      EXPECT_EQ(m_log.Lines().size(), 1u);
    }
  });
  EXPECT_GT(nCalls, 15);
  m_folder.MakeFolder("gone/sub");
  m_folder.Write("gone/sub/library.dll", "in use");
  m_folder.Write("gone/other", "");
  {
    OsFaultHook = [](OsCall call) { return call == OsCall::Open; };
    EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("gone"), FUNCTION_ERROR);
    OsFaultHook = nullptr;
  }
  EXPECT_EQ(m_folder.Names("gone"), (Lines{"other", "sub"}));
  EXPECT_EQ(m_folder.Names("gone/sub"), Lines{"library.dll"});
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("gone"), 0);
}

TEST_F(FaultTest, AFailedReadIsNoEndOfTheFile) {
  m_folder.Write("lines", "one\n" + std::string(9000, 'x') + "\nlast");
  ForEveryFault([&](const FaultPlan& plan) {
    std::string all;
    bool bFailed;
    {
      Faults faults(plan);
      CNFile file("lines", "rb");
      while (const char* szLine = file.ReadLine("test", "file", 25)) all += szLine;
      bFailed = file.bFailed() || !file.bFileOpened();
    }
    if (!bFailed) {
      EXPECT_EQ(all.size(), 9007u);
    }
  });
}

#endif
