// The system itself reads what was written: this very test program, with new resources, is looked at and started.
#ifdef _WIN32
#include <windows.h>

#include <shellapi.h>

#include "PeImage.h"
#include "PeResources.h"
#include "orbit/ToolFixture.h"

namespace {

template <class Function>
Function VersionCall(const char* szName) {
  return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(LoadLibraryA("version.dll"), szName)));
}

std::vector<uint8_t> FileBytes(const std::string& path) {
  const std::string text = TestFolder::ReadFile(path);
  return std::vector<uint8_t>(text.begin(), text.end());
}

class PeWindowsTest : public ::testing::Test {
 protected:
  PeWindowsTest() : m_program(m_folder.Path("program.exe")) {
    char path[MAX_PATH];
    GetModuleFileNameA(nullptr, path, MAX_PATH);
    m_image = FileBytes(path);
    m_image.resize(FindOverlay(m_image));
    SetPeResources(m_image, FileBytes(SourcePath("products/plumo/pictures/plumo.ico")), m_info);
    m_folder.Write("program.exe", std::string(m_image.begin(), m_image.end()));
  }

  static std::string Utf8(const char8_t* pText) { return reinterpret_cast<const char*>(pText); }

  const PeVersionInfo m_info = {Utf8(u8"Čitač"),          "2.1.0.77 beta",         Utf8(u8"Tavola – 中"),
                                Utf8(u8"Installs Čitač"), Utf8(u8"© 2026 Tavola"), "Citac-2.1-install.exe"};
  TestFolder m_folder;
  std::string m_program;
  std::vector<uint8_t> m_image;
};

TEST_F(PeWindowsTest, TheVersionIsShown) {
  const auto size = VersionCall<DWORD(WINAPI*)(LPCSTR, LPDWORD)>("GetFileVersionInfoSizeA");
  const auto read = VersionCall<BOOL(WINAPI*)(LPCSTR, DWORD, DWORD, LPVOID)>("GetFileVersionInfoA");
  const auto query = VersionCall<BOOL(WINAPI*)(LPCVOID, LPCWSTR, LPVOID*, PUINT)>("VerQueryValueW");
  std::vector<char> info(size(m_program.c_str(), nullptr));
  ASSERT_TRUE(read(m_program.c_str(), 0, static_cast<DWORD>(info.size()), info.data()));
  void* pValue = nullptr;
  UINT length = 0;
  ASSERT_TRUE(query(info.data(), L"\\", &pValue, &length));
  const auto* const pFixed = static_cast<const VS_FIXEDFILEINFO*>(pValue);
  EXPECT_EQ(pFixed->dwProductVersionLS, 77u);
  ASSERT_TRUE(query(info.data(), L"\\VarFileInfo\\Translation", &pValue, &length));
  EXPECT_EQ(*static_cast<const DWORD*>(pValue), 0x04b00409u);
  const std::pair<const wchar_t*, const wchar_t*> texts[] = {
      {L"CompanyName", L"Tavola \x2013 \x4e2d"}, {L"FileDescription", L"Installs \x10cita\x10d"},
      {L"FileVersion", L"2.1.0.77 beta"},        {L"InternalName", L"Citac-2.1-install"},
      {L"LegalCopyright", L"\xa9 2026 Tavola"},  {L"OriginalFilename", L"Citac-2.1-install.exe"},
      {L"ProductName", L"\x10cita\x10d"},        {L"ProductVersion", L"2.1.0.77 beta"}};
  for (const auto& [pKey, pText] : texts) {
    ASSERT_TRUE(query(info.data(), (std::wstring(L"\\StringFileInfo\\040904B0\\") + pKey).c_str(), &pValue, &length));
    EXPECT_EQ(std::wstring(static_cast<const wchar_t*>(pValue)), pText);
    EXPECT_EQ(length, wcslen(pText) + 1);
  }
}

TEST_F(PeWindowsTest, TheIconIsShownAndTheResourcesAreFound) {
  HICON hLarge = nullptr, hSmall = nullptr;
  EXPECT_EQ(ExtractIconExA(m_program.c_str(), 0, &hLarge, &hSmall, 1), 2u);
  EXPECT_TRUE(hLarge && hSmall);
  DestroyIcon(hLarge);
  DestroyIcon(hSmall);
  const HMODULE hModule = LoadLibraryExA(m_program.c_str(), nullptr, LOAD_LIBRARY_AS_DATAFILE);
  ASSERT_TRUE(hModule);
  for (const auto& [way, data] : ReadResources(m_image, ReadPeHeaders(m_image))) {
    const HRSRC hFound = FindResourceExW(hModule, MAKEINTRESOURCEW(way[0].id), MAKEINTRESOURCEW(way[1].id),
                                         static_cast<WORD>(way[2].id));
    ASSERT_TRUE(hFound) << way[0].id << " " << way[1].id;
    EXPECT_EQ(SizeofResource(hModule, hFound), data.bytes.size());
    EXPECT_EQ(memcmp(LockResource(LoadResource(hModule, hFound)), data.bytes.data(), data.bytes.size()), 0);
  }
  FreeLibrary(hModule);
}

TEST_F(PeWindowsTest, TheProgramStillStarts) {
  std::string command = "\"" + m_program + "\" --gtest_list_tests --gtest_filter=no.test";
  STARTUPINFOA start = {};
  start.cb = sizeof start;
  PROCESS_INFORMATION process = {};
  ASSERT_TRUE(CreateProcessA(m_program.c_str(), command.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr, &start,
                             &process));
  EXPECT_EQ(WaitForSingleObject(process.hProcess, 120000), WAIT_OBJECT_0);
  DWORD code = 1;
  GetExitCodeProcess(process.hProcess, &code);
  EXPECT_EQ(code, 0u);
  CloseHandle(process.hThread);
  CloseHandle(process.hProcess);
}

}  // namespace
#endif
