#include "foundation/Log.h"

#include <atomic>
#include <regex>
#include <thread>

#include "foundation/CNSem.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

TEST(Log, WritesNothingWithoutItsFile) {
  TestFolder folder;
  TestLog log(folder);
  ASSERT_TRUE(bOsDeleteFile(folder.Path("execution.log").c_str()));
  EXPECT_EQ(LogPrintf("ERROR: %s", "lost"), nullptr);
  EXPECT_EQ(folder.Names(), Lines{});
}

TEST(Log, AppendsAnEntryWithThreadAndTime) {
  TestFolder folder;
  TestLog log(folder);
  folder.Write("execution.log", "before");
  EXPECT_EQ(iLogReturn(SYNTAX_ERROR, "ERROR: %s -> %li%c", "A::b", 7L, '!'), 46);
  EXPECT_EQ(CNString().Trim('x'), nullptr);
  const std::regex entry(
      "before\n\\[([0-9]+), [A-Z][a-z]{2} [A-Z][a-z]{2} [ 0-9]{2} [0-9]{2}:[0-9]{2}:[0-9]{2} [0-9]{4}\\] "
      "ERROR: A::b -> 7!\n\\[.{20,}\\] ERROR: CNString::Trim -> !m_szString -> return NULL");
  std::smatch parts;
  const std::string text = log.Raw();
  ASSERT_TRUE(std::regex_match(text, parts, entry)) << text;
  EXPECT_EQ(parts[1], std::to_string(OsThreadId()));
#ifdef _WIN32
  EXPECT_EQ(folder.Read("execution.log").substr(0, 9), "before\r\n[");
#endif
}

TEST(Log, CutsAMessageThatIsTooLongAndGoesOn) {
  TestFolder folder;
  TestLog log(folder);
  LogPrintf("%s|", std::string(499998, 'a').c_str());
  LogPrintf("%s|", std::string(600000, 'b').c_str());
  LogPrintf("next\n[line]");
  EXPECT_EQ(log.Lines(), (Lines{std::string(499998, 'a') + "|", std::string(499999, 'b'), "next\n[line]"}));
}

TEST(Log, KeepsEntriesOfSeveralThreadsWhole) {
  TestFolder folder;
  TestLog log(folder);
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; i++)
    threads.emplace_back([i] {
      for (int j = 0; j < 25; j++) LogPrintf("thread %d entry %d", i, j);
    });
  for (std::thread& thread : threads) thread.join();
  Lines expected, found = log.Lines();
  for (int i = 0; i < 4; i++)
    for (int j = 0; j < 25; j++) expected.push_back("thread " + std::to_string(i) + " entry " + std::to_string(j));
  std::sort(expected.begin(), expected.end());
  std::sort(found.begin(), found.end());
  EXPECT_EQ(found, expected);
}

TEST(Log, LockReportsARedundantRelease) {
  EXPECT_EQ(iGetSemaphore(), EVERYTHING_IS_OK);
  EXPECT_EQ(iReleaseSemaphore(), EVERYTHING_IS_OK);
  EXPECT_EQ(iReleaseSemaphore(), LOG_LOCK_RELEASE_FAILED);
}

TEST(CNSem, HoldsOthersBackUntilReleased) {
  TestFolder folder;
  TestLog log(folder);
  CNSem sem;
  std::atomic<int> iStep{0};
  sem.GetSem();
  std::thread other([&] {
    CNSemHold hold(sem);
    EXPECT_EQ(iStep.exchange(2), 1);
  });
  OsSleep(30);
  EXPECT_EQ(iStep.exchange(1), 0);
  sem.ReleaseSem();
  other.join();
  EXPECT_EQ(iStep, 2);
  EXPECT_EQ(log.Lines(), Lines{});
  sem.ReleaseSem();  // nobody holds it
  ASSERT_EQ(log.Lines().size(), 1u);
  EXPECT_EQ(log.Lines()[0].find("ERROR: CNSem::ReleaseSem -> !ReleaseSemaphore -> "), 0u);
  EXPECT_GT(log.Lines()[0].size(), 50u) << "the reason is missing";
}
