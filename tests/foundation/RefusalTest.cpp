// What the foundation refuses: each call leaves with its documented value, tells exactly one line and changes nothing.
// The lines that are not of the common form are held word for word.
#ifdef _WIN32
#include <windows.h>  // has a macro CopyFile
#endif

#include <climits>
#include <memory>

#include "foundation/CNArray.h"
#include "foundation/CNConfigFile.h"
#include "foundation/CNStream.h"
#include "foundation/CNSystem.h"
#include "foundation/SocketError.h"
#include "support/TestFolder.h"

namespace {

const char* const NOTHING = nullptr;

class RefusalTest : public testing::Test {
 protected:
  // One call, and its line.
  void Expect(const std::string& line, bool bDocumented) {
    EXPECT_TRUE(bDocumented) << line;
    EXPECT_EQ(m_log.Lines(), std::vector<std::string>{line});
    m_log.Clear();
  }
  // Several calls, all of one class, with one ending.
  void ExpectEach(const std::string& start, const std::string& ending, std::initializer_list<bool> documented) {
    for (auto p = documented.begin(); p != documented.end(); p++) EXPECT_TRUE(*p) << p - documented.begin();
    EXPECT_EQ(m_log.Lines().size(), documented.size());
    for (const std::string& line : m_log.Lines()) {
      EXPECT_EQ(line.find("ERROR: " + start), 0u) << line;
      EXPECT_TRUE(line.size() > ending.size() && line.substr(line.size() - ending.size()) == ending) << line;
    }
    m_log.Clear();
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(RefusalTest, Strings) {
  CNString csNull, cs("text", 0);
  const auto vPrintf = [&cs](const char* szFormat, ...) {
    va_list args;
    va_start(args, szFormat);
    const char* const szResult = cs.vPrintf("f", "v", szFormat, args);
    va_end(args);
    return szResult;
  };
  ExpectEach("CNString::", " -> return NULL",
             {!csNull.Trim('x'), !csNull.TrimRight(), !csNull.AddSlash(), !cs.Copy(nullptr, 1), !cs.iInsert(nullptr, 0),
              !cs.iInsert("a", 5), !cs.Concat("a", LONG_MAX)});
  ExpectEach("CNString::SubstituteAll -> !", " -> szFunction=f, szVariable=v -> return NULL",
             {!csNull.SubstituteAll("f", "v", "a", "b"), !cs.SubstituteAll("f", "v", nullptr, "b"),
              !cs.SubstituteAll("f", "v", "", "b"), !cs.SubstituteAll("f", "v", "a", nullptr)});
  Expect("ERROR: CNString::IHas -> !m_szString || !szSubStr-> return 0", !csNull.IHas("a", false));
  Expect("ERROR: CNString::EndsWith -> !m_szString || !str -> return 0", !csNull.EndsWith("a"));
  Expect("ERROR: CNString::vPrintf(char *str, va_list args) -> !str -> return NULL -> szFunction=f, szVariable=v",
         !vPrintf(nullptr));
  EXPECT_STREQ(cs.Ptr(), "text");
  Expect("ERROR: CNString::Copy -> !m_szString -> return NULL",
         !cs.Copy("a", LONG_MAX) && !cs.Ptr() && cs.Length() == LONG_MAX);
  EXPECT_TRUE(cs.Concat("new") && cs.Length() == 3) << "usable after a failed copy";
}

TEST_F(RefusalTest, Arrays) {
  const auto a = std::make_unique<int>(), b = std::make_unique<int>();
  CNArray<int> array;
  CNCharArray chars;
  CNStringArray strings;
  array.Add(a.get(), 0);
  ExpectEach("CNArray::", " -> return",
             {(array.Add(nullptr, 0), true), (array.Add(nullptr), true), (array.Insert(nullptr, 0), true),
              (array.Remove(nullptr), true), (array.Remove(b.get()), true)});
  for (const int i : {-1, 2})
    Expect("ERROR: CNArray::Insert -> iIndex<0 || iIndex>=m_nArrayEl -> return", (array.Insert(b.get(), i), true));
  ExpectEach("CNStringArray::", " -> return",
             {(strings.Add(NOTHING, 1), true), (strings.Add(CNString("", 0), 1), true), (strings.Remove(nullptr), true),
              (strings.Remove("missing"), true)});
  ExpectEach("CN", " -> return -1",
             {array.Find(nullptr) == -1, chars.Set(nullptr, ";", false) == -1, strings.Find(nullptr) == -1,
              strings.Set(nullptr, ';', false) == -1});
  Expect("ERROR: CNCharArray::Add -> !string -> return", (chars.Add(nullptr, 1), true));
  Expect("ERROR: CNCharArray::operator[] -> n>=m_nArrayEl -> return NULL", !chars[0]);
  EXPECT_TRUE(array.Size() == 1 && chars.Size() == 0 && strings.Size() == 0);
}

TEST_F(RefusalTest, Streams) {
  char bytes[4] = "abc";
  CNString csAll;
  CNBuffer buffer;
  CNFile closed, file("f", "wb+");
  const std::string names = " -> szFunction=F, szVariable=V";
  ExpectEach("CN", " -> return -1" + names,
             {buffer.Read("F", "V", nullptr, 1) == -1, buffer.Read("F", "V", bytes, -1) == -1,
              buffer.Write("F", "V", nullptr, 1) == -1, buffer.Write("F", "V", bytes, 0) == -1,
              buffer.Printf("F", "V", NOTHING) == -1, file.Write("F", "V", "", 1) == -1,
              closed.Write("F", "V", bytes, 1) == -1, closed.Printf("F", "V", "x") == -1,
              file.lRead("F", "V", nullptr, 1) == -1});
  ExpectEach("CN", " -> return NULL" + names,
             {!buffer.ReadLine("F", "V", 0), !file.ReadLine("F", "V", 0), !closed.ReadLine("F", "V", 1)});
  ExpectEach("CNFile::Open -> !", " -> return 0", {!closed.Open("f", ""), !closed.Open(nullptr, "rb")});
  ExpectEach("CNFile::CNFile(char *file, char *type) -> !", " -> return",
             {!CNFile("", "rb").bFileOpened(), !CNFile("f", "").bFileOpened()});
  Expect("ERROR: CNFile::Write -> lBufferLength<0 -> return -1" + names, file.Write("F", "V", bytes, 0) == -1);
  Expect("ERROR: CNFile::lRead -> lMaxReadBufferLength-> return -1" + names, file.lRead("F", "V", bytes, -1) == -1);
  Expect("ERROR: CNFile::lRead -> !m_File -> return 0", closed.lRead("F", "V", bytes, 1) == -1);
  Expect("ERROR: CNFile::lRead -> !m_File -> return 0", closed.lRead(csAll) == -1);
  Expect("ERROR: CNFile::lGetNumLines -> !m_File -> return -1", closed.lGetNumLines() == -1);
  Expect("ERROR: CNBuffer::Resize(long size) -> size<0L -> return", (buffer.Resize(-1), true));
}

TEST_F(RefusalTest, ConfigurationFiles) {
  const std::string content = "002\r\na=1\r\nbroken";
  m_folder.Write("config.ini", content);
  CNConfigFile config(nullptr), nowhere("missing/config.ini");
  CNString csValue("old", 0);
  char* const szNoBuffer = nullptr;
  const std::string invalid = " -> return PRECONDITIONS_NOT_VALID", closed = " -> return FILE_COULD_NOT_BE_OPEN";
  ExpectEach("CNConfigFile::i", "ConfigString -> !szKeyName || !*szKeyName" + invalid,
             {config.iReadConfigString("", csValue) == 1, config.iWriteConfigString(nullptr, "v") == 1,
              config.iRemoveConfigString("") == 1});
  ExpectEach("CNConfigFile::i", "ConfigString -> !szKeyValue" + invalid,
             {config.iReadConfigString("k", szNoBuffer) == 1, config.iWriteConfigString("k", nullptr) == 1});
  ExpectEach("CNConfigFile::i", "ConfigString -> !file.bFileOpened()" + closed,
             {nowhere.iReadConfigString("k", csValue) == 7, nowhere.iWriteConfigString("k", "v") == 7,
              nowhere.iRemoveConfigString("k") == 7});
  EXPECT_STREQ(csValue.Ptr(), "old");
  EXPECT_TRUE(config.iReadConfigString("a", csValue) == 0 && csValue.IsEqual("1")) << "before the broken line";
  ExpectEach("CNConfigFile::i", "ConfigString -> !'='(broken) -> return FUNCTION_ERROR",
             {config.iReadConfigString("b", csValue) == 9 && csValue.IsEqual(""),
              config.iWriteConfigString("a", "2") == 9, config.iRemoveConfigString("a") == 9});
  EXPECT_EQ(m_folder.Read("config.ini"), content);
}

TEST_F(RefusalTest, System) {
  m_folder.Write("file", "content");
  CNString csPath;
  CNStringArray names;
  int64_t value = -1;
  ExpectEach("CNSystem::CopyFile -> ", " -> return 0",
             {!CNSystem::CopyFile(nullptr, "to"), !CNSystem::CopyFile("file", ""),
              !CNSystem::CopyFile("file", m_folder.Path("file").c_str())});
  ExpectEach("CNSystem::CopyFile -> f==-1 || g==-1", " -> return 0",
             {!CNSystem::CopyFile("missing", "to"), !CNSystem::CopyFile("file", "no/folder")});
  const std::string exit = "EXIT: CNSystem::", invalid = " -> return PRECONDITIONS_NOT_VALID";
  const struct {
    std::string line;
    int iResult, iExpected;
  } exits[] = {
      {"GetCurrentDir-> (!pcsPath)" + invalid, CNSystem::GetCurrentDir(nullptr), 1},
      {"GetFileNameFromPath-> (!szFullPath || !*szFullPath)" + invalid, CNSystem::GetFileNameFromPath("", csPath), 1},
      {"SwapBackSlashToSlash-> (!szString || !*szString)" + invalid, CNSystem::SwapBackSlashToSlash(nullptr), 1},
      {"ListFListFilesAndFoldersiles-> (!szPath || !*szPath)" + invalid, CNSystem::ListFilesAndFolders("", &names), 1},
      {"ListFilesAndFolders-> (!parcsFileNames)" + invalid, CNSystem::ListFilesAndFolders(".", nullptr), 1},
      {"ListFolders-> (!szPath || !*szPath)" + invalid, CNSystem::ListFolders(nullptr, &names), 1},
      {"ListFolders-> (!parcsFolderNames)" + invalid, CNSystem::ListFolders(".", nullptr), 1},
      {"GetSize-> (!szPath)" + invalid, CNSystem::GetSize(nullptr, &value), 1},
      {"GetSize-> (!i64Size)" + invalid, CNSystem::GetSize("file", nullptr), 1},
      {"GetSize-> return FUNCTION_ERROR", CNSystem::GetSize("missing", &value), 9},
      {"GetFileCreationTime-> (!szPath)" + invalid, CNSystem::GetFileCreationTime(nullptr, &value), 1},
      {"GetFileCreationTime-> (!i64Size)" + invalid, CNSystem::GetFileCreationTime("file", nullptr), 1},
      {"GetFileCreationTime-> return FUNCTION_ERROR", CNSystem::GetFileCreationTime("missing", &value), 9},
      {"bExistFile-> (!szPath || !*szPath) -> return FALSE", CNSystem::bExistFile(""), 0},
  };
  std::vector<std::string> lines;
  for (const auto& row : exits) {
    EXPECT_EQ(row.iResult, row.iExpected) << row.line;
    lines.push_back(exit + row.line);
  }
  EXPECT_EQ(m_log.Lines(), lines);
  m_log.Clear();
  Expect("ENTER: CNSystem::CopyAll -> !SrcDir || !*SrcDir -> return 0", !CNSystem::CopyAll("", "to"));
  Expect("ENTER: CNSystem::CopyAll -> !DstDir || !*DstDir -> return 0", !CNSystem::CopyAll("from", nullptr));
  Expect("ERROR: CNSystem::CopyAll -> _findfirst()==-1, SrcDir=missing -> return -1",
         !CNSystem::CopyAll("missing", "."));
  for (const char* szPath : {NOTHING, "", "/", "C:\\", "c:", ".", "kept\\..", "kept/./"})
    EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders(szPath), 1) << szPath;
  EXPECT_EQ(m_log.Lines().size(), 8u);
  m_log.Clear();
  for (const char* szPath : {"missing", "file"})
    Expect("ERROR: CNSystem::iDeleteFolderAndSubFolders -> iDeleteFolderAndSubFolders -> return FUNCTION_ERROR",
           CNSystem::iDeleteFolderAndSubFolders(szPath) == 9);
  EXPECT_EQ(m_folder.Names(), (std::vector<std::string>{"execution.log", "file"}));
  EXPECT_EQ(m_folder.Read("file"), "content");
  EXPECT_TRUE(value == -1 && names.Size() == 0);
}

TEST_F(RefusalTest, SocketErrors) {
  char szText[] = "untouched";
  ExpectEach("WSAGetLastErrorString -> ", " -> return PRECONDITIONS_NOT_VALID",
             {WSAGetLastErrorString(nullptr, 10) == 1, WSAGetLastErrorString(szText, 0) == 1});
  EXPECT_STREQ(szText, "untouched");
  Expect("ERROR: WSAGetLastErrorString -> !szErrorString || !*szErrorString -> return POSTCONDITIONS_NOT_VALID",
         WSAGetLastErrorString(szText, 1) == 2);
}
