#include "launcher/SetupRun.h"

#include <windows.h>

#include <cstring>

#include "SetupFiles.h"

class SetupRun : public testing::Test {
 protected:
  int Run(const std::string& arguments) {
    const std::string line = "setup.exe" + arguments;
    return iRunSetupIn(m_files.surroundings, std::wstring(line.begin(), line.end()).c_str());
  }

  SetupFiles m_files;
};

TEST_F(SetupRun, AFileThatCannotBeOpenedIsToldAndLogged) {
  TestLog log(m_files.folder);
  EXPECT_EQ(Run(""), -200);
  EXPECT_TRUE(m_files.Saw("Failed to Open the SFX!?\nsetup.exe\n"));
  EXPECT_EQ(Run(" \"C:\\no such file.exe\""), -200);
  EXPECT_TRUE(m_files.Saw("Failed to Open the SFX!?\nsetup.exe C:\\no such file.exe\nC:\\no such file.exe"));
  EXPECT_EQ(log.Lines(), (std::vector<std::string>{"ERROR: Failed to Open the SFX!? -> setup.exe -> ",
                                                   "ERROR: Failed to Open the SFX!? -> setup.exe C:\\no such file.exe "
                                                   "-> C:\\no such file.exe"}));
  EXPECT_FALSE(m_files.Saw("open-window"));
}

TEST_F(SetupRun, ShowsThePagesOfAStampedExecutableAndCleansUp) {
  const std::string target = m_files.folder.Path("target");
  m_files.folder.MakeFolder("target");
  m_files.folder.Write("my setup.exe", Stamped(Compressed(MakeTestArchive({{"Plumo.exe", "program"}}))));
  bool bReached = false;
  std::string caption;
  m_files.onIdle = [&](HeadlessView& view) {
    const std::string page = view.Dialog() ? view.Dialog()->m_csName.Text() : "";
    if (page == "PL-dlg1") caption = view.Caption();
    if (page == "PL-dlg1" || page == "PL-dlg2") return view.bPress("b_next");
    if (page == "PL-dlg3") return view.bType("default_path", target.c_str()) && view.bPress("btn_next_folder");
    if (page != "PL-dlg4") return false;
    // Far enough: what the later pages do has tests of its own, and leaves traces outside this folder.
    bReached = true;
    EXPECT_EQ(m_files.NewTempFiles(), 1);
    return false;
  };
  EXPECT_EQ(Run(" \"" + m_files.folder.Path("my setup.exe") + "\""), 0);
  EXPECT_TRUE(bReached);
  EXPECT_EQ(m_files.NewTempFiles(), 0);
  // The version is there from the first drawing on.
  EXPECT_EQ(caption.size(), std::string(" Plumo Setup - version 2026.01.01").size()) << caption;
  EXPECT_EQ(caption.substr(0, 25), " Plumo Setup - version 20");
  for (const std::string& event : m_files.events)
    EXPECT_TRUE(event.find("caption  Plumo") != 0 || event == "caption " + caption) << event;
}

TEST_F(SetupRun, ShowsPagesWithoutAPayloadFromAPathThatTheCodePageCannotHold) {
  const std::string root = m_files.folder.Root();
  const std::wstring path = std::wstring(root.begin(), root.end()) + L"\\\u0416\u4E2D setup.exe";
  const HANDLE hFile = CreateFileW(path.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_NEW, 0, nullptr);
  ASSERT_NE(hFile, INVALID_HANDLE_VALUE);
  CloseHandle(hFile);
  bool bShown = false;
  m_files.onIdle = [&](HeadlessView&) {
    bShown = true;
    return false;
  };
  EXPECT_EQ(iRunSetupIn(m_files.surroundings, (L"setup.exe \"" + path + L"\"").c_str()), 0);
  EXPECT_TRUE(bShown);
  EXPECT_EQ(m_files.NewTempFiles(), 0);
}

TEST_F(SetupRun, TheEndOfTheSessionLeavesNoFileEvenIfTheProcessEndsThere) {
  m_files.folder.Write("setup.exe", Stamped(Compressed(MakeTestArchive({{"Plumo.exe", "program"}}))));
  bool bReached = false;
  m_files.onIdle = [&](HeadlessView& view) {
    if (!view.Dialog() || strcmp(view.Dialog()->m_csName.Text(), "PL-dlg1") != 0) return false;
    bReached = true;
    EXPECT_EQ(m_files.NewTempFiles(), 1);
    view.EndSession();
    EXPECT_EQ(m_files.NewTempFiles(), 0);
    EXPECT_FALSE(view.bHasWindow());
    return true;
  };
  EXPECT_EQ(Run(" " + m_files.folder.Path("setup.exe")), 0);
  EXPECT_TRUE(bReached);
}

// ---- the payload by itself ----

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
