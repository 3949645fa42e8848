#ifdef _WIN32
#include <windows.h>  // has a macro CopyFile
#endif

#include "foundation/CNSystem.h"
#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

class CNSystemTest : public testing::Test {
 protected:
  std::string Path(const std::string& name) const { return m_folder.Path(name); }
  // What a listing adds, sorted.
  Lines List(const std::string& folder, const char* szPattern, bool bFoldersOnly) const {
    CNStringArray names;
    const auto list = bFoldersOnly ? CNSystem::ListFolders : CNSystem::ListFilesAndFolders;
    EXPECT_EQ(list(folder.c_str(), &names, szPattern), 0);
    Lines sorted;
    for (int i = 0; i < names.Size(); i++) sorted.push_back(names[i]->Text());
    std::sort(sorted.begin(), sorted.end());
    return sorted;
  }
  Lines All(const std::string& folder, const char* szPattern) const { return List(folder, szPattern, false); }
  Lines Folders(const std::string& folder, const char* szPattern) const { return List(folder, szPattern, true); }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

std::string FileName(const char* szPath) {
  CNString csName("old", 0);
  EXPECT_EQ(CNSystem::GetFileNameFromPath(szPath, csName), 0);
  return csName.Text();
}

}  // namespace

TEST_F(CNSystemTest, CopiesAFile) {
  std::string content(250001, 'x');
  for (size_t i = 0; i < content.size(); i++) content[i] = char(i * 31 >> 3);
  m_folder.Write("from", content);
  m_folder.Write("to \x9A", std::string(400000, 'o'));
  EXPECT_EQ(CNSystem::CopyFile(Path("from").c_str(), Path("to \x9A").c_str()), 1);
  EXPECT_EQ(m_folder.Read("to \x9A"), content) << "what was longer is cut";
  m_folder.Write("empty", "");
  EXPECT_EQ(CNSystem::CopyFile(Path("empty").c_str(), Path("new").c_str()), 1);
  EXPECT_EQ(m_folder.Read("new"), "");
  EXPECT_EQ(m_log.Lines(), Lines{});
}

TEST_F(CNSystemTest, CopyFileRefusesAndReports) {
  m_folder.Write("file", "content");
  EXPECT_EQ(CNSystem::CopyFile(nullptr, "to"), 0);
  EXPECT_EQ(CNSystem::CopyFile("file", ""), 0);
  EXPECT_EQ(CNSystem::CopyFile("missing", "to"), 0);
  EXPECT_EQ(CNSystem::CopyFile("file", "no/folder"), 0);
  EXPECT_EQ(CNSystem::CopyFile("file", Path("file").c_str()), 0);
  const std::string failed = "ERROR: CNSystem::CopyFile -> f==-1 || g==-1 -> return 0";
  EXPECT_EQ(m_log.Lines(), (Lines{"ERROR: CNSystem::CopyFile -> !SrcFile || !*SrcFile -> return 0",
                                  "ERROR: CNSystem::CopyFile -> !DestFile || !*DestFile -> return 0", failed, failed,
                                  "ERROR: CNSystem::CopyFile -> f==g -> return 0"}));
  EXPECT_EQ(m_folder.Read("file"), "content") << "a file copied onto itself";
  EXPECT_EQ(m_folder.Names(), (Lines{"execution.log", "file"})) << "no destination without a source";
}

TEST_F(CNSystemTest, CopiesATree) {
  m_folder.MakeFolder("from/sub/deep");
  m_folder.MakeFolder("from/empty");
  m_folder.MakeFolder("to/sub");
  m_folder.Write("from/a.txt", "A");
  m_folder.Write("from/sub/b.txt", "B");
  m_folder.Write("from/sub/deep/c.txt", "C");
  m_folder.Write("to/a.txt", "old");
  m_folder.Write("to/kept", "kept");
  EXPECT_EQ(CNSystem::CopyAll("from", Path("to").c_str()), 1);
  EXPECT_EQ(m_log.Lines(), Lines{});
  EXPECT_EQ(m_folder.Names("to"), (Lines{"a.txt", "empty", "kept", "sub"}));
  EXPECT_EQ(m_folder.Read("to/a.txt"), "A");
  EXPECT_EQ(m_folder.Read("to/sub/b.txt"), "B");
  EXPECT_EQ(m_folder.Read("to/sub/deep/c.txt"), "C");
  EXPECT_EQ(m_folder.Names("to/empty"), Lines{});
}

TEST_F(CNSystemTest, CopyAllGoesOnBehindWhatFailsAndEnds) {
  m_folder.MakeFolder("from/backup");
  m_folder.MakeFolder("from/taken");
  m_folder.Write("from/taken/inside", "");
  m_folder.Write("from/x", "X");
  m_folder.Write("from/backup/taken", "a file where a folder should be");
  EXPECT_EQ(CNSystem::CopyAll("from", "from/backup"), 1) << "into itself";
  EXPECT_EQ(m_folder.Names("from/backup"), (Lines{"taken", "x"}));
  Lines lines = m_log.Lines();
  std::sort(lines.begin(), lines.end());
  EXPECT_EQ(lines, (Lines{"ERROR: CNSystem::CopyAll -> !OsMakeFolder(from/backup\\taken)",
                          "INFO: CNSystem::CopyAll -> from\\backup is not copied"}));
  m_log.Clear();
  EXPECT_EQ(CNSystem::CopyAll("", "to"), 0);
  EXPECT_EQ(CNSystem::CopyAll("from", nullptr), 0);
  EXPECT_EQ(CNSystem::CopyAll("missing", "from"), 0);
  EXPECT_EQ(m_log.Lines(), (Lines{"ENTER: CNSystem::CopyAll -> !SrcDir || !*SrcDir -> return 0",
                                  "ENTER: CNSystem::CopyAll -> !DstDir || !*DstDir -> return 0",
                                  "ERROR: CNSystem::CopyAll -> _findfirst()==-1, SrcDir=missing -> return -1"}));
}

TEST_F(CNSystemTest, PathsOfTheProgramAndTheCurrentFolder) {
  CNString csPath;
  ASSERT_EQ(CNSystem::GetCurrentApplicationDir(csPath), 0);
  EXPECT_TRUE(csPath.EndsWith("\\"));
  EXPECT_TRUE(bOsIsFolder(csPath.Text()));
  CNString csProgram;
  ASSERT_TRUE(bOsGetProgramPath(csProgram));
  EXPECT_TRUE(bOsIsSameFile((csPath.Text() + FileName(csProgram.Text())).c_str(), csProgram.Text()));
  ASSERT_EQ(CNSystem::GetCurrentDir(&csPath), 0);
  EXPECT_TRUE(csPath.EndsWith("/") && !csPath.EndsWith("//") && !csPath.EndsWith("\\/"));
  EXPECT_TRUE(bOsIsSameFile(csPath.Text(), m_folder.Root().c_str()));
  EXPECT_EQ(CNSystem::GetCurrentDir(nullptr), 1);
  EXPECT_EQ(m_log.Lines(), Lines{"EXIT: CNSystem::GetCurrentDir-> (!pcsPath) -> return PRECONDITIONS_NOT_VALID"});
}

TEST_F(CNSystemTest, PartsOfPaths) {
  EXPECT_EQ(FileName("C:\\dir/x.dat"), "x.dat");
  EXPECT_EQ(FileName("a/b\\c"), "c");
  EXPECT_EQ(FileName("plain"), "plain");
  EXPECT_EQ(FileName("C:\\dir\\"), "");
  CNString csPath("one/two", 0);
  EXPECT_EQ(CNSystem::GetFileNameFromPath(csPath.Text(), csPath), 0);
  EXPECT_STREQ(csPath.Text(), "two") << "the path's own text as the result";
  EXPECT_EQ(CNSystem::GetFileNameFromPath("", csPath), 1);
  char szPath[] = "\\a\\b/c\\";
  EXPECT_EQ(CNSystem::SwapBackSlashToSlash(szPath), 0);
  EXPECT_STREQ(szPath, "/a/b/c/");
  EXPECT_EQ(CNSystem::SwapBackSlashToSlash(nullptr), 1);
  m_folder.Write("there", "");
  EXPECT_EQ(CNSystem::bExistFile("there"), 1);
  EXPECT_EQ(CNSystem::bExistFile(m_folder.Root().c_str()), 1);
  EXPECT_EQ(CNSystem::bExistFile("missing"), 0);
  EXPECT_EQ(CNSystem::bExistFile(""), 0);
  const std::string start = "EXIT: CNSystem::";
  EXPECT_EQ(m_log.Lines(),
            (Lines{start + "GetFileNameFromPath-> (!szFullPath || !*szFullPath) -> return PRECONDITIONS_NOT_VALID",
                   start + "SwapBackSlashToSlash-> (!szString || !*szString) -> return PRECONDITIONS_NOT_VALID",
                   start + "bExistFile-> (!szPath || !*szPath) -> return FALSE"}));
}

TEST_F(CNSystemTest, ListsWhatMatches) {
  m_folder.MakeFolder("list/One.d");
  m_folder.MakeFolder("list/two");
  m_folder.Write("list/a.txt", "");
  m_folder.Write("list/B.TXT", "");
  m_folder.Write("list/two/inside", "");
  EXPECT_EQ(All("list", ""), (Lines{".", "..", "B.TXT", "One.d", "a.txt", "two"}));
  EXPECT_EQ(All("list/", ".txt"), (Lines{"B.TXT", "a.txt"}));
  EXPECT_EQ(All(Path("list\\"), "O"), Lines{"two"}) << "anything may stand before the pattern";
  EXPECT_EQ(All("list/two", nullptr), (Lines{".", "..", "inside"}));
  EXPECT_EQ(Folders("list", "*"), (Lines{"One.d", "two"}));
  EXPECT_EQ(Folders("list", "*.*"), (Lines{"One.d", "two"}));
  EXPECT_EQ(Folders("list", "o*"), Lines{"One.d"});
  EXPECT_EQ(Folders("list", "a.txt"), Lines{}) << "a file";
  EXPECT_EQ(Folders(m_folder.Root(), "list/*"), (Lines{"One.d", "two"}));
  EXPECT_EQ(m_log.Lines(), Lines{});
}

TEST_F(CNSystemTest, AListOfNothingChangesNothing) {
  CNStringArray names;
  names.Add("kept", 1);
  EXPECT_EQ(CNSystem::ListFilesAndFolders("missing", &names), 0);
  EXPECT_EQ(CNSystem::ListFolders("missing", &names), 0);
  EXPECT_EQ(CNSystem::ListFilesAndFolders(".", &names, "no such name"), 0);
  EXPECT_EQ(CNSystem::ListFilesAndFolders("", &names), 1);
  EXPECT_EQ(CNSystem::ListFilesAndFolders(".", nullptr), 1);
  EXPECT_EQ(CNSystem::ListFolders(nullptr, &names), 1);
  EXPECT_EQ(CNSystem::ListFolders(".", nullptr), 1);
  EXPECT_EQ(names.Size(), 1);
  const std::string start = "EXIT: CNSystem::", end = " -> return PRECONDITIONS_NOT_VALID";
  EXPECT_EQ(m_log.Lines(), (Lines{start + "ListFListFilesAndFoldersiles-> (!szPath || !*szPath)" + end,
                                  start + "ListFilesAndFolders-> (!parcsFileNames)" + end,
                                  start + "ListFolders-> (!szPath || !*szPath)" + end,
                                  start + "ListFolders-> (!parcsFolderNames)" + end}));
}

TEST_F(CNSystemTest, RemovesAFolderWithAllItHolds) {
  m_folder.MakeFolder("gone/sub/deep");
  m_folder.Write("gone/run.exe", "");
  m_folder.Write("gone/sub/read only.dll", "");
  m_folder.Write("gone/sub/deep/file", "");
  bOsSetAttributes(Path("gone/sub/read only.dll").c_str(), OS_READ_ONLY);
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("gone/"), 0);
  EXPECT_FALSE(m_folder.Exists("gone"));
  EXPECT_EQ(m_log.Lines(), Lines{});
}

TEST_F(CNSystemTest, RefusesToRemoveWhatIsNoFolder) {
  m_folder.MakeFolder("kept");
  m_folder.Write("file", "");
  for (const char* szPath : {"", "/", "C:\\", "c:", ".", "kept\\..", "kept/./"})
    EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders(szPath), 1) << szPath;
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders(nullptr), 1);
  EXPECT_EQ(m_log.Lines().size(), 8u);
  m_log.Clear();
  const std::string line =
      "ERROR: CNSystem::iDeleteFolderAndSubFolders -> iDeleteFolderAndSubFolders -> return FUNCTION_ERROR";
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("missing"), 9);
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("file"), 9);
  EXPECT_EQ(m_log.Lines(), (Lines{line, line}));
  EXPECT_EQ(m_folder.Names(), (Lines{"execution.log", "file", "kept"}));
}

#ifdef _WIN32
TEST_F(CNSystemTest, RemovesNothingWhileAProgramIsInUse) {
  m_folder.MakeFolder("kept/sub");
  m_folder.Write("kept/a", "");
  m_folder.Write("kept/sub/used.DLL", "");
  bOsSetAttributes(Path("kept/a").c_str(), OS_READ_ONLY);
  {
    OsFile use;
    ASSERT_TRUE(use.bOpen(Path("kept/sub/used.DLL").c_str(), OsOpenMode::Truncate));
    EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("kept"), 9);
  }
  EXPECT_TRUE(m_folder.Exists("kept/a"));
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("kept"), 0);
}
#else
TEST_F(CNSystemTest, LinksAreNotFollowedIntoFolders) {
  m_folder.MakeFolder("outside");
  m_folder.MakeFolder("from");
  m_folder.MakeFolder("to");
  m_folder.Write("outside/file", "12345");
  std::filesystem::create_directory_symlink(Path("outside"), Path("from/folder link"));
  std::filesystem::create_symlink(Path("outside/file"), Path("from/file link"));
  int64_t size = 0;
  EXPECT_EQ(CNSystem::GetSize(Path("from/file link").c_str(), &size), 0);
  EXPECT_EQ(size, 5);
  EXPECT_EQ(CNSystem::CopyFile("from/file link", "outside/file"), 0) << "the same file by another name";
  EXPECT_EQ(CNSystem::CopyAll("from", "to"), 1);
  EXPECT_EQ(m_folder.Names("to"), Lines{"file link"});
  EXPECT_EQ(m_folder.Read("to/file link"), "12345");
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("from/folder link"), 0);
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("from"), 0);
  EXPECT_EQ(m_folder.Names("outside"), Lines{"file"});
}
#endif

TEST_F(CNSystemTest, SizeAndTimeOfCreation) {
  m_folder.Write("file", "12345");
  int64_t value = -1;
  EXPECT_EQ(CNSystem::GetSize("file", &value), 0);
  EXPECT_EQ(value, 5);
  EXPECT_EQ(CNSystem::GetFileCreationTime("file", &value), 0);
  EXPECT_GT(value, 125911584000000000) << "2000-01-01";
  value = -1;
  EXPECT_EQ(CNSystem::GetSize("missing", &value), 9);
  EXPECT_EQ(CNSystem::GetFileCreationTime("missing", &value), 9);
  EXPECT_EQ(CNSystem::GetSize(nullptr, &value), 1);
  EXPECT_EQ(CNSystem::GetSize("file", nullptr), 1);
  EXPECT_EQ(CNSystem::GetFileCreationTime(nullptr, &value), 1);
  EXPECT_EQ(CNSystem::GetFileCreationTime("file", nullptr), 1);
  EXPECT_EQ(value, -1);
  const std::string start = "EXIT: CNSystem::", end = "-> return FUNCTION_ERROR",
                    invalid = " -> return PRECONDITIONS_NOT_VALID";
  EXPECT_EQ(m_log.Lines(), (Lines{start + "GetSize" + end, start + "GetFileCreationTime" + end,
                                  start + "GetSize-> (!szPath)" + invalid, start + "GetSize-> (!i64Size)" + invalid,
                                  start + "GetFileCreationTime-> (!szPath)" + invalid,
                                  start + "GetFileCreationTime-> (!i64Size)" + invalid}));
}
