#include "foundation/CNString.h"

#include <cstring>

#include "support/TestFolder.h"

namespace {

// The text with its length and its two closing zeros checked; "(null)" when there is none.
std::string Value(const CNString& cs) {
  if (!cs.Ptr()) return "(null)";
  EXPECT_EQ(cs.Ptr()[cs.Length()], 0);
  EXPECT_EQ(cs.Ptr()[cs.Length() + 1], 0);
  return std::string(cs.Ptr(), size_t(cs.Length()));
}

void ExpectText(const CNString& cs, const std::string& value, int iMode) {
  EXPECT_EQ(Value(cs), value);
  int iFound = 99;
  EXPECT_EQ(cs.iGetMode(&iFound), 0);
  EXPECT_EQ(iFound, iMode) << value;
}

const std::string ZEROED("a\0b", 3);

}  // namespace

TEST(CNString, ConstructionAndAssignmentCopyTextAndMode) {
  CNString csNull(5), csText("text", 1), csZeroed(2), csAssigned("x", 0), csFrom("moved", 3);
  csZeroed.Copy(ZEROED.data(), 3);
  ExpectText(csNull, "(null)", 5);
  ExpectText(CNString(csZeroed), "a", 2);  // a copy ends at the first zero
  ExpectText(csAssigned = csZeroed, ZEROED, 2);
  ExpectText(csAssigned = csText, "text", 1);
  ExpectText(csAssigned = csAssigned.Ptr() + 2, "xt", -1);  // from its own text
  const CNString& csSame = csAssigned;
  ExpectText(csAssigned = csSame, "xt", -1);
  ExpectText(csAssigned = csNull, "(null)", 5);
  ExpectText(csText = static_cast<const char*>(nullptr), "(null)", -1);
  ExpectText(csText = std::move(csFrom), "moved", 3);
  csText.Free();
  ExpectText(csText, "(null)", 3);
  EXPECT_EQ(csText.Length(), 0);
}

TEST(CNString, AppendsAndInsertsAlsoFromItsOwnText) {
  CNString cs, csNull;
  EXPECT_EQ(cs.Concat(nullptr), nullptr);
  EXPECT_STREQ(cs.Concat(""), "");
  cs.Concat("abc");
  cs.Concat(cs.Ptr() + 1);
  cs.Concat(ZEROED.data(), 3);
  EXPECT_EQ(Value(cs), "abcbc" + ZEROED);
  cs = "abc";
  EXPECT_EQ(cs.iInsert(cs.Ptr() + 1, 1), 1);
  EXPECT_EQ(Value(cs), "abcbc");
  EXPECT_EQ(cs.iInsert("!", 5), 1);
  EXPECT_EQ(cs.iInsert("", 0), 1);
  EXPECT_EQ(cs.iInsert(">", 0), 1);
  EXPECT_EQ(Value(cs), ">abcbc!");
  EXPECT_STREQ(cs.Copy(cs.Ptr() + 1, 2), "ab");
  EXPECT_EQ(Value(cs), "ab");
  EXPECT_EQ(csNull.SetLength(0), nullptr);
  EXPECT_EQ(csNull.iInsert("new", 0), 1);
  EXPECT_EQ(Value(csNull), "new");
  csNull.SetLength(1);
  csNull.SetLength(5);
  EXPECT_EQ(Value(csNull), std::string("n\0\0\0\0", 5));
}

TEST(CNString, PathAndLineEndHelpers) {
  const struct {
    const char *szText, *szTrimmed, *szTrimmedRight, *szSlashed;
  } rows[] = {
      {"C:\\dir\\setup.exe", "C:\\dir", "C:\\dir\\setup.exe", "C:\\dir\\setup.exe\\"},
      {"setup.exe", "", "setup.exe", "setup.exe\\"},
      {"\\setup.exe", "", "\\setup.exe", "\\setup.exe\\"},  // position 0 is never looked at
      {"C:/dir/", "", "C:/dir/", "C:/dir\\"},
      {"C:\\dir\\", "C:\\dir", "C:\\dir\\", "C:\\dir\\"},
      {"abc \r\n\r\n", "", "abc ", "abc \r\n\r\n\\"},
      {"", "", "", "\\"},
  };
  for (const auto& row : rows) {
    CNString csTrim(row.szText, 0), csRight(row.szText, 0), csSlash(row.szText, 0);
    csTrim.Trim('\\');
    csRight.TrimRight();
    csSlash.AddSlash();
    EXPECT_EQ(Value(csTrim), row.szTrimmed) << row.szText;
    EXPECT_EQ(Value(csRight), row.szTrimmedRight) << row.szText;
    EXPECT_EQ(Value(csSlash), row.szSlashed) << row.szText;
  }
}

TEST(CNString, SubstituteAllNeverRescans) {
  const struct {
    const char *szText, *szOld, *szNew, *szResult;
  } rows[] = {{"x%a%y", "%a%", "%a%%a%", "x%a%%a%y"},
              {"aaa", "aa", "b", "ba"},
              {"-a-a-", "-", "", "aa"},
              {"aa", "a", "", ""},
              {"none", "x", "y", "none"}};
  for (const auto& row : rows) {
    CNString cs(row.szText, 0);
    EXPECT_STREQ(cs.SubstituteAll("test", "cs", row.szOld, row.szNew), row.szResult);
    EXPECT_EQ(Value(cs), row.szResult) << row.szText;
  }
  CNString cs("abab", 0);
  cs.SubstituteAll("test", "cs", cs.Ptr() + 3, cs.Ptr() + 1);
  EXPECT_EQ(Value(cs), "abababab") << "search and replacement inside the text itself";
}

TEST(CNString, PrintfTakesResultsOfAnyLength) {
  for (const size_t nLength : {0u, 1u, 8095u, 8096u, 16191u, 16192u, 100000u}) {
    const std::string text(nLength, 'x');
    CNString cs("old", 0);
    EXPECT_EQ(cs.Printf("test", "cs", "%s", text.c_str()), text);
    EXPECT_EQ(Value(cs), text);
  }
  CNString cs("self", 0);
  cs.Printf("test", "cs", "<%s %.3d %li>", cs.Ptr(), 7, -1L);
  EXPECT_EQ(Value(cs), "<self 007 -1>");
  EXPECT_EQ(cs.Printf("test", "cs", nullptr), nullptr);
  EXPECT_EQ(Value(cs), "<self 007 -1>");
}

TEST(CNString, QueriesAndLetterCase) {
  const CNString cs("one two", 0), csNull;
  const struct {
    const char* szText;
    int iHas, iFind, iEnds;
  } rows[] = {{"e t", 1, 2, 0}, {"two", 1, 4, 1},     {"Two", 0, -1, 0},
              {"", 1, -1, 1},   {"one two", 1, 0, 1}, {"and one two", 0, -1, 0}};
  for (const auto& row : rows) {
    EXPECT_EQ(cs.Has(row.szText), row.iHas) << row.szText;
    EXPECT_EQ(cs.Find(row.szText), row.iFind) << row.szText;
    EXPECT_EQ(cs.EndsWith(row.szText), row.iEnds) << row.szText;
    EXPECT_EQ(cs.IsEqual(row.szText), row.iHas && row.iEnds && row.iFind == 0) << row.szText;
  }
  EXPECT_TRUE(cs.Has('\0') && cs.Has('t') && !cs.Has('x') && !csNull.Has('\0') && !csNull.Has("a"));
  CNString csLower("AZ@[\xC8", 0);
  char szOther[] = "Other";
  EXPECT_TRUE(csLower.MakeLower(szOther) == csLower.Ptr() && Value(csLower) == "AZ@[\xC8");
  EXPECT_STREQ(szOther, "other");
  EXPECT_STREQ(csLower.MakeLower(), "az@[\xC8") << "ASCII letters only";
  EXPECT_TRUE(cs.Find(nullptr) == -1 && csNull.Find("a") == -1 && !csNull.IsEqual(nullptr));
}

TEST(CNString, HasSearches16BitTextsInMode1) {
  const char text[] = "a\0b\0c\0", found[] = "b\0c\0\0", other[] = "\0b\0\0";  // each with one more zero
  CNString cs(1);
  cs.Copy(text, 6);
  EXPECT_EQ(cs.Has(found), 1);
  EXPECT_EQ(cs.Has("c\0\0"), 1);
  EXPECT_EQ(cs.Has(other), 0) << "a match across two characters";
  cs.Copy(text, 5);  // half a character at the end
  EXPECT_EQ(cs.Has(found), 1);
}

TEST(CNString, IHasFindsWholeWordsAmongCodePageLetters) {
  const struct {
    const char *szText, *szSearch;
    long lAnywhere, lWholeWord;
  } rows[] = {
      {"xaB y", "Ab", 1, -1}, {"x aB", "Ab", 2, 2},    {"abc ab", "AB", 0, 4}, {"x1", "x", 0, 0},
      {"x_y", "X", 0, 0},     {"ab\x8A", "ab", 0, -1}, {"ab\xD7", "ab", 0, 0}, {"\xC8", "\xE8", -1, -1},
      {"text", "", -1, -1},   {"a", "ab", -1, -1},     {"\xE8p p", "p", 1, 3},
  };
  for (const auto& row : rows) {
    const CNString cs(row.szText, 0);
    const auto at = [&](const char* p) { return p ? long(p - cs.Ptr()) : -1; };
    EXPECT_EQ(at(cs.IHas(row.szSearch, false)), row.lAnywhere) << row.szText;
    EXPECT_EQ(at(cs.IHas(row.szSearch, true)), row.lWholeWord) << row.szText;
  }
  const std::string single = "\x8A\x8C\x8D\x8E\x8F\x9A\x9C\x9D\x9E\x9F\xA3\xA5\xAA\xAF\xB3\xB9\xBA\xBC\xBE\xBF";
  for (int c = 0; c < 256; c++) {
    const bool bAscii = (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z');
    const bool bUpperHalf = c >= 0xC0 && c != 0xD7 && c != 0xDF && c != 0xF7 && c != 0xFF;
    const bool bSingle = c && single.find(char(c)) != std::string::npos;
    EXPECT_EQ(IsLetter(static_cast<unsigned char>(c)), bAscii || bUpperHalf || bSingle) << c;
  }
}
