#include <gtest/gtest.h>

#include <atomic>
#include <string>

#include "foundation/os/Os.h"
#include "foundation/os/OsRegistry.h"

namespace {

int iFormat(char* szBuffer, size_t nSize, const char* szFormat, ...) {
  va_list args;
  va_start(args, szFormat);
  const int iWritten = iOsFormat(szBuffer, nSize, szFormat, args);
  va_end(args);
  return iWritten;
}

std::string Query(const OsRegistryKey& key, const char* szName, OsRegType expected, long lCapacity = 64) {
  char data[64] = {};
  long lSize = -1;
  OsRegType type = OsRegType::None;
  if (!key.bQuery(szName, type, data, lCapacity, lSize)) return "(failed)";
  EXPECT_EQ(type, expected);
  return std::string(data, size_t(lSize));
}

const char* const PARENT = "Software\\Orbit Tests";
const char* const KEY = "Software\\Orbit Tests\\Foundation";

}  // namespace

TEST(OsSystem, FormatsAndCompares) {
  char buffer[5] = "????";
  EXPECT_EQ(iFormat(buffer, 5, "%d%s", 12, "34"), 4);
  EXPECT_EQ(iFormat(buffer, 5, "%s", "12345"), -1);
  EXPECT_STREQ(buffer, "1234") << "cut, and terminated";
  EXPECT_EQ(iFormat(buffer, 5, "%s", "much too long"), -1);
  EXPECT_STREQ(buffer, "much");
  EXPECT_EQ(iOsCompareNoCase("Unzip", "uNZIP"), 0);
  EXPECT_LT(iOsCompareNoCase("abc", "ABD"), 0);
  EXPECT_GT(iOsCompareNoCase("abc", "AB"), 0);
  EXPECT_LT(iOsCompareNoCase("[", "a"), 0);
  EXPECT_NE(iOsCompareNoCase("\xC8", "\xE8"), 0);
}

TEST(OsSystem, ThreadsRunAndSleep) {
  static std::atomic<unsigned long> ulThread;
  ulThread = 0;
  const uint32_t start = OsTickCount();
  const auto run = [](void* pContext) {
    OsSleep(20);
    static_cast<std::atomic<unsigned long>*>(pContext)->store(OsThreadId());
  };
  ASSERT_TRUE(bOsStartThread(run, &ulThread));
  while (!ulThread && OsTickCount() - start < 5000) OsSleep(1);
  EXPECT_TRUE(ulThread != 0u && ulThread != OsThreadId());
  EXPECT_GE(OsTickCount() - start, 15u);
}

TEST(OsSystem, NamesTheSystemAndItsErrors) {
  CNString cs;
  OsGetSystemName(cs);
#ifdef _WIN32
  EXPECT_EQ(cs.Find("Windows "), 0) << cs.Text();
  OsErrorText(0xE0000001, cs);
  EXPECT_STREQ(cs.Text(), "unknown error (3758096385)");
#else
  EXPECT_STREQ(cs.Text(), "unknown");
#endif
  EXPECT_FALSE(OsFile().bOpen("missing/missing", OsOpenMode::Read));
  OsErrorText(OsLastError(), cs);
  EXPECT_TRUE(cs.Length() > 5 && !cs.EndsWith("\n"));
}

TEST(OsRegistry, KeepsValuesOfEveryType) {
  const struct {
    const char* szName;
    OsRegType type;
    std::string set, got;
  } rows[] = {
      {"Text", OsRegType::String, std::string("Gre\x9Aka\0", 7), std::string("Gre\x9Aka\0", 7)},
      {"text", OsRegType::String, std::string("Gre\x9Aka!\0", 8), std::string("Gre\x9Aka!\0", 8)},  // the same value
      {"Bare", OsRegType::ExpandString, "%x%", std::string("%x%", 4)},  // gets its terminator
      {"Multi", OsRegType::MultiString, std::string("a\0\xE8\0", 5), std::string("a\0\xE8\0", 5)},
      {"Number", OsRegType::Dword, std::string("\1\0\0\x80", 4), std::string("\1\0\0\x80", 4)},
      {"Bytes", OsRegType::Binary, std::string("\0\xFF\0", 3), std::string("\0\xFF\0", 3)},
      {"", OsRegType::String, std::string(1, '\0'), std::string(1, '\0')},
  };
  OsRegistryKey key, reader;
  ASSERT_TRUE(key.bOpen(OS_HKEY_CURRENT_USER, KEY, OsRegAccess::Create));
  ASSERT_TRUE(reader.bOpen(OS_HKEY_CURRENT_USER, "SOFTWARE\\orbit tests\\FOUNDATION", OsRegAccess::Read));
  for (const auto& row : rows) {
    EXPECT_TRUE(key.bSet(row.szName, row.type, row.set.data(), long(row.set.size())));
    EXPECT_EQ(Query(reader, row.szName, row.type), row.got) << row.szName;
  }
  EXPECT_EQ(Query(reader, "TEXT", OsRegType::String, 8), rows[1].got);
  EXPECT_EQ(Query(reader, "Text", OsRegType::String, 7), "(failed)") << "too little room";
  EXPECT_EQ(Query(reader, nullptr, OsRegType::String), std::string(1, '\0'));
  EXPECT_EQ(Query(reader, "Missing", OsRegType::String), "(failed)");
  EXPECT_FALSE(reader.bSet("Text", OsRegType::String, "x", 2)) << "opened for reading";
  EXPECT_FALSE(reader.bDeleteValue("Text"));
  EXPECT_TRUE(key.bDeleteValue("Text"));
  EXPECT_FALSE(key.bDeleteValue("Text"));
  EXPECT_EQ(Query(reader, "Text", OsRegType::String), "(failed)");
  for (const char* szKey : {KEY, PARENT}) EXPECT_TRUE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, szKey));
}

TEST(OsRegistry, ListsAndDeletesKeys) {
  OsRegistryKey key, child;
  CNString csName;
  const auto path = [](const char* szName) { return std::string(PARENT) + "\\" + szName; };
  ASSERT_TRUE(key.bOpen(OS_HKEY_CURRENT_USER, PARENT, OsRegAccess::Create));
  for (const char* szName : {"b", "\x8A", "A"}) {
    ASSERT_TRUE(child.bOpen(OS_HKEY_CURRENT_USER, path(szName).c_str(), OsRegAccess::Create));
    EXPECT_TRUE(key.bSet(szName, OsRegType::Dword, "\0\0\0", 4));
  }
  child.Close();
  std::string keys, values;
  for (unsigned i = 0; key.bEnumSubkey(i, csName); i++) keys += csName.Text();
  for (unsigned i = 0; key.bEnumValue(i, csName); i++) values += csName.Text();
  EXPECT_EQ(keys, "Ab\x8A");
  EXPECT_TRUE(values.size() == 3 && values.find('\x8A') != std::string::npos) << values;
  EXPECT_FALSE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, PARENT)) << "has subkeys";
  EXPECT_FALSE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, ""));
  for (const char* szName : {"a", "b", "\x8A"})
    EXPECT_TRUE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, path(szName).c_str()));
  EXPECT_TRUE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, PARENT));
  EXPECT_FALSE(key.bSet("late", OsRegType::Dword, "\0\0\0", 4)) << "the key is gone";
  EXPECT_FALSE(child.bOpen(OS_HKEY_CURRENT_USER, PARENT, OsRegAccess::Full));
  EXPECT_FALSE(child.bOpen(OS_HKEY_CURRENT_USER, nullptr, OsRegAccess::Create));
}
