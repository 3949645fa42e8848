// The door to the system: files, folders, the registry and the rest, alike on every system.
#include "foundation/os/Os.h"
#include "foundation/os/OsRegistry.h"
#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

const uint64_t SECOND = 10000000;
const uint64_t YEAR_2000 = 125911584000000000;  // 2000-01-01 00:00:00 UTC
const char* const PARENT = "Software\\Orbit Tests";
const char* const KEY = "Software\\Orbit Tests\\Foundation";

std::string ReadSome(OsFile& file, size_t nBytes) {
  std::string bytes(nBytes, '?');
  const long lRead = file.lRead(bytes.data(), nBytes);
  return lRead < 0 ? "(failed)" : bytes.substr(0, size_t(lRead));
}

std::string Query(const OsRegistryKey& key, const char* szName, OsRegType expected, long lCapacity = 64) {
  char data[64] = {};
  long lSize = -1;
  OsRegType type = OsRegType::None;
  if (!key.bQuery(szName, type, data, lCapacity, lSize)) return "(failed)";
  EXPECT_EQ(type, expected);
  return std::string(data, size_t(lSize));
}

}  // namespace

TEST(OsFile, OpenModes) {
  TestFolder folder;
  const std::string path = folder.Path("file");
  OsFile file;
  EXPECT_FALSE(file.bOpen(path.c_str(), OsOpenMode::Read));
  EXPECT_FALSE(file.bOpen(path.c_str(), OsOpenMode::Truncate));
  EXPECT_FALSE(folder.Exists("file"));
  const struct {
    OsOpenMode mode;
    const char* szResult;
  } rows[] = {{OsOpenMode::CreateNew, "x"},
              {OsOpenMode::Append, "xx"},
              {OsOpenMode::Create, "x"},
              {OsOpenMode::Append, "xx"},
              {OsOpenMode::Truncate, "x"}};
  for (const auto& row : rows) {
    EXPECT_TRUE(file.bOpen(path.c_str(), row.mode));
    EXPECT_EQ(ReadSome(file, 1), "(failed)") << "opened for writing only";
    EXPECT_TRUE(file.bWrite("x", 1) && file.bClose());
    EXPECT_EQ(folder.Read("file"), row.szResult);
  }
  EXPECT_FALSE(file.bOpen(path.c_str(), OsOpenMode::CreateNew));
  EXPECT_EQ(folder.Read("file"), "x") << "a file that was there";
  EXPECT_TRUE(file.bOpen(path.c_str(), OsOpenMode::Read));
  EXPECT_FALSE(file.bWrite("x", 1));
  EXPECT_FALSE(file.bOpen(folder.Root().c_str(), OsOpenMode::Read)) << "a folder is no file";
  EXPECT_TRUE(!file.bIsOpen() && file.Size() == -1 && !file.bSeek(0));
  // A hidden file can be emptied.
  EXPECT_TRUE(bOsSetAttributes(path.c_str(), OS_HIDDEN | OS_SYSTEM));
  folder.Write("file", "new");
  EXPECT_EQ(folder.Read("file"), "new");
}

TEST(OsFile, SeeksMovesAndKnowsItsSize) {
  TestFolder folder;
  OsFile file;
  ASSERT_TRUE(file.bOpen(folder.Path("file").c_str(), OsOpenMode::Create));
  EXPECT_TRUE(file.bWrite("0123456789", 10) && file.bSeek(4) && file.bWrite("##", 2) && file.bClose());
  const auto openAt = [&](uint64_t offset) {
    OsFile opened;
    EXPECT_TRUE(opened.bOpen(folder.Path("file").c_str(), OsOpenMode::Read) && opened.bSeek(offset));
    return opened;
  };
  OsFile moved(openAt(8));
  EXPECT_EQ(moved.Size(), 10);
  EXPECT_EQ(ReadSome(moved, 5), "89");
  EXPECT_EQ(ReadSome(moved, 5), "");
  moved = openAt(3);
  EXPECT_EQ(ReadSome(moved, 2), "3#") << "the position comes along";
}

TEST(OsFile, TimesAndAttributes) {
  TestFolder folder;
  folder.Write("file", "abc");
  const std::string path = folder.Path("file");
  OsFile file;
  ASSERT_TRUE(file.bOpen(path.c_str(), OsOpenMode::Append));
  EXPECT_TRUE(file.bSetTimes({YEAR_2000, YEAR_2000 + SECOND, YEAR_2000 + 2 * SECOND}));
  EXPECT_TRUE(file.bSetTimes({0, 0, YEAR_2000 + 3 * SECOND}));
  EXPECT_TRUE(file.bClose());
  OsFileInfo info;
  for (const uint32_t attributes : {uint32_t(OS_READ_ONLY), 0u}) {
    EXPECT_TRUE(bOsSetAttributes(path.c_str(), attributes));
    ASSERT_TRUE(bOsGetFileInfo(path.c_str(), info));
    EXPECT_EQ(info.attributes & (OS_READ_ONLY | OS_DIRECTORY | OS_REPARSE_POINT), attributes);
    EXPECT_TRUE(info.size == 3 && info.times.lastWrite == YEAR_2000 + 3 * SECOND);
    EXPECT_EQ(info.times.lastAccess, YEAR_2000 + SECOND);
  }
  ASSERT_TRUE(bOsGetFileInfo((folder.Root() + "/").c_str(), info));
  EXPECT_EQ(info.attributes & (OS_READ_ONLY | OS_DIRECTORY), OS_DIRECTORY);
  EXPECT_FALSE(bOsGetFileInfo(folder.Path("missing").c_str(), info));
  EXPECT_FALSE(bOsSetAttributes(folder.Path("missing").c_str(), 0));
}

TEST(OsFolder, MakesListsRenamesAndDeletes) {
  TestFolder folder;
  const std::string sub = folder.Path("Sub \x8A"), file = folder.Path("file \xE6");
  EXPECT_EQ(OsMakeFolder(sub.c_str()), OsMakeFolderResult::Made);
  EXPECT_EQ(OsMakeFolder(sub.c_str()), OsMakeFolderResult::Exists);
  EXPECT_EQ(OsMakeFolder(folder.Path("missing/sub").c_str()), OsMakeFolderResult::NoParent);
  folder.Write("file \xE6", "54321");
  EXPECT_EQ(OsMakeFolder(file.c_str()), OsMakeFolderResult::Failed) << "a file is in the way";
  folder.Write("Sub \x8A/inner", "old");
  EXPECT_TRUE(bOsRename(file.c_str(), (sub + "/inner").c_str()));
  EXPECT_EQ(folder.Read("Sub \x8A/inner"), "54321");
  EXPECT_FALSE(bOsRename(file.c_str(), folder.Path("c").c_str()));
  folder.MakeFolder("Sub \x8A/deep");
  EXPECT_EQ(folder.Names("Sub \x8A"), (Lines{"deep", "inner"}));
  EXPECT_TRUE(bOsIsFolder((sub + "\\deep").c_str()) && !bOsIsFolder((sub + "\\inner").c_str()));
  EXPECT_FALSE(bOsDeleteFolder(sub.c_str())) << "not empty";
  EXPECT_FALSE(bOsDeleteFile(sub.c_str())) << "a folder";

  int nVisits = 0;
  const auto stop = [](const OsFolderEntry& entry, void* pCount) {
    EXPECT_EQ(entry.info.size, (entry.info.attributes & OS_DIRECTORY) ? 0u : 5u);
    return ++*static_cast<int*>(pCount) < 1;
  };
  EXPECT_TRUE(bOsListFolder(sub.c_str(), stop, &nVisits) && nVisits == 1);
  EXPECT_FALSE(bOsListFolder(folder.Path("missing").c_str(), stop, &nVisits));
  EXPECT_FALSE(bOsListFolder("", stop, &nVisits));
  EXPECT_TRUE(bOsDeleteFile((sub + "/inner").c_str()) && bOsDeleteFolder((sub + "/deep").c_str()));
  EXPECT_TRUE(bOsDeleteFolder(sub.c_str()) && !bOsDeleteFolder(sub.c_str()));
}

TEST(OsFolder, PathsBeyondTheUsualLimit) {
  TestFolder folder;
  std::string name;
  for (int i = 0; i < 6; i++) name += (i ? "/" : "") + std::string(60, char('a' + i));
  folder.MakeFolder(name);
  folder.Write(name + "/file", "deep");
  EXPECT_EQ(folder.Read(name + "/file"), "deep");
  EXPECT_EQ(folder.Names(name), Lines{"file"});
}

TEST(OsFolder, NamesThatTheCodePageCannotHold) {
  TestFolder folder;
  const std::filesystem::path cyrillic = std::filesystem::path(folder.Root()) / u"\u0416\u0416.txt";
#ifdef _WIN32
  std::fclose(_wfopen(cyrillic.c_str(), L"w"));
  ASSERT_EQ(folder.Names().size(), 1u);
  EXPECT_TRUE(folder.Exists(folder.Names()[0])) << "the short name finds the file";
#else
  std::fclose(std::fopen(cyrillic.c_str(), "w"));
  EXPECT_EQ(folder.Names(), Lines{"??.txt"});
#endif
  std::filesystem::remove(cyrillic);
}

TEST(OsFolder, TemporaryFilesAndFreeSpace) {
  TestFolder folder;
  CNString csFirst, csSecond, csPlace;
  ASSERT_TRUE(bOsMakeTempFile(folder.Root().c_str(), "orb", csFirst));
  ASSERT_TRUE(bOsMakeTempFile(folder.Root().c_str(), "orb", csSecond));
  EXPECT_EQ(folder.Names().size(), 2u);
  for (const std::string& name : folder.Names()) EXPECT_EQ(name.substr(0, 3), "orb");
  EXPECT_EQ(TestFolder::ReadFile(csFirst.Text()), "");
  EXPECT_FALSE(bOsMakeTempFile(folder.Path("missing").c_str(), "orb", csPlace));
  ASSERT_TRUE(bOsGetTempFolder(csPlace));
  EXPECT_TRUE(bOsIsFolder(csPlace.Text()) && (csPlace.EndsWith("\\") || csPlace.EndsWith("/")));
  uint64_t bytes = 0;
  for (const std::string& path : {folder.Root(), std::string(csFirst.Text()), folder.Path("not/yet/there"),
                                  std::string("not\\yet"), std::string()})
    EXPECT_TRUE(bOsGetFreeSpace(path.c_str(), bytes) && std::exchange(bytes, 0) > 4096) << path;
#ifdef _WIN32
  EXPECT_FALSE(bOsGetFreeSpace("Q:\\no\\such\\drive", bytes));
#endif
}

TEST(OsSystem, ComparesAndNamesTheSystemAndItsErrors) {
  EXPECT_EQ(iOsCompareNoCase("Unzip", "uNZIP"), 0);
  EXPECT_LT(iOsCompareNoCase("abc", "ABD"), 0);
  EXPECT_GT(iOsCompareNoCase("abc", "AB"), 0);
  EXPECT_LT(iOsCompareNoCase("[", "a"), 0);
  EXPECT_NE(iOsCompareNoCase("\xC8", "\xE8"), 0);
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

TEST(OsRegistry, KeepsValuesOfEveryTypeAndListsThem) {
  const struct {
    const char* szName;
    OsRegType type;
    std::string set, got;
  } rows[] = {
      {"Text", OsRegType::String, std::string("Gre\x9Aka\0", 7), std::string("Gre\x9Aka\0", 7)},
      {"text", OsRegType::String, std::string("Gre\x9Aka!\0", 8), std::string("Gre\x9Aka!\0", 8)},  // the same value
      {"Bare \x8A", OsRegType::ExpandString, "%x%", std::string("%x%", 4)},  // gets its terminator
      {"Multi", OsRegType::MultiString, std::string("a\0\xE8\0", 5), std::string("a\0\xE8\0", 5)},
      {"Number", OsRegType::Dword, std::string("\1\0\0\x80", 4), std::string("\1\0\0\x80", 4)},
      {"Bytes", OsRegType::Binary, std::string("\0\xFF\0", 3), std::string("\0\xFF\0", 3)},
      {"", OsRegType::String, std::string(1, '\0'), std::string(1, '\0')},
  };
  OsRegistryKey parent, key, reader;
  ASSERT_TRUE(key.bOpen(OS_HKEY_CURRENT_USER, KEY, OsRegAccess::Create));
  ASSERT_TRUE(reader.bOpen(OS_HKEY_CURRENT_USER, "SOFTWARE\\orbit tests\\FOUNDATION", OsRegAccess::Read));
  for (const auto& row : rows) {
    EXPECT_TRUE(key.bSet(row.szName, row.type, row.set.data(), long(row.set.size())));
    EXPECT_EQ(Query(reader, row.szName, row.type), row.got) << row.szName;
  }
  EXPECT_EQ(Query(reader, "TEXT", OsRegType::String, 8), rows[1].got);
  EXPECT_EQ(Query(reader, "Text", OsRegType::String, 7), "(failed)") << "too little room";
  EXPECT_EQ(Query(reader, nullptr, OsRegType::String), std::string(1, '\0'));
  EXPECT_FALSE(reader.bSet("Text", OsRegType::String, "x", 2)) << "opened for reading";
  EXPECT_FALSE(reader.bDeleteValue("Text"));
  EXPECT_TRUE(key.bDeleteValue("Text") && !key.bDeleteValue("Text"));
  EXPECT_EQ(Query(reader, "Text", OsRegType::String), "(failed)");
  Lines names;
  CNString csName;
  for (unsigned i = 0; key.bEnumValue(i, csName); i++) names.push_back(csName.Text());
  std::sort(names.begin(), names.end());
  EXPECT_EQ(names, (Lines{"", "Bare \x8A", "Bytes", "Multi", "Number"}));

  ASSERT_TRUE(parent.bOpen(OS_HKEY_CURRENT_USER, PARENT, OsRegAccess::Full));
  EXPECT_TRUE(parent.bEnumSubkey(0, csName) && csName.IsEqual("Foundation") && !parent.bEnumSubkey(1, csName));
  EXPECT_FALSE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, PARENT)) << "has subkeys";
  EXPECT_FALSE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, ""));
  for (const char* szKey : {KEY, PARENT}) EXPECT_TRUE(bOsDeleteRegistryKey(OS_HKEY_CURRENT_USER, szKey));
  EXPECT_FALSE(key.bSet("late", OsRegType::Dword, "\0\0\0", 4)) << "the key is gone";
  EXPECT_FALSE(key.bOpen(OS_HKEY_CURRENT_USER, PARENT, OsRegAccess::Full));
  EXPECT_FALSE(key.bOpen(OS_HKEY_CURRENT_USER, nullptr, OsRegAccess::Create));
}
