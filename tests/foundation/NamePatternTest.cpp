#include "foundation/NamePattern.h"

#include <gtest/gtest.h>

#include <sstream>

TEST(NamePattern, MatchesAsAFileSearchDoes) {
  const struct {
    const char *szPattern, *szMatching, *szOthers;  // names with a blank between them
  } rows[] = {
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
  for (const auto& row : rows)
    for (const bool bMatching : {true, false}) {
      std::istringstream names(bMatching ? row.szMatching : row.szOthers);
      for (std::string name; names >> name;)
        EXPECT_EQ(bMatchesPattern(name.c_str(), row.szPattern), bMatching) << name << " against " << row.szPattern;
    }
  EXPECT_TRUE(bMatchesPattern("", "") && bMatchesPattern("", "*"));
}

TEST(NamePattern, ManyWildcardsCostNoMoreThanTheirProduct) {
  std::string pattern;
  for (int i = 0; i < 300; i++) pattern += "*a";
  EXPECT_FALSE(bMatchesPattern(std::string(600, 'a').c_str(), (pattern + "b").c_str()));
  EXPECT_TRUE(bMatchesPattern(std::string(600, 'a').c_str(), pattern.c_str()));
}
