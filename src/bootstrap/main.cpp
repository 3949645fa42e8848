// The front of a packed file: unpacks its bundle into a private folder, runs the setup program that was in it, takes
// the folder away and passes the exit code on. What it tells the setup program: its first argument is the packed file,
// two variables of the environment (launcher/BundleStart.h) are the folder and the packed file's own switches.
#include <windows.h>

#include <cwchar>

#include "bootstrap/Bundle.h"
#include "bootstrap/Handles.h"
#include "bootstrap/OwnCommandLine.h"
#include "bootstrap/PrivateFolder.h"
#include "foundation/os/OsLibraries.h"

namespace {

const int FAILED = 1603;  // as installers of the system say it
const int NO_SPACE = 112;
const DWORD AFTER_SETUP = 0x200;  // in the order in which the system ends programs with the session: 0x280 is usual
const size_t MOST = 32768;        // the system's bound for a path and for a command line
const wchar_t PROGRAM[] = L"\\setup.exe";
const wchar_t ARGUMENT[] = L"setup.exe ";
const wchar_t ENDED[] = L"\\ended";  // made by a setup program that ends by itself (launcher/BundleStart.h)

// Not on the stack, and no memory to run out of.
wchar_t s_szOwnPath[MOST];
wchar_t s_szText[2 * MOST];

// Not linked to: what that library links to itself would be looked for before this program's first line.
template <class Function>
Function pUserFunction(const char* szName) {
  const HMODULE hUser = LoadLibraryW(L"user32.dll");
  return hUser ? reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(hUser, szName))) : nullptr;
}

int iFail(const wchar_t* szText, int iCode = FAILED) {
  if (bAsksForSilence(pSkipProgramName(GetCommandLineW()))) return iCode;
  if (const auto pShow = pUserFunction<decltype(&MessageBoxW)>("MessageBoxW"))
    pShow(nullptr, szText, L"Setup", MB_OK | MB_ICONERROR | MB_SETFOREGROUND);
  return iCode;
}

bool bOwnPath() {
  const DWORD dwLength = GetModuleFileNameW(nullptr, s_szOwnPath, MOST);
  return dwLength && dwLength < MOST - sizeof(ARGUMENT);
}

// A folder (in the older systems, a file) of this name makes the system load libraries from beside the program.
bool bIsRedirected() {
  wcscpy(s_szText, s_szOwnPath);
  wcscat(s_szText, L".local");
  if (GetFileAttributesW(s_szText) != INVALID_FILE_ATTRIBUTES) return true;
  const DWORD dwError = GetLastError();
  return dwError != ERROR_FILE_NOT_FOUND && dwError != ERROR_PATH_NOT_FOUND;
}

// The command line is split by the setup program's own rule: all behind the first blank is the path, in quotes or not.
bool bStart(const wchar_t* szFolder, PROCESS_INFORMATION& process) {
  wchar_t szProgram[MAX_PATH + 16];
  STARTUPINFOW own = {}, start = {};
  GetStartupInfoW(&own);
  start.cb = sizeof(start);
  start.lpDesktop = own.lpDesktop;
  start.dwFlags = own.dwFlags & STARTF_USESHOWWINDOW;
  start.wShowWindow = own.wShowWindow;
  wcscpy(szProgram, szFolder);
  wcscat(szProgram, PROGRAM);
  wcscpy(s_szText, ARGUMENT);
  wcscat(s_szText, s_szOwnPath);
  return SetEnvironmentVariableW(L"ORBIT_BUNDLE", szFolder) &&
         SetEnvironmentVariableW(L"ORBIT_SWITCHES", pSkipProgramName(GetCommandLineW())) &&
         CreateProcessW(szProgram, s_szText, nullptr, nullptr, FALSE, 0, nullptr, nullptr, &start, &process);
}

// One that was killed has a code of its killer's choice, and may have left half an installation.
bool bHasEnded(const wchar_t* szFolder) {
  wcscpy(s_szText, szFolder);
  wcscat(s_szText, ENDED);
  return GetFileAttributesW(s_szText) != INVALID_FILE_ATTRIBUTES;
}

// Asked when the bundle could not be unpacked.
bool bIsFull(const wchar_t* szFolder, const BundleRange& range) {
  ULARGE_INTEGER free;
  return GetDiskFreeSpaceExW(szFolder, &free, nullptr, nullptr) && free.QuadPart < 4 * (range.end - range.start);
}

int iRunProgram(const wchar_t* szFolder) {
  PROCESS_INFORMATION process = {};
  DWORD dwCode = FAILED;
  if (!bStart(szFolder, process)) return iFail(L"The setup program cannot be started.");
  const Handle thread(process.hThread), running(process.hProcess);
  if (const auto pAllow = pUserFunction<decltype(&AllowSetForegroundWindow)>("AllowSetForegroundWindow"))
    pAllow(process.dwProcessId);
  WaitForSingleObject(running.get(), INFINITE);
  GetExitCodeProcess(running.get(), &dwCode);
  return bHasEnded(szFolder) ? static_cast<int>(dwCode) : FAILED;
}

const wchar_t* szReason(BundleResult result) {
  if (result == BundleResult::None) return L"This program carries nothing to install.";
  if (result == BundleResult::Damaged) return L"This setup program is damaged. Please get a new copy of it.";
  return L"The setup program cannot be unpacked. Please see whether there is room on the system's drive.";
}

int iRun() {
  // Open to the end, so that nobody puts another file in its place.
  const Handle file(CreateFileW(s_szOwnPath, GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr));
  LARGE_INTEGER size;
  BundleRange range;
  PrivateFolder folder;
  if (!file || !GetFileSizeEx(file.get(), &size)) return iFail(L"The setup program cannot read its own file.");
  BundleResult result = FindBundle(GetModuleHandleW(nullptr), static_cast<uint64_t>(size.QuadPart), range);
  if (result != BundleResult::Unpacked) return iFail(szReason(result));
  if (!folder.bMake()) return iFail(L"The folder for the setup program's files cannot be made.");
  result = UnpackBundle(file.get(), range, folder.Path());
  if (result == BundleResult::Unpacked) return iRunProgram(folder.Path());
  const bool bFull = result == BundleResult::NotWritten && bIsFull(folder.Path(), range);
  folder.Remove();  // the message may stand for long
  return iFail(szReason(result), bFull ? NO_SPACE : FAILED);
}

}  // namespace

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR, int) {
  LoadLibrariesFromSystemOnly();
  SetProcessShutdownParameters(AFTER_SETUP, 0);
  if (!bOwnPath()) return iFail(L"The setup program's own path cannot be used.");
  if (bIsRedirected())
    return iFail(
        L"Beside the setup program there is a folder with its name and .local at the end. Please move the program "
        L"to a folder of its own.");
  return iRun();
}
