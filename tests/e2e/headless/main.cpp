// The setup program without a screen, for tests that install many times: the launcher's own run over a view in memory,
// whose pages are walked through. What it does to the machine is what setup.exe does.
//
//   headless install SETUP.EXE FOLDER SCRIPTS   installs; SCRIPTS is the folder of the installer's scripts, and must
//   end
//                                               with a backslash. Prints what was shown; exit code 0 when the last
//                                               page came and no message
//   headless registry FILE...                   writes HKEY_LOCAL_MACHINE and HKEY_CURRENT_USER into the two files
#include <windows.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "launcher/SetupRun.h"
#include "wizard/HeadlessView.h"

namespace {

std::string ReadText(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  std::stringstream text;
  text << file.rdbuf();
  return text.str();
}

struct Walk {
  std::string folder;
  bool bTyped = false, bEnded = false, bMessage = false;

  bool bStep(HeadlessView& view) {
    const std::string page = view.Dialog() ? view.Dialog()->m_csName.Text() : "";
    bEnded = page == "PL-dlg6";
    if (bEnded) return false;
    if (page == "PL-dlg3") {
      if (bTyped) return false;  // the folder was refused
      bTyped = view.bType("default_path", folder.c_str());
      return view.bPress("btn_next_folder");
    }
    if (!view.bPress("b_next")) OsSleep(2);
    return true;
  }
};

// With the variables that make setup register more than the sample product does.
std::string InstallerScript(const std::string& folder) {
  std::string script = ReadText(folder + "installer.txt");
  script.insert(script.find("END_INIT"),
                "  context_menu = \"1\"\n  context_menu_key = \"*\\\\shell\\\\OrbitTest\"\n"
                "  file_types = \".orbtest|OrbitTest.Text|Text\"\n  fonts = \"OrbitTest.ttf\"\n");
  return script;
}

int iInstall(char** argv) {
  CarriedScripts scripts;
  const std::string folder = argv[4];
  scripts.csInstaller = InstallerScript(folder).c_str();
  scripts.csPleaseWait = ReadText(folder + "please_wait.txt").c_str();
  scripts.csExit = ReadText(folder + "exit.txt").c_str();
  Walk walk;
  walk.folder = argv[3];
  SetupSurroundings surroundings;
  surroundings.pScripts = &scripts;
  surroundings.pContext = &walk;
  surroundings.uEndPause = 0;
  surroundings.pMakeView = [](void* pContext) -> std::unique_ptr<WizardView> {
    auto pView = std::make_unique<HeadlessView>();
    Walk& shown = *static_cast<Walk*>(pContext);
    // The page that waits for the expansion has no name, and needs nobody.
    static bool bFirst = true;
    if (bFirst) pView->onIdle = [&shown](HeadlessView& view) { return shown.bStep(view); };
    bFirst = false;
    pView->onEvent = [&shown](const std::string& event) {
      printf("%s\n", event.c_str());
      fflush(stdout);
      if (event.compare(0, 8, "message ") == 0 && event.find("create") == std::string::npos) shown.bMessage = true;
    };
    return pView;
  };
  const CNString csLine((std::string("setup.exe ") + argv[2]).c_str(), 0);
  iRunSetupIn(surroundings, Wide(csLine.Text()));
  return walk.bEnded && !walk.bMessage ? 0 : 1;
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
