#include "SetupFiles.h"

class SfxStream : public testing::Test {
 protected:
  int Expand(const std::string& file) {
    m_files.folder.Write("setup.exe", file);
    return ExpandSfx(m_files.surroundings, m_context, m_files.folder.Path("setup.exe").c_str());
  }

  SetupFiles m_files;
  SfxContext m_context;
};

TEST_F(SfxStream, ExpandsThePayloadWhileThePageIsShown) {
  std::string content;
  for (int i = 0; i < 20000; i++) content += std::to_string(i * 7919 % 65537);
  EXPECT_EQ(Expand(Stamped(Compressed(content))), SFX_EXPANDED);
  EXPECT_EQ(std::string(m_context.csTempFolder.Text()), m_files.tempFolder);
  const std::string path = m_context.GetExpandedFile();
  EXPECT_EQ(path.substr(0, m_files.tempFolder.size() + 1), m_files.tempFolder + "@");
  EXPECT_EQ(TestFolder::ReadFile(path), content);
  EXPECT_TRUE(m_files.Saw("caption  Setup"));
  EXPECT_TRUE(m_files.Saw("close-window"));
  ReleaseSfx(m_context, 0);
  EXPECT_EQ(m_files.NewTempFiles(), 0);
  EXPECT_EQ(m_context.GetExpandedFile(), nullptr);
}

TEST_F(SfxStream, WithoutAStampNoFileIsMade) {
  for (const std::string& file : {std::string("MZ") + std::string(200, '\0'), std::string("short"), std::string()}) {
    EXPECT_EQ(Expand(file), SFX_NO_STAMP);
    EXPECT_EQ(m_context.GetExpandedFile(), nullptr);
    EXPECT_EQ(m_files.NewTempFiles(), 0);
  }
  EXPECT_TRUE(m_files.events.empty());
}

TEST_F(SfxStream, ADamagedPayloadFailsAndItsFileIsReleased) {
  const std::string good = Compressed(std::string(100000, 'x') + "end");
  std::string bad = good;
  bad[good.size() / 2] ^= 0x55;
  for (const std::string& file : {Stamped(good.substr(0, good.size() - 5)), Stamped(bad), Stamped(""),
                                  Stamped(good, 0x7FFFFFF0), Stamped(good, 0)}) {
    SfxContext context;
    m_files.folder.Write("setup.exe", file);
    EXPECT_EQ(ExpandSfx(m_files.surroundings, context, m_files.folder.Path("setup.exe").c_str()), SFX_FAILED);
    ReleaseSfx(context, 0);
    EXPECT_EQ(m_files.NewTempFiles(), 0);
  }
}

TEST_F(SfxStream, UnpacksTheExtraArchiveBesideItself) {
  m_files.folder.Write("extra.dat", MakeTestArchive({{"one.txt", "1"}, {"sub/two.txt", "2"}}));
  m_context.csExtraArchive = m_files.folder.Path("extra.dat").c_str();
  EXPECT_EQ(Expand(Stamped(Compressed("content"))), SFX_EXPANDED);
  EXPECT_EQ(m_files.folder.Read("Savjetnici\\one.txt"), "1");
  EXPECT_EQ(m_files.folder.Read("Savjetnici\\sub\\two.txt"), "2");
  ReleaseSfx(m_context, 0);
  EXPECT_FALSE(m_files.folder.Exists("extra.dat"));
}

TEST_F(SfxStream, ReleasingWaitsFirst) {
  const uint32_t uStart = OsTickCount();
  ReleaseSfx(m_context, 120);
  EXPECT_GE(OsTickCount() - uStart, 100u);
}
