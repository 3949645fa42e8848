// The setup program without a screen and without a packed file's starter, for tests that install many times; and what
// such tests need to see of the registry.
//
//   headless install SETUP.EXE FOLDER SCRIPTS   installs unattended; SCRIPTS is the folder of the installer's scripts,
//                                               and must end with a backslash. Prints the log; exit code 0 or 1
//   headless registry FILE...                   writes HKEY_LOCAL_MACHINE and HKEY_CURRENT_USER into the two files
#include <windows.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "launcher/SetupRun.h"

namespace {

std::string ReadText(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  std::stringstream text;
  text << file.rdbuf();
  return text.str();
}

// The variables make setup register more than the sample product does.
const char REGISTERS[] =
    " /SET context_menu=1 /SET context_menu_key=*\\shell\\OrbitTest /SET fonts=OrbitTest.ttf"
    " /SET \"file_types=.orbtest|OrbitTest.Text|Text\"";

int iInstall(char** argv) {
  printf("begin\n");  // from here on a test counts what the run writes
  fflush(stdout);
  CarriedScripts scripts;
  const std::string folder = argv[4];
  scripts.csInstaller = ReadText(folder + "installer.txt").c_str();
  scripts.csPleaseWait = ReadText(folder + "please_wait.txt").c_str();
  scripts.csExit = ReadText(folder + "exit.txt").c_str();
  const std::string log = "headless-" + std::to_string(GetCurrentProcessId()) + ".log";
  bOsDeleteFile(log.c_str());
  const std::string switches = "/S \"/DIR=" + std::string(argv[3]) + "\" /LOG=" + log + REGISTERS;
  const CNWideText wide(switches.c_str());
  SetupSurroundings surroundings;
  surroundings.pScripts = &scripts;
  surroundings.pSwitches = reinterpret_cast<const wchar_t*>(wide.Ptr());
  const CNString csLine((std::string("setup.exe ") + argv[2]).c_str(), 0);
  const int iCode = iRunSetupIn(surroundings, Wide(csLine.Text()));
  printf("%s", ReadText(log).c_str());
  bOsDeleteFile(log.c_str());
  return iCode ? 1 : 0;
}

bool bTakeBackupPrivilege() {
  HANDLE hToken = nullptr;
  TOKEN_PRIVILEGES wanted = {1, {{{}, SE_PRIVILEGE_ENABLED}}};
  return OpenProcessToken(GetCurrentProcess(), TOKEN_ADJUST_PRIVILEGES, &hToken) &&
         LookupPrivilegeValueW(nullptr, L"SeBackupPrivilege", &wanted.Privileges[0].Luid) &&
         AdjustTokenPrivileges(hToken, FALSE, &wanted, 0, nullptr, nullptr) && CloseHandle(hToken);
}

int iRegistry(char** argv) {
  bTakeBackupPrivilege();
  const HKEY roots[] = {HKEY_LOCAL_MACHINE, HKEY_CURRENT_USER};
  LSTATUS status = ERROR_SUCCESS;
  for (int i = 0; i < 2; i++) {
    DeleteFileA(argv[2 + i]);
    const LSTATUS saved = RegSaveKeyW(roots[i], Wide(argv[2 + i]), nullptr);
    if (saved != ERROR_SUCCESS) status = saved;
  }
  if (status != ERROR_SUCCESS) printf("error %ld\n", static_cast<long>(status));
  return status != ERROR_SUCCESS;
}

}  // namespace

int main(int argc, char** argv) {
  const std::string verb = argc > 1 ? argv[1] : "";
  if (verb == "install" && argc == 5) return iInstall(argv);
  if (verb == "registry" && argc == 4) return iRegistry(argv);
  return 2;
}
