#include "foundation/Text.h"

#include <gtest/gtest.h>

#include <string>

namespace {

std::u16string Widened(const char* szText) { return CNWideText(szText).Ptr(); }

std::string FromUtf8(const char* szText) {
  CNString cs;
  const bool bComplete = bUtf8ToCp1250(szText, cs);
  return cs.Text() + std::string(bComplete ? "" : " (incomplete)");
}

std::string FromUtf16(const char16_t* pText) {
  CNString cs;
  const bool bComplete = bUtf16ToCp1250(pText, cs);
  return cs.Text() + std::string(bComplete ? "" : " (incomplete)");
}

}  // namespace

TEST(Text, ConvertsKnownCharacters) {
  EXPECT_EQ(Widened("A\x80\x8A\x9A\xE8\xC6\xF0\xFF"), u"A\u20AC\u0160\u0161\u010D\u0106\u0111\u02D9");
  EXPECT_EQ(FromUtf16(u"A\u20AC\u0160\u0161\u010D\u0106\u0111\u02D9"), "A\x80\x8A\x9A\xE8\xC6\xF0\xFF");
  EXPECT_EQ(FromUtf8("Gre\xC5\xA1ka \xE2\x82\xAC"), "Gre\x9Aka \x80");
  EXPECT_STREQ("Greška", "Gre\x9Aka") << "literals are code page 1250";
  EXPECT_EQ(CNWideText(nullptr).Ptr(), nullptr);
  EXPECT_EQ(Widened(""), u"");
}

TEST(Text, EveryByteSurvivesBothWays) {
  std::string all;
  for (int c = 1; c < 256; c++) all += char(c);
  const std::u16string wide = Widened(all.c_str());
  EXPECT_EQ(wide.size(), 255u);
  for (size_t i = 0; i < wide.size(); i++) EXPECT_EQ(wide.find(wide[i]), i) << "two bytes, one character";
  EXPECT_EQ(FromUtf16(wide.c_str()), all);
  CNString cs(all.c_str(), 0);
  Cp1250ToUtf8(cs.Ptr(), cs);  // in place
  EXPECT_GT(cs.Length(), 127 + 128 * 2 - 1);
  EXPECT_EQ(FromUtf8(cs.Ptr()), all);
}

TEST(Text, WhatHasNoPlaceBecomesAQuestionMark) {
  EXPECT_EQ(FromUtf16(u"a\u0416b"), "a?b (incomplete)");
  EXPECT_EQ(FromUtf16(u"a\xD83D\xDE00"
                      u"b"),
            "a?b (incomplete)")
      << "a surrogate pair is one character";
  EXPECT_EQ(FromUtf16(u"\xD83D"), "? (incomplete)");
  const struct {
    const char *szUtf8, *szResult;
  } malformed[] = {
      {"\xD0\x96", "?"},
      {"\xF0\x9F\x98\x80!", "?!"},
      {"\x80", "?"},
      {"a\xC5", "a?"},
      {"\xC5"
       "a",
       "?a"},
      {"\xC0\x80", "?"},
      {"\xE0\x81\x81", "?"},
      {"\xED\xA0\x80", "?"},
      {"\xE2\x82", "?"},
      {"\xFF\xFE", "??"},
      {"\xF0\x80\x80\x80", "?"},
  };
  for (const auto& row : malformed) EXPECT_EQ(FromUtf8(row.szUtf8), std::string(row.szResult) + " (incomplete)");
}
