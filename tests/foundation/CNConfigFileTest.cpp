#include "foundation/CNConfigFile.h"

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

class CNConfigFileTest : public testing::Test {
 protected:
  std::string Path() const { return m_folder.Path("test.ini"); }
  std::string Content() const { return m_folder.Read("test.ini"); }
  int iWrite(const char* szKey, const char* szValue) const {
    return CNConfigFile(Path().c_str()).iWriteConfigString(szKey, szValue);
  }
  int iRemove(const char* szKey) const { return CNConfigFile(Path().c_str()).iRemoveConfigString(szKey); }
  std::string Value(const char* szKey) const {
    CNString csValue("old", 0);
    const int iResult = CNConfigFile(Path().c_str()).iReadConfigString(szKey, csValue);
    return std::to_string(iResult) + ":" + csValue.Text();
  }
  TestFolder m_folder;
  TestLog m_log{m_folder};
};

}  // namespace

TEST_F(CNConfigFileTest, WritesReadsAndRemoves) {
  CNConfigFile created(Path().c_str());
  EXPECT_EQ(iRemove("none"), 0);
  EXPECT_EQ(Content(), "") << "a file without content";
  const struct {
    const char *szKey, *szValue, *szContent;  // no value: removed
  } rows[] = {
      {"first", "1", "001\r\nfirst=1"},
      {"second", "a=b=c", "002\r\nfirst=1\r\nsecond=a=b=c"},
      {"First", "\xE8", "003\r\nfirst=1\r\nsecond=a=b=c\r\nFirst=\xE8"},
      {"first", "changed", "003\r\nfirst=changed\r\nsecond=a=b=c\r\nFirst=\xE8"},
      {"missing", nullptr, "003\r\nfirst=changed\r\nsecond=a=b=c\r\nFirst=\xE8"},
      {"first", nullptr, "002\r\nsecond=a=b=c\r\nFirst=\xE8"},
      {"First", nullptr, "001\r\nsecond=a=b=c\r\n"},  // the line before a removed last one keeps its line end
      {"second", nullptr, "000\r\n"},
      {"again", "2", "001\r\nagain=2"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(row.szValue ? iWrite(row.szKey, row.szValue) : iRemove(row.szKey), 0);
    EXPECT_EQ(Content(), row.szContent);
    EXPECT_EQ(Value(row.szKey), std::string("0:") + (row.szValue ? row.szValue : ""));
  }
  EXPECT_EQ(Value("agai"), "0:");
  EXPECT_EQ(m_log.Lines(), Lines{});
  EXPECT_EQ(m_folder.Names(), (Lines{"execution.log", "test.ini"})) << "nothing is left beside the file";
  EXPECT_EQ(CNConfigFile("").iWriteConfigString("k", "v"), 0);
  EXPECT_EQ(m_folder.Read("config.ini"), "001\r\nk=v") << "the name without a name";
}

TEST_F(CNConfigFileTest, FilesOfOtherHands) {
  std::string many = "999";
  for (int i = 1; i < 1000; i++) many += "\r\nk" + std::to_string(i) + "=v";
  const std::string longest(4086, 'x');  // with its key and line end one piece of the file
  const struct {
    std::string before, after;                  // b=2 written
  } rows[] = {{"1\na=1", "002\r\na=1\r\nb=2"},  // a short count line
              {many, "100" + many.substr(3) + "\r\nb=2"},
              {"002\r\na=1\r\nlong=" + longest, "003\r\na=1\r\nlong=" + longest + "\r\nb=2"}};
  for (const auto& row : rows) {
    m_folder.Write("test.ini", row.before);
    EXPECT_EQ(iWrite("b", "2"), 0);
    EXPECT_EQ(Content(), row.after);
  }
  char value[4094];
  EXPECT_EQ(CNConfigFile(Path().c_str()).iReadConfigString("long", value), 0);
  EXPECT_EQ(value, longest);
  EXPECT_EQ(CNConfigFile(Path().c_str()).iReadConfigString("missing", value), 0);
  EXPECT_STREQ(value, "");
}

TEST_F(CNConfigFileTest, SuspiciousValuesAreLoggedAndWritten) {
  CNConfigFile created(Path().c_str());
  EXPECT_EQ(iWrite("k", "") + iWrite("k", "\xCC\xCC"), 0);
  EXPECT_EQ(m_log.Lines(), (Lines{"ERROR: CNConfigFile::iWriteConfigString -> !*szKeyValue == 0",
                                  "ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue == \xCC\xCC"}));
  m_log.Clear();
  EXPECT_EQ(iWrite("k", std::string(300, 'v').c_str()), 0);
  EXPECT_EQ(m_log.Lines(), Lines(45, "ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue length > 255"));
  EXPECT_EQ(Value("k"), "0:" + std::string(300, 'v'));
}

#ifdef _WIN32
TEST_F(CNConfigFileTest, AHiddenFileStaysHidden) {
  m_folder.Write("test.ini", "001\r\na=1");
  EXPECT_TRUE(bOsSetAttributes(Path().c_str(), OS_HIDDEN));
  EXPECT_EQ(iWrite("a", "2"), 0);
  OsFileInfo info;
  EXPECT_TRUE(bOsGetFileInfo(Path().c_str(), info) && (info.attributes & OS_HIDDEN));
  EXPECT_EQ(Content(), "001\r\na=2");
}
#else
TEST_F(CNConfigFileTest, NoFileOfAnotherIsOverwritten) {
  CNConfigFile created(Path().c_str());
  EXPECT_EQ(iWrite("a", "1"), 0);
  // All names that the new content could have in a fifth of a second that is to come; a machine that lets it pass gets
  // another one.
  Lines taken;
  int iResult = 0;
  for (uint32_t uLead = 50; !iResult && uLead < 60000; uLead *= 2) {
    const uint32_t uStart = OsTickCount() + uLead;
    for (uint32_t i = 0; i < 200; i++) {
      char szName[64];
      std::snprintf(szName, sizeof szName, "test.ini.%x-%lx.tmp", uStart + i, OsThreadId());
      m_folder.Write(szName, "kept");
      taken.push_back(szName);
    }
    while (int32_t(OsTickCount() - uStart) < 0) OsSleep(1);
    iResult = iWrite("a", "1");
  }
  EXPECT_EQ(iResult, 9);
  EXPECT_EQ(Content(), "001\r\na=1");
  for (const std::string& name : taken) EXPECT_EQ(m_folder.Read(name), "kept");
}
#endif
