#include "foundation/Text.h"

#include <gtest/gtest.h>

#include <string>

namespace {

std::u16string Widened(const char* szText) { return CNWideText(szText).Ptr(); }

// What does not fit is marked by a tilde at the end.
std::string Narrowed(const char* szUtf8) {
  CNString cs;
  const bool bComplete = bUtf8ToCp1250(szUtf8, cs);
  return cs.Text() + std::string(bComplete ? "" : "~");
}
std::string Narrowed(const char16_t* pText) {
  CNString cs;
  const bool bComplete = bUtf16ToCp1250(pText, cs);
  return cs.Text() + std::string(bComplete ? "" : "~");
}

}  // namespace

TEST(Text, EveryByteSurvivesBothWays) {
  EXPECT_EQ(Widened("A\x80\x8A\x9A\xE8\xC6\xF0\xFF"), u"A\u20AC\u0160\u0161\u010D\u0106\u0111\u02D9");
  EXPECT_EQ(Narrowed("Gre\xC5\xA1ka \xE2\x82\xAC"), "Gre\x9Aka \x80");
  EXPECT_STREQ("Greška", "Gre\x9Aka") << "literals are code page 1250";
  EXPECT_EQ(CNWideText(nullptr).Ptr(), nullptr);
  EXPECT_EQ(Widened(""), u"");
  std::string all;
  for (int c = 1; c < 256; c++) all += char(c);
  const std::u16string wide = Widened(all.c_str());
  EXPECT_EQ(wide.size(), 255u);
  for (size_t i = 0; i < wide.size(); i++) EXPECT_EQ(wide.find(wide[i]), i) << "two bytes, one character";
  EXPECT_EQ(Narrowed(wide.c_str()), all);
  CNString cs(all.c_str(), 0);
  Cp1250ToUtf8(cs.Ptr(), cs);  // in place
  EXPECT_EQ(Narrowed(cs.Ptr()), all);
}

TEST(Text, WhatHasNoPlaceBecomesAQuestionMark) {
  EXPECT_EQ(Narrowed(u"a\u0416b"), "a?b~");
  EXPECT_EQ(Narrowed(u"a\xD83D\xDE00!"), "a?!~") << "a surrogate pair is one character";
  EXPECT_EQ(Narrowed(u"\xD83D"), "?~");
  const struct {
    const char *szUtf8, *szResult;
  } malformed[] = {{"\xD0\x96", "?~"},
                   {"\xF0\x9F\x98\x80!", "?!~"},
                   {"\x80", "?~"},
                   {"a\xC5", "a?~"},
                   {"\xC5n", "?n~"},
                   {"\xC0\x80", "?~"},
                   {"\xE0\x81\x81", "?~"},
                   {"\xED\xA0\x80", "?~"},
                   {"\xE2\x82", "?~"},
                   {"\xFF\xFE", "??~"},
                   {"\xF0\x80\x80\x80", "?~"}};
  for (const auto& row : malformed) EXPECT_EQ(Narrowed(row.szUtf8), row.szResult);
}
