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
  Lines List(const std::string& folder, const char* szPattern, bool bFoldersOnly = false) const {
    CNStringArray names;
    const auto list = bFoldersOnly ? CNSystem::ListFolders : CNSystem::ListFilesAndFolders;
    EXPECT_EQ(list(folder.c_str(), &names, szPattern), 0);
    Lines sorted;
    for (int i = 0; i < names.Size(); i++) sorted.push_back(names[i]->Text());
    std::sort(sorted.begin(), sorted.end());
    return sorted;
  }
  TestFolder m_folder;
  TestLog m_log{m_folder};
};

std::string FileName(const char* szPath) {
  CNString csName("old", 0);
  EXPECT_EQ(CNSystem::GetFileNameFromPath(szPath, csName), 0);
  return csName.Text();
}

}  // namespace

TEST_F(CNSystemTest, CopiesATree) {
  std::string content(250001, 'x');
  for (size_t i = 0; i < content.size(); i++) content[i] = char(i * 31 >> 3);
  for (const char* szName : {"from/sub/deep", "from/empty", "to/sub"}) m_folder.MakeFolder(szName);
  m_folder.Write("from/a \x9A", content);
  m_folder.Write("from/sub/deep/c.txt", "C");
  m_folder.Write("to/a \x9A", std::string(400000, 'o'));
  m_folder.Write("to/kept", "kept");
  EXPECT_EQ(CNSystem::CopyAll("from", Path("to").c_str()), 1);
  EXPECT_EQ(m_log.Lines(), Lines{});
  EXPECT_EQ(m_folder.Names("to"), (Lines{"a \x9A", "empty", "kept", "sub"}));
  EXPECT_TRUE(m_folder.Read("to/a \x9A") == content) << "what was longer is cut";
  EXPECT_EQ(m_folder.Read("to/sub/deep/c.txt"), "C");
  EXPECT_EQ(m_folder.Names("to/empty"), Lines{});
}

TEST_F(CNSystemTest, CopyAllGoesOnBehindWhatFailsAndEnds) {
  m_folder.MakeFolder("from/backup");
  m_folder.MakeFolder("from/taken");
  m_folder.Write("from/x", "X");
  m_folder.Write("from/backup/taken", "a file where a folder should be");
  EXPECT_EQ(CNSystem::CopyAll("from", "from/backup"), 1) << "into itself";
  EXPECT_EQ(m_folder.Names("from/backup"), (Lines{"taken", "x"}));
  Lines lines = m_log.Lines();
  std::sort(lines.begin(), lines.end());
  EXPECT_EQ(lines, (Lines{"ERROR: CNSystem::CopyAll -> !OsMakeFolder(from/backup\\taken)",
                          "INFO: CNSystem::CopyAll -> from\\backup is not copied"}));
}

TEST_F(CNSystemTest, PathsOfTheProgramAndTheCurrentFolder) {
  CNString csPath, csProgram;
  ASSERT_EQ(CNSystem::GetCurrentApplicationDir(csPath), 0);
  EXPECT_TRUE(csPath.EndsWith("\\"));
  ASSERT_TRUE(bOsGetProgramPath(csProgram));
  EXPECT_TRUE(bOsIsSameFile((csPath.Text() + FileName(csProgram.Text())).c_str(), csProgram.Text()));
  ASSERT_EQ(CNSystem::GetCurrentDir(&csPath), 0);
  EXPECT_TRUE(csPath.EndsWith("/") && !csPath.EndsWith("//") && !csPath.EndsWith("\\/"));
  EXPECT_TRUE(bOsIsSameFile(csPath.Text(), m_folder.Root().c_str()));
}

TEST_F(CNSystemTest, PartsOfPaths) {
  EXPECT_EQ(FileName("C:\\dir/x.dat"), "x.dat");
  EXPECT_EQ(FileName("a/b\\c"), "c");
  EXPECT_EQ(FileName("plain"), "plain");
  EXPECT_EQ(FileName("C:\\dir\\"), "");
  CNString csPath("one/two", 0);
  EXPECT_EQ(CNSystem::GetFileNameFromPath(csPath.Text(), csPath), 0);
  EXPECT_STREQ(csPath.Text(), "two") << "the path's own text as the result";
  char szPath[] = "\\a\\b/c\\";
  EXPECT_EQ(CNSystem::SwapBackSlashToSlash(szPath), 0);
  EXPECT_STREQ(szPath, "/a/b/c/");
}

TEST_F(CNSystemTest, ListsWhatMatches) {
  m_folder.MakeFolder("list/One.d");
  m_folder.MakeFolder("list/two");
  m_folder.Write("list/a.txt", "");
  m_folder.Write("list/B.TXT", "");
  m_folder.Write("list/two/inside", "");
  EXPECT_EQ(List("list", ""), (Lines{".", "..", "B.TXT", "One.d", "a.txt", "two"}));
  EXPECT_EQ(List("list/", ".txt"), (Lines{"B.TXT", "a.txt"}));
  EXPECT_EQ(List(Path("list\\"), "O"), Lines{"two"}) << "anything may stand before the pattern";
  EXPECT_EQ(List("list", "*", true), (Lines{"One.d", "two"}));
  EXPECT_EQ(List("list", "o*", true), Lines{"One.d"});
  EXPECT_EQ(List("list", "a.txt", true), Lines{}) << "a file";
  EXPECT_EQ(List(m_folder.Root(), "list/*", true), (Lines{"One.d", "two"}));
  EXPECT_EQ(m_log.Lines(), Lines{});

  CNStringArray names;
  EXPECT_EQ(CNSystem::ListFilesAndFolders("missing", &names), 0);
  EXPECT_EQ(CNSystem::ListFolders("missing", &names), 0);
  EXPECT_EQ(CNSystem::ListFilesAndFolders(".", &names, "no such name"), 0);
  EXPECT_EQ(names.Size(), 0);
}

TEST_F(CNSystemTest, RemovesAFolderWithAllItHolds) {
  m_folder.MakeFolder("gone/sub/deep");
  m_folder.Write("gone/run.exe", "");
  m_folder.Write("gone/sub/read only.dll", "");
  m_folder.Write("gone/sub/deep/file", "");
  bOsSetAttributes(Path("gone/sub/read only.dll").c_str(), OS_READ_ONLY);
#ifdef _WIN32
  {
    OsFile use;
    ASSERT_TRUE(use.bOpen(Path("gone/run.exe").c_str(), OsOpenMode::Truncate));
    EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("gone"), 9);
    EXPECT_TRUE(m_folder.Exists("gone/sub/deep/file")) << "a program in use";
    m_log.Clear();
  }
#endif
  EXPECT_EQ(CNSystem::iDeleteFolderAndSubFolders("gone/"), 0);
  EXPECT_EQ(m_log.Lines(), Lines{});
}

#ifndef _WIN32
TEST_F(CNSystemTest, LinksAreNotFollowedIntoFolders) {
  for (const char* szName : {"outside", "from", "to"}) m_folder.MakeFolder(szName);
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
  int64_t size = -1, time = -1;
  EXPECT_EQ(CNSystem::GetSize("file", &size), 0);
  EXPECT_EQ(size, 5);
  EXPECT_EQ(CNSystem::GetFileCreationTime("file", &time), 0);
  EXPECT_GT(time, 125911584000000000) << "2000-01-01";
  EXPECT_TRUE(CNSystem::bExistFile("file") && CNSystem::bExistFile(m_folder.Root().c_str()));
  EXPECT_FALSE(CNSystem::bExistFile("missing"));
}
