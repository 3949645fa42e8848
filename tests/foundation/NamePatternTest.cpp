#include "foundation/NamePattern.h"

#include <gtest/gtest.h>

#include <string>

namespace {

struct MatchRow {
  const char* szPattern;
  const char* szMatching;  // names with a blank between them
  const char* szOthers;
};
const MatchRow MATCH_ROWS[] = {
    {"a.txt", "a.txt A.TXT", "a.tx a.txtt ba.txt a"},
    {"", "", "a"},
    {"*", "a a.b .. .x", ""},
    {"*.*", "a a.b a.b.c . ..", ""},
    {"*.txt", "a.txt .txt a.b.TXT a.txt.txt", "a.txt1 txt a.txt.b"},
    {"*b*d*", "bd abcde abbdd", "db acd abc"},
    {"*aab", "aab aaab aabaab", "aaba aa"},
    {"a*.?", "abc a a.b ab.c a.b.c", "a.bc b.c a.b.cd"},
    {"*a*.?", "a.ba xa.b", "xa.bc"},
    {"*.???", "a a.b .txt a.b.txt", "a.html a.txt.html"},
    {"a?c", "abc aXc", "ac abbc a.c"},
    {"a??", "a ab abc", "abcd a.b"},
    {"?.b", "a.b .b", "aa.b a.bb"},
    {"**", "a", ""},
    {"*?", "a abc", ""},
    {"*.", "a abc", "a.b a.b.c"},
    {"readme.", "readme README", "readme.txt read"},
    {"a.", "a", "b a.b"},
    {"\xE8*\x9A.D\xC6", "\xC8x\x8A.d\xE6", "cx\x9A.d\xE6"},
    {"\xB3\xB9\xBA\xBF\xBE\x9F", "\xA3\xA5\xAA\xAF\xBC\x8F", ""},
    {"\xD7\x8B", "\xD7\x8B", "\xF7\x8B \xD7\x9B"},
};

void ExpectEach(const char* szPattern, const std::string& names, bool bMatches) {
  for (size_t at = 0; at < names.size();) {
    const size_t end = std::min(names.find(' ', at), names.size());
    const std::string name = names.substr(at, end - at);
    EXPECT_EQ(bMatchesPattern(name.c_str(), szPattern), bMatches) << name << " against " << szPattern;
    at = end + 1;
  }
}

}  // namespace

TEST(NamePattern, MatchesAsAFileSearchDoes) {
  for (const MatchRow& row : MATCH_ROWS) {
    ExpectEach(row.szPattern, row.szMatching, true);
    ExpectEach(row.szPattern, row.szOthers, false);
  }
  EXPECT_TRUE(bMatchesPattern("", ""));
  EXPECT_TRUE(bMatchesPattern("", "*"));
}

TEST(NamePattern, ManyWildcardsCostNoMoreThanTheirProduct) {
  std::string pattern;
  for (int i = 0; i < 300; i++) pattern += "*a";
  EXPECT_FALSE(bMatchesPattern(std::string(600, 'a').c_str(), (pattern + "b").c_str()));
  EXPECT_TRUE(bMatchesPattern(std::string(600, 'a').c_str(), pattern.c_str()));
}
