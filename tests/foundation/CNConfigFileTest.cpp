#include "foundation/CNConfigFile.h"

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

class CNConfigFileTest : public testing::Test {
 protected:
  std::string Path() const { return m_folder.Path("test.ini"); }
  std::string Content() const { return m_folder.Read("test.ini"); }
  std::string Value(const char* szKey) const {
    CNConfigFile config(Path().c_str());
    CNString csValue("old", 0);
    const int iResult = config.iReadConfigString(szKey, csValue);
    return std::to_string(iResult) + ":" + csValue.Text();
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(CNConfigFileTest, WritesTheCountAndEntriesWithoutALastLineEnd) {
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(Content(), "");
  EXPECT_EQ(config.iWriteConfigString("first", "1"), 0);
  EXPECT_EQ(Content(), "001\r\nfirst=1");
  EXPECT_EQ(config.iWriteConfigString("second", "a=b=c"), 0);
  EXPECT_EQ(config.iWriteConfigString("First", "\xE8"), 0);
  EXPECT_EQ(config.iWriteConfigString("first", "changed"), 0);
  EXPECT_EQ(Content(), "003\r\nfirst=changed\r\nsecond=a=b=c\r\nFirst=\xE8");
  EXPECT_EQ(Value("second"), "0:a=b=c");
  EXPECT_EQ(Value("firs"), "0:");
  EXPECT_EQ(m_log.Lines(), Lines{});
  EXPECT_EQ(m_folder.Names(), (Lines{"execution.log", "test.ini"})) << "nothing is left beside the file";
}

TEST_F(CNConfigFileTest, ReadsIntoACallersBuffer) {
  m_folder.Write("test.ini", "002\r\na=1\r\nlong=" + std::string(4088, 'x'));
  CNConfigFile config(Path().c_str());
  char value[4094];
  EXPECT_EQ(config.iReadConfigString("long", value), 0);
  EXPECT_EQ(value, std::string(4088, 'x'));
  EXPECT_EQ(config.iReadConfigString("missing", value), 0);
  EXPECT_STREQ(value, "");
}

TEST_F(CNConfigFileTest, RemovesEntries) {
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iRemoveConfigString("none"), 0) << "a file without content";
  EXPECT_EQ(Content(), "");
  for (const char* szKey : {"a", "b", "c"}) config.iWriteConfigString(szKey, szKey);
  EXPECT_EQ(config.iRemoveConfigString("missing"), 0);
  EXPECT_EQ(Content(), "003\r\na=a\r\nb=b\r\nc=c");
  EXPECT_EQ(config.iRemoveConfigString("a"), 0);
  EXPECT_EQ(Content(), "002\r\nb=b\r\nc=c");
  EXPECT_EQ(config.iRemoveConfigString("c"), 0);
  EXPECT_EQ(Content(), "001\r\nb=b\r\n") << "the line before a removed last one keeps its line end";
  EXPECT_EQ(config.iWriteConfigString("d", "d"), 0);
  EXPECT_EQ(Content(), "002\r\nb=b\r\nd=d");
}

TEST_F(CNConfigFileTest, StaysUsableWhenTheLastEntryIsGone) {
  CNConfigFile config(Path().c_str());
  config.iWriteConfigString("a", "1");
  config.iRemoveConfigString("a");
  EXPECT_EQ(Content(), "000\r\n");
  EXPECT_EQ(Value("a"), "0:");
  EXPECT_EQ(config.iWriteConfigString("b", "2"), 0);
  EXPECT_EQ(Content(), "001\r\nb=2");
  EXPECT_EQ(Value("b"), "0:2");
}

TEST_F(CNConfigFileTest, SuspiciousValuesAreLoggedAndWritten) {
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iWriteConfigString("k", ""), 0);
  EXPECT_EQ(config.iWriteConfigString("k", "\xCC\xCC"), 0);
  EXPECT_EQ(m_log.Lines(), (Lines{"ERROR: CNConfigFile::iWriteConfigString -> !*szKeyValue == 0",
                                  "ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue == \xCC\xCC"}));
  m_log.Clear();
  EXPECT_EQ(config.iWriteConfigString("k", std::string(300, 'v').c_str()), 0);
  EXPECT_EQ(m_log.Lines(), Lines(45, "ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue length > 255"));
  EXPECT_EQ(Value("k"), "0:" + std::string(300, 'v'));
}

TEST_F(CNConfigFileTest, AMalformedLineStopsEverythingAndChangesNothing) {
  const std::string content = "002\r\na=1\r\nbroken";
  m_folder.Write("test.ini", content);
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(Value("a"), "0:1") << "found before the broken line";
  EXPECT_EQ(Value("b"), "9:");
  EXPECT_EQ(config.iWriteConfigString("a", "2"), 9);
  EXPECT_EQ(config.iRemoveConfigString("a"), 9);
  EXPECT_EQ(Content(), content);
  EXPECT_EQ(m_log.Lines(),
            (Lines{"ERROR: CNConfigFile::iReadConfigString -> !'='(broken) -> return FUNCTION_ERROR",
                   "ERROR: CNConfigFile::iWriteConfigString -> !'='(broken) -> return FUNCTION_ERROR",
                   "ERROR: CNConfigFile::iRemoveConfigString -> !'='(broken) -> return FUNCTION_ERROR"}));
}

TEST_F(CNConfigFileTest, ManyEntriesKeepThreeDigitsOfTheCount) {
  std::string content = "999";
  for (int i = 1; i < 1000; i++) content += "\r\nk" + std::to_string(i) + "=v";
  m_folder.Write("test.ini", content);
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iWriteConfigString("new", "v"), 0);
  EXPECT_EQ(Content(), "100" + content.substr(3) + "\r\nnew=v");
}

TEST_F(CNConfigFileTest, AShortCountLineCostsNoEntry) {
  m_folder.Write("test.ini", "1\na=1");
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iWriteConfigString("b", "2"), 0);
  EXPECT_EQ(Content(), "002\r\na=1\r\nb=2");
}

TEST_F(CNConfigFileTest, IsWrittenInPlaceWhereNoSecondFileCanBeMade) {
  m_folder.MakeFolder("test.ini.new");
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iWriteConfigString("a", "1"), 0);
  EXPECT_EQ(config.iWriteConfigString("a", "2"), 0);
  EXPECT_EQ(Content(), "001\r\na=2");
  EXPECT_EQ(m_log.Lines(), Lines{});
}

#ifndef _WIN32
TEST_F(CNConfigFileTest, AFullDiskLeavesTheOldContent) {
  CNConfigFile config(Path().c_str());
  EXPECT_EQ(config.iWriteConfigString("a", "1"), 0);
  std::filesystem::create_symlink("/dev/full", Path() + ".new");
  EXPECT_EQ(config.iWriteConfigString("a", "2"), 9);
  EXPECT_EQ(Content(), "001\r\na=1");
  EXPECT_EQ(m_log.Lines(), Lines{"ERROR: CNConfigFile::iWriteConfigString -> !csBuffer.bReplace(" + Path() +
                                 ") -> return FUNCTION_ERROR"});
}
#endif

TEST_F(CNConfigFileTest, BadArgumentsAndMissingFiles) {
  CNConfigFile config(Path().c_str()), nowhere(m_folder.Path("missing/test.ini").c_str());
  CNString csValue("old", 0);
  EXPECT_EQ(config.iReadConfigString("", csValue), 1);
  EXPECT_EQ(config.iReadConfigString("k", static_cast<char*>(nullptr)), 1);
  EXPECT_EQ(config.iWriteConfigString(nullptr, "v"), 1);
  EXPECT_EQ(config.iWriteConfigString("k", nullptr), 1);
  EXPECT_EQ(config.iRemoveConfigString(""), 1);
  EXPECT_EQ(nowhere.iReadConfigString("k", csValue), 7);
  EXPECT_EQ(nowhere.iWriteConfigString("k", "v"), 7);
  EXPECT_EQ(nowhere.iRemoveConfigString("k"), 7);
  EXPECT_STREQ(csValue.Ptr(), "old");
  const std::string start = "ERROR: CNConfigFile::";
  EXPECT_EQ(m_log.Lines(),
            (Lines{start + "iReadConfigString -> !szKeyName || !*szKeyName -> return PRECONDITIONS_NOT_VALID",
                   start + "iReadConfigString -> !szKeyValue -> return PRECONDITIONS_NOT_VALID",
                   start + "iWriteConfigString -> !szKeyName || !*szKeyName -> return PRECONDITIONS_NOT_VALID",
                   start + "iWriteConfigString -> !szKeyValue -> return PRECONDITIONS_NOT_VALID",
                   start + "iRemoveConfigString -> !szKeyName || !*szKeyName -> return PRECONDITIONS_NOT_VALID",
                   start + "iReadConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN",
                   start + "iWriteConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN",
                   start + "iRemoveConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN"}));
}

TEST_F(CNConfigFileTest, UsesConfigIniWithoutAName) {
  CNConfigFile config("");
  EXPECT_EQ(config.iWriteConfigString("k", "v"), 0);
  EXPECT_EQ(m_folder.Read("config.ini"), "001\r\nk=v");
}
