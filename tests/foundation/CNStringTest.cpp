#include "foundation/CNString.h"

#include <climits>
#include <cstring>

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

// The text with its length and its two closing zeros checked; "(null)" when there is none.
std::string Value(const CNString& cs) {
  if (!cs.Ptr()) return "(null)";
  EXPECT_EQ(cs.Ptr()[cs.Length()], 0);
  EXPECT_EQ(cs.Ptr()[cs.Length() + 1], 0);
  return std::string(cs.Ptr(), size_t(cs.Length()));
}

int iMode(const CNString& cs) {
  int iValue = 99;
  EXPECT_EQ(cs.iGetMode(&iValue), 0);
  return iValue;
}

const std::string ZEROED("a\0b", 3);

}  // namespace

TEST(CNString, ConstructionAndAssignmentCopyTextAndMode) {
  CNString csNull(5), csText("text", 1), csZeroed(2);
  csZeroed.Copy(ZEROED.data(), 3);
  EXPECT_EQ(Value(csNull), "(null)");
  EXPECT_EQ(iMode(csNull), 5);
  EXPECT_EQ(iMode(csText), 1);
  EXPECT_EQ(Value(CNString(csZeroed)), "a");  // a copy ends at the first zero
  EXPECT_EQ(iMode(CNString(csZeroed)), 2);
  CNString csAssigned("x", 0);
  csAssigned = csZeroed;
  EXPECT_EQ(Value(csAssigned), ZEROED);
  csAssigned = csText;
  EXPECT_EQ(Value(csAssigned), "text");
  EXPECT_EQ(iMode(csAssigned), 1);
  csAssigned = csAssigned.Ptr() + 2;  // from its own text
  EXPECT_EQ(Value(csAssigned), "xt");
  EXPECT_EQ(iMode(csAssigned), -1);
  const CNString& csSame = csAssigned;
  csAssigned = csSame;
  EXPECT_EQ(Value(csAssigned), "xt");
  csAssigned = csNull;
  EXPECT_EQ(Value(csAssigned), "(null)");
  csText = static_cast<const char*>(nullptr);
  EXPECT_EQ(Value(csText), "(null)");
  CNString csFrom("moved", 3), csTo("old", 0);
  csTo = std::move(csFrom);
  EXPECT_EQ(Value(csTo), "moved");
  EXPECT_EQ(iMode(csTo), 3);
  csTo.Free();
  EXPECT_EQ(csTo.Length(), 0);
  EXPECT_EQ(iMode(csTo), 3);
}

TEST(CNString, AppendsAndInsertsAlsoFromItsOwnText) {
  CNString cs;
  EXPECT_EQ(cs.Concat(nullptr), nullptr);
  EXPECT_STREQ(cs.Concat(""), "");
  cs.Concat("abc");
  cs.Concat(cs.Ptr() + 1);
  EXPECT_EQ(Value(cs), "abcbc");
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
  CNString csNull;
  EXPECT_EQ(csNull.iInsert("new", 0), 1);
  EXPECT_EQ(Value(csNull), "new");
}

TEST(CNString, SetLengthGrowsWithZerosAndCuts) {
  CNString cs;
  EXPECT_EQ(cs.SetLength(0), nullptr);
  cs.SetLength(2);
  EXPECT_EQ(Value(cs), std::string(2, '\0'));
  cs = "abcdef";
  cs.SetLength(3);
  EXPECT_EQ(Value(cs), "abc");
  cs.SetLength(5);
  EXPECT_EQ(Value(cs), std::string("abc\0\0", 5));
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
      {"\r\n", "", "", "\r\n\\"},
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
  } rows[] = {
      {"x%a%y", "%a%", "%a%%a%", "x%a%%a%y"},
      {"aaa", "aa", "b", "ba"},
      {"-a-a-", "-", "", "aa"},
      {"aa", "a", "", ""},
      {"none", "x", "y", "none"},
      {"", "x", "y", ""},
  };
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
  for (const size_t nLength : {0u, 1u, 8094u, 8095u, 8096u, 16190u, 16192u, 100000u}) {
    const std::string text(nLength, 'x');
    CNString cs("old", 0);
    EXPECT_EQ(cs.Printf("test", "cs", "%s", text.c_str()), text);
    EXPECT_EQ(Value(cs), text);
  }
  CNString cs("self", 0);
  cs.Printf("test", "cs", "<%s %.3d %li>", cs.Ptr(), 7, -1L);
  EXPECT_EQ(Value(cs), "<self 007 -1>");
  EXPECT_STREQ(cs.Printf("test", "cs", "%s", ""), "");
  EXPECT_EQ(Value(cs), "");
}

TEST(CNString, MakeLowerChangesAsciiLettersOnly) {
  CNString cs("AZ@[\xC8", 0);
  char szOther[] = "Other";
  EXPECT_EQ(cs.MakeLower(szOther), cs.Ptr());
  EXPECT_STREQ(szOther, "other");
  EXPECT_EQ(Value(cs), "AZ@[\xC8");
  cs.MakeLower();
  EXPECT_EQ(Value(cs), "az@[\xC8");
}

TEST(CNString, Queries) {
  const CNString cs("one two", 0), csNull;
  EXPECT_EQ(cs.Has('\0'), 1);
  EXPECT_EQ(cs.Has('t'), 1);
  EXPECT_EQ(cs.Has('x'), 0);
  EXPECT_EQ(csNull.Has('\0'), 0);
  EXPECT_EQ(cs.Has("e t"), 1);
  EXPECT_EQ(cs.Has("Two"), 0);
  EXPECT_EQ(csNull.Has("a"), 0);
  EXPECT_EQ(cs.Find("two"), 4);
  EXPECT_EQ(cs.Find(""), -1);
  EXPECT_EQ(cs.Find(nullptr), -1);
  EXPECT_EQ(cs.EndsWith("two"), 1);
  EXPECT_EQ(cs.EndsWith("Two"), 0);
  EXPECT_EQ(cs.EndsWith(""), 1);
  EXPECT_EQ(cs.EndsWith("and one two"), 0);
  EXPECT_EQ(cs.IsEqual("one two"), 1);
  EXPECT_EQ(cs.IsEqual("one tw"), 0);
  EXPECT_EQ(csNull.IsEqual(nullptr), 0);
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
      {"xaB y", "Ab", 1, -1},
      {"x aB", "Ab", 2, 2},
      {"abc ab", "AB", 0, 4},
      {"x1", "x", 0, 0},
      {"x_y", "X", 0, 0},
      {"\xE8"
       "ab ab",
       "ab", 1, 4},
      {"ab\x8A", "ab", 0, -1},
      {"ab\xD7", "ab", 0, 0},
      {"\xC8", "\xE8", -1, -1},
      {"text", "", -1, -1},
      {"a", "ab", -1, -1},
  };
  for (const auto& row : rows) {
    const CNString cs(row.szText, 0);
    const auto at = [&](const char* p) { return p ? long(p - cs.Ptr()) : -1; };
    EXPECT_EQ(at(cs.IHas(row.szSearch, false)), row.lAnywhere) << row.szText;
    EXPECT_EQ(at(cs.IHas(row.szSearch, true)), row.lWholeWord) << row.szText;
  }
}

TEST(CNString, LettersAreThoseOfCodePage1250) {
  // Upper and lower case of the upper half stand 0x20 (from 0xC0) or 0x10 (below 0xA0) apart.
  const std::string letters = "\x8A\x8C\x8D\x8E\x8F\x9A\x9C\x9D\x9E\x9F\xA3\xA5\xAA\xAF\xB3\xB9\xBA\xBC\xBE\xBF";
  for (int c = 0; c < 256; c++) {
    const bool bAscii = (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z');
    const bool bUpperHalf = c >= 0xC0 && c != 0xD7 && c != 0xDF && c != 0xF7 && c != 0xFF;
    const bool bSingle = letters.find(char(c)) != std::string::npos && c;
    EXPECT_EQ(IsLetter(static_cast<unsigned char>(c)), bAscii || bUpperHalf || bSingle) << c;
  }
}

TEST(CNString, EveryRefusalLogsOneLineAndKeepsTheText) {
  TestFolder folder;
  TestLog log(folder);
  CNString csNull, cs("text", 0);
  EXPECT_EQ(csNull.Trim('x'), nullptr);
  EXPECT_EQ(csNull.TrimRight(), nullptr);
  EXPECT_EQ(csNull.AddSlash(), nullptr);
  EXPECT_EQ(csNull.IHas("a", false), nullptr);
  EXPECT_EQ(csNull.EndsWith("a"), 0);
  EXPECT_EQ(csNull.SubstituteAll("f", "v", "a", "b"), nullptr);
  EXPECT_EQ(cs.SubstituteAll("f", "v", nullptr, "b"), nullptr);
  EXPECT_EQ(cs.SubstituteAll("f", "v", "", "b"), nullptr);
  EXPECT_EQ(cs.SubstituteAll("f", "v", "a", nullptr), nullptr);
  EXPECT_EQ(cs.Copy(nullptr, 1), nullptr);
  EXPECT_EQ(cs.iInsert(nullptr, 0), 0);
  EXPECT_EQ(cs.iInsert("a", 5), 0);
  EXPECT_EQ(cs.Concat("a", LONG_MAX), nullptr);
  const auto vPrintf = [](CNString& csOut, const char* szFormat, ...) {
    va_list args;
    va_start(args, szFormat);
    EXPECT_EQ(csOut.vPrintf("f", "v", szFormat, args), nullptr);
    va_end(args);
  };
  vPrintf(cs, nullptr);
  EXPECT_EQ(Value(cs), "text");
  EXPECT_EQ(log.Lines(),
            (Lines{"ERROR: CNString::Trim -> !m_szString -> return NULL",
                   "ERROR: CNString::TrimRight -> !m_szString -> return NULL",
                   "ERROR: CNString::AddSlash -> !m_szString -> return NULL",
                   "ERROR: CNString::IHas -> !m_szString || !szSubStr-> return 0",
                   "ERROR: CNString::EndsWith -> !m_szString || !str -> return 0",
                   "ERROR: CNString::SubstituteAll -> !m_szString -> szFunction=f, szVariable=v -> return NULL",
                   "ERROR: CNString::SubstituteAll -> !str -> szFunction=f, szVariable=v -> return NULL",
                   "ERROR: CNString::SubstituteAll -> !str -> szFunction=f, szVariable=v -> return NULL",
                   "ERROR: CNString::SubstituteAll -> !newstr -> szFunction=f, szVariable=v -> return NULL",
                   "ERROR: CNString::Copy -> !mem -> return NULL", "ERROR: CNString::iInsert -> !string -> return NULL",
                   "ERROR: CNString::iInsert -> iAt>m_lLength -> return NULL",
                   "ERROR: CNString::Concat -> !m_szString -> return NULL",
                   "ERROR: CNString::vPrintf(char *str, va_list args) -> !str -> return NULL -> szFunction=f, "
                   "szVariable=v"}));
}

TEST(CNString, AFailedCopyLeavesNoTextButTheAskedLength) {
  TestFolder folder;
  TestLog log(folder);
  CNString cs("text", 0);
  EXPECT_EQ(cs.Copy("a", LONG_MAX), nullptr);
  EXPECT_EQ(cs.Ptr(), nullptr);
  EXPECT_EQ(cs.Length(), LONG_MAX);
  EXPECT_EQ(log.Lines(), Lines{"ERROR: CNString::Copy -> !m_szString -> return NULL"});
  EXPECT_STREQ(cs.Concat("new"), "new");
  EXPECT_EQ(cs.Length(), 3);
}
