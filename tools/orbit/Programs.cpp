#include "Programs.h"

#include "OrbitText.h"
#include "foundation/os/Os.h"

namespace fs = std::filesystem;

namespace {

struct Program {
  const char *szName, *szInBuild, *szOption;
};

const Program SETUP = {"setup.exe", "src/starter/setup.exe", "--setup"};
const Program BOOTSTRAP = {"bootstrap.exe", "src/bootstrap/bootstrap.exe", "--starter"};
const Program UNINSTALLER = {"UnInstall.exe", "products/plumo/UnInstall.exe", ""};

// orbit is built in build/PRESET/tools/orbit, the programs in build/windows.
fs::path Find(const Program& program) {
  const fs::path folder = OwnFolder();
  std::error_code ignored;
  for (const fs::path& path : {folder / program.szName, folder / "../../../windows" / program.szInBuild})
    if (fs::is_regular_file(path, ignored)) return path.lexically_normal();
  return {};
}

void FillIn(const Program& program, std::string& path) {
  if (!path.empty()) return;
  path = FromPath(Find(program));
  if (path.empty())
    throw OrbitError(std::string(program.szName) + " is neither in " + FromPath(OwnFolder()) +
                     " nor in build/windows/" + program.szInBuild + ": say " + program.szOption + " FILE");
}

}  // namespace

fs::path OwnFolder() {
  CNString csPath;
  if (!bOsGetProgramPath(csPath)) throw OrbitError("the folder of this program cannot be found out");
  const fs::path path = ToPath(ToUtf8(csPath.Text()));
  std::error_code ignored;
  // The system says either the program or its folder, with or without a slash.
  return !path.has_filename() || fs::is_regular_file(path, ignored) ? path.parent_path() : path;
}

void FindPrograms(SetupPrograms& programs) {
  FillIn(SETUP, programs.setup);
  FillIn(BOOTSTRAP, programs.bootstrap);
}

std::string FindUninstaller() { return FromPath(Find(UNINSTALLER)); }

std::string ProgramsHelp() {
  std::string help = "Without --setup and --starter the programs lie beside orbit, or else in its project's build:\n";
  for (const Program* pProgram : {&SETUP, &BOOTSTRAP})
    help += std::string("  ") + pProgram->szName + ", or build/windows/" + pProgram->szInBuild + "\n";
  return help;
}
