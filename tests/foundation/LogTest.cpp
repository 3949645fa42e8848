#include "foundation/Log.h"

#include <atomic>
#include <regex>
#include <thread>

#include "foundation/CNSem.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

class LogTest : public testing::Test {
 protected:
  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(LogTest, AppendsAnEntryWithThreadAndTimeWhereTheFileIs) {
  m_folder.Write("execution.log", "before");
  EXPECT_EQ(iLogReturn(SYNTAX_ERROR, "ERROR: %s -> %li%c", "A::b", 7L, '!'), 46);
  EXPECT_EQ(CNString().Trim('x'), nullptr);
  const std::regex entry(
      "before\n\\[([0-9]+), [A-Z][a-z]{2} [A-Z][a-z]{2} [ 0-9]{2} [0-9]{2}:[0-9]{2}:[0-9]{2} [0-9]{4}\\] "
      "ERROR: A::b -> 7!\n\\[.{20,}\\] ERROR: CNString::Trim -> !m_szString -> return NULL");
  std::smatch parts;
  const std::string text = m_log.Raw();
  ASSERT_TRUE(std::regex_match(text, parts, entry)) << text;
  EXPECT_EQ(parts[1], std::to_string(OsThreadId()));
#ifdef _WIN32
  EXPECT_EQ(m_folder.Read("execution.log").substr(0, 9), "before\r\n[");
#endif
  ASSERT_TRUE(bOsDeleteFile("execution.log"));
  EXPECT_EQ(LogPrintf("ERROR: %s", "lost"), nullptr);
  EXPECT_EQ(m_folder.Names(), Lines{});
}

TEST_F(LogTest, CutsAMessageThatIsTooLongAndGoesOn) {
  LogPrintf("%s|", std::string(499998, 'a').c_str());
  LogPrintf("%s|", std::string(600000, 'b').c_str());
  LogPrintf("next\n[line]");
  EXPECT_EQ(m_log.Lines(), (Lines{std::string(499998, 'a') + "|", std::string(499999, 'b'), "next\n[line]"}));
}

TEST_F(LogTest, KeepsEntriesOfSeveralThreadsWhole) {
  std::vector<std::thread> threads;
  Lines expected;
  for (int i = 0; i < 4; i++) {
    for (int j = 0; j < 25; j++) expected.push_back("thread " + std::to_string(i) + " entry " + std::to_string(j + 10));
    threads.emplace_back([i] {
      for (int j = 0; j < 25; j++) LogPrintf("thread %d entry %d", i, j + 10);
    });
  }
  for (std::thread& thread : threads) thread.join();
  Lines lines = m_log.Lines();
  std::sort(lines.begin(), lines.end());
  EXPECT_EQ(lines, expected);
  EXPECT_EQ(iGetSemaphore(), EVERYTHING_IS_OK);
  EXPECT_EQ(iReleaseSemaphore(), EVERYTHING_IS_OK);
  EXPECT_EQ(iReleaseSemaphore(), LOG_LOCK_RELEASE_FAILED);
}

TEST_F(LogTest, ASemaphoreLetsOneThreadInAtATime) {
  CNSem sem;
  std::atomic<int> iInside{0};
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; i++)
    threads.emplace_back([&] {
      for (int j = 0; j < 2000; j++) {
        CNSemHold hold(sem);
        EXPECT_EQ(iInside.exchange(1), 0);
        iInside = 0;
      }
    });
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(m_log.Lines(), Lines{});
  sem.ReleaseSem();  // nobody holds it
  ASSERT_EQ(m_log.Lines().size(), 1u);
  EXPECT_EQ(m_log.Lines()[0].find("ERROR: CNSem::ReleaseSem -> !ReleaseSemaphore -> "), 0u);
  EXPECT_GT(m_log.Lines()[0].size(), 50u) << "the reason is missing";
}
