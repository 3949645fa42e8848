// Code page 1250 and Unicode, patterns of names, the texts of socket errors.
#include "foundation/Text.h"

#ifdef _WIN32
#include <winsock2.h>
#else
#include <cerrno>
#endif

#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "foundation/NamePattern.h"
#include "foundation/SocketError.h"

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

std::string SocketText(int iError, int iSize = 500) {
  std::string buffer(size_t(iSize) + 1, '#');
#ifdef _WIN32
  SetLastError(DWORD(iError));
#else
  errno = iError;
#endif
  EXPECT_EQ(WSAGetLastErrorString(&buffer[0], iSize), 0);
  EXPECT_EQ(buffer[size_t(iSize)], '#') << "written beyond the buffer";
  return buffer.c_str();
}

}  // namespace

TEST(Text, EveryByteSurvivesBothWays) {
  EXPECT_EQ(Widened("A\x80\x8A\x9A\xE8\xC6\xF0\xFF"), u"A\u20AC\u0160\u0161\u010D\u0106\u0111\u02D9");
  EXPECT_EQ(Narrowed("Gre\xC5\xA1ka \xE2\x82\xAC"), "Gre\x9Aka \x80");
  EXPECT_STREQ("Greška", "Gre\x9Aka") << "literals are code page 1250";
  EXPECT_EQ(CNWideText(nullptr).Ptr(), nullptr);
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
  EXPECT_EQ(Narrowed("\xF0\x9F\x98\x80!a\xC5"), "?!a?~");
  EXPECT_EQ(Narrowed("\xC5n\xFF\xFE"), "?n??~");
  for (const char* szMalformed :
       {"\xD0\x96", "\x80", "\xC0\x80", "\xE0\x81\x81", "\xED\xA0\x80", "\xE2\x82", "\xF0\x80\x80\x80"})
    EXPECT_EQ(Narrowed(szMalformed), "?~");
}

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
      {"*.", "a abc", "a.b a.b.c"},
      {"readme.", "readme README", "readme.txt read"},
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
  std::string many;  // which cost no more than the product of both lengths
  for (int i = 0; i < 300; i++) many += "*a";
  EXPECT_TRUE(bMatchesPattern(std::string(600, 'a').c_str(), many.c_str()));
  EXPECT_FALSE(bMatchesPattern(std::string(600, 'a').c_str(), (many + "b").c_str()));
}

TEST(SocketError, TellsKnownAndUnknownErrorsAndCutsThem) {
  EXPECT_EQ(SocketText(6), "WSA_INVALID_HANDLE: Specified event object handle is invalid.");
  EXPECT_EQ(SocketText(10049), "WSAEADDRINUSE: Cannot assign requested address.");
  EXPECT_EQ(SocketText(10107), "WSASYSCALLFAILURE: System call failure.");
  EXPECT_EQ(SocketText(0), "unknown error (0)");
  EXPECT_EQ(SocketText(11005), "unknown error (11005)");
  EXPECT_EQ(SocketText(10060, 10), "WSAETIMED");
  EXPECT_EQ(SocketText(4711, 10), "unknown e");
}

#ifdef _WIN32
TEST(SocketError, HoldsTheNumbersOfWindowsSockets) {
#define ROW(name) \
  { name, #name ": " }
  // clang-format off
  const struct { int iError; const char* szName; } rows[] = {
      ROW(WSA_INVALID_HANDLE), ROW(WSA_NOT_ENOUGH_MEMORY), ROW(WSA_INVALID_PARAMETER), ROW(WSA_OPERATION_ABORTED),
      ROW(WSA_IO_INCOMPLETE), ROW(WSA_IO_PENDING), ROW(WSAEINTR), ROW(WSAEACCES), ROW(WSAEFAULT), ROW(WSAEINVAL),
      ROW(WSAEMFILE), ROW(WSAEWOULDBLOCK), ROW(WSAEINPROGRESS), ROW(WSAEALREADY), ROW(WSAENOTSOCK),
      ROW(WSAEDESTADDRREQ), ROW(WSAEMSGSIZE), ROW(WSAEPROTOTYPE), ROW(WSAENOPROTOOPT), ROW(WSAEPROTONOSUPPORT),
      ROW(WSAESOCKTNOSUPPORT), ROW(WSAEOPNOTSUPP), ROW(WSAEPFNOSUPPORT), ROW(WSAEAFNOSUPPORT), ROW(WSAEADDRINUSE),
      ROW(WSAENETDOWN), ROW(WSAENETUNREACH), ROW(WSAENETRESET), ROW(WSAECONNABORTED), ROW(WSAECONNRESET),
      ROW(WSAENOBUFS), ROW(WSAEISCONN), ROW(WSAENOTCONN), ROW(WSAESHUTDOWN), ROW(WSAETIMEDOUT), ROW(WSAECONNREFUSED),
      ROW(WSAEHOSTDOWN), ROW(WSAEHOSTUNREACH), ROW(WSAEPROCLIM), ROW(WSASYSNOTREADY), ROW(WSAVERNOTSUPPORTED),
      ROW(WSANOTINITIALISED), ROW(WSAEDISCON), ROW(WSATYPE_NOT_FOUND), ROW(WSAHOST_NOT_FOUND), ROW(WSATRY_AGAIN),
      ROW(WSANO_RECOVERY), ROW(WSANO_DATA), ROW(WSASYSCALLFAILURE),
  };
  // clang-format on
#undef ROW
  for (const auto& row : rows) EXPECT_EQ(SocketText(row.iError).find(row.szName), 0u) << row.szName;
}
#endif
