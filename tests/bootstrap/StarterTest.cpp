// What the starter decides alone; how it does it with a packed file is tested end to end.
#include <gtest/gtest.h>
#include <windows.h>

#include <string>

#include "bootstrap/Bundle.h"
#include "bootstrap/OwnCommandLine.h"
#include "bootstrap/PrivateFolder.h"

TEST(Starter, SilenceIsAskedForByAWholeWord) {
  const struct {
    const wchar_t *szLine, *szRest;
    bool bSilent;
  } ROWS[] = {
      {L"C:\\a.exe", L"", false},
      {L"\"C:\\my files\\a.exe\"  /DIR=C:\\x -s", L"/DIR=C:\\x -s", true},
      {L"a.exe\t/q", L"/q", true},
      {L"a.exe /SILENT", L"/SILENT", true},
      {L"a.exe -verysilent", L"-verysilent", true},
      {L"a.exe /Quiet", L"/Quiet", true},
      {L"a.exe /LOG=\"C:\\x /S y\"", L"/LOG=\"C:\\x /S y\"", false},
      {L"a.exe /silently s C:/quiet", L"/silently s C:/quiet", false},
      {L"a.exe /PASSIVE /D=C:\\x /S", L"/PASSIVE /D=C:\\x /S", true},
      {L"a.exe /D=C:\\x /S", L"/D=C:\\x /S", false},  // all of it is the folder
  };
  for (const auto& row : ROWS) {
    EXPECT_STREQ(pSkipProgramName(row.szLine), row.szRest);
    EXPECT_EQ(bAsksForSilence(pSkipProgramName(row.szLine)), row.bSilent) << std::wstring(row.szLine).size();
  }
}

TEST(Starter, ABundleLiesBetweenTheLastSectionAndThePayload) {
  struct Image {
    IMAGE_DOS_HEADER dos = {};
    IMAGE_NT_HEADERS32 headers = {};
    IMAGE_SECTION_HEADER sections[3] = {};
  } image;
  image.dos.e_lfanew = offsetof(Image, headers);
  image.headers.FileHeader.NumberOfSections = 3;
  image.headers.FileHeader.SizeOfOptionalHeader = sizeof(image.headers.OptionalHeader);
  image.sections[0].PointerToRawData = 0x400, image.sections[0].SizeOfRawData = 0x600;
  image.sections[1].PointerToRawData = 0x9000;  // of zeros alone: nothing of it is in the file
  image.sections[2].PointerToRawData = 0x200, image.sections[2].SizeOfRawData = 0x100;
  const auto find = [&](uint32_t uPayload, uint64_t size, BundleRange& range) {
    memcpy(reinterpret_cast<char*>(&image) + 0x2c, &uPayload, 4);
    return FindBundle(&image, size, range);
  };
  BundleRange range;
  EXPECT_EQ(find(0x1000, 0x2000, range), BundleResult::None);
  memcpy(reinterpret_cast<char*>(&image) + 0x1c, "rSFX", 4);
  EXPECT_EQ(find(0x1000, 0x2000, range), BundleResult::Unpacked);
  EXPECT_EQ(range.start, 0xa00u);
  EXPECT_EQ(range.end, 0x1000u);
  EXPECT_EQ(find(0xa00, 0x2000, range), BundleResult::None);
  for (const uint32_t uPayload : {0x9ffu, 0u, 0x2001u, 0xffffffffu})
    EXPECT_EQ(find(uPayload, 0x2000, range), BundleResult::Damaged) << uPayload;
}

namespace {

// This thread without the administrators' rights, for the time of one object.
class PlainUser {
 public:
  PlainUser() {
    SID_IDENTIFIER_AUTHORITY authority = SECURITY_NT_AUTHORITY;
    HANDLE hOwn = nullptr, hPlain = nullptr;
    SID_AND_ATTRIBUTES administrators = {};
    AllocateAndInitializeSid(&authority, 2, SECURITY_BUILTIN_DOMAIN_RID, DOMAIN_ALIAS_RID_ADMINS, 0, 0, 0, 0, 0, 0,
                             &administrators.Sid);
    bDone = OpenProcessToken(GetCurrentProcess(), TOKEN_ALL_ACCESS, &hOwn) &&
            CreateRestrictedToken(hOwn, 0, 1, &administrators, 0, nullptr, 0, nullptr, &hPlain) &&
            ImpersonateLoggedOnUser(hPlain);
    FreeSid(administrators.Sid);
    CloseHandle(hOwn);
    CloseHandle(hPlain);
  }
  ~PlainUser() { RevertToSelf(); }
  bool bDone = false;
};

std::wstring Below(const wchar_t* szFolder) {
  std::wstring path = szFolder;
  for (wchar_t& c : path) c = static_cast<wchar_t>(towlower(c));
  return path;
}

}  // namespace

TEST(Starter, ThePlaceOfTheFolderGoesByTheRights) {
  wchar_t szTemp[MAX_PATH], szWindows[MAX_PATH];
  GetTempPathW(MAX_PATH, szTemp);
  GetWindowsDirectoryW(szWindows, MAX_PATH);
  PrivateFolder elevated, again;
  ASSERT_TRUE(elevated.bMake() && again.bMake());
  EXPECT_EQ(Below(elevated.Path()).find(Below(szWindows) + L"\\temp\\orbit-"), 0u);
  EXPECT_STRNE(elevated.Path(), again.Path());
  EXPECT_FALSE(RemoveDirectoryW(elevated.Path())) << "it is held";
  PrivateFolder plain;
  const PlainUser user;
  ASSERT_TRUE(user.bDone);
  ASSERT_TRUE(plain.bMake());
  EXPECT_EQ(Below(plain.Path()).find(Below(szTemp) + L"orbit-"), 0u);
}

TEST(Starter, AFolderGoesWithAllThatIsInIt) {
  PrivateFolder folder;
  ASSERT_TRUE(folder.bMake());
  const std::wstring path = folder.Path(), deep = L"\\\\?\\" + path + L"\\" + std::wstring(200, L'a');
  ASSERT_TRUE(CreateDirectoryW(deep.c_str(), nullptr));
  ASSERT_TRUE(CreateDirectoryW((deep + L"\\" + std::wstring(100, L'b')).c_str(), nullptr));
  const HANDLE hFile = CreateFileW((path + L"\\file").c_str(), GENERIC_WRITE, 0, nullptr, CREATE_NEW,
                                   FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_HIDDEN, nullptr);
  EXPECT_FALSE(bRemoveTree(path.c_str())) << "a file is in use";
  CloseHandle(hFile);
  folder.Remove();
  EXPECT_EQ(GetFileAttributesW(path.c_str()), INVALID_FILE_ATTRIBUTES);
  EXPECT_STREQ(folder.Path(), L"");
}
