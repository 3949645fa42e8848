// Gives every target its seeds and all that was ever found with it, once each. A crash ends the program; the log's last
// line then names the input.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>

#include "Fuzz.h"
#include "support/TestFolder.h"

namespace {

std::map<std::string, FuzzTarget>& Targets() {
  static std::map<std::string, FuzzTarget> targets;
  return targets;
}

std::vector<std::filesystem::path> Inputs(const std::string& target) {
  std::vector<std::filesystem::path> inputs;
  for (const char* szKind : {"seeds", "findings"}) {
    const std::filesystem::path folder = std::filesystem::path(ORBIT_FUZZ_DIR) / szKind / target;
    if (!std::filesystem::is_directory(folder)) continue;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) inputs.push_back(entry.path());
  }
  std::sort(inputs.begin(), inputs.end());
  return inputs;
}

class FuzzReplayTest : public testing::TestWithParam<std::string> {};

std::string NameOf(const testing::TestParamInfo<std::string>& info) { return info.param; }

std::vector<std::string> TargetNames() {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(std::filesystem::path(ORBIT_FUZZ_DIR) / "seeds"))
    names.push_back(entry.path().filename().string());
  std::sort(names.begin(), names.end());
  return names;
}

TEST_P(FuzzReplayTest, ComesBack) {
  ASSERT_TRUE(Targets().count(GetParam())) << "seeds for a target that does not exist";
  const std::vector<std::filesystem::path> inputs = Inputs(GetParam());
  ASSERT_FALSE(inputs.empty());
  TestFolder folder;
  TestLog log(folder);  // diagnostic lines are formatted too
  for (const std::filesystem::path& path : inputs) {
    std::ifstream file(path, std::ios::binary);
    const std::string input{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    std::fprintf(stderr, "%s\n", path.c_str());
    Targets()[GetParam()](input);
  }
  EXPECT_EQ(folder.Names(), std::vector<std::string>{"execution.log"}) << "a target leaves files behind";
}

INSTANTIATE_TEST_SUITE_P(Targets, FuzzReplayTest, testing::ValuesIn(TargetNames()), NameOf);

TEST(FuzzReplay, EveryTargetHasSeeds) {
  std::vector<std::string> names;
  for (const auto& target : Targets()) names.push_back(target.first);
  EXPECT_EQ(names, TargetNames());
}

}  // namespace

FuzzRegistration::FuzzRegistration(const char* szName, FuzzTarget pRun) { Targets()[szName] = pRun; }
