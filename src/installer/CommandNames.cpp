#include "installer/CommandNames.h"

#include "foundation/os/Os.h"
#include "installer/CommandList.h"

#define NAME_ROW(name, second, parameter, handler, help) {name, second, parameter},
#define HELP_ROW(name, second, parameter, handler, help) help,

const InstallCommandName INSTALL_COMMAND_NAMES[] = {ORBIT_INSTALL_COMMANDS(NAME_ROW)};
const char* const INSTALL_COMMAND_HELP[] = {ORBIT_INSTALL_COMMANDS(HELP_ROW)};

static_assert(sizeof(INSTALL_COMMAND_NAMES) / sizeof(INSTALL_COMMAND_NAMES[0]) == INSTALL_COMMAND_COUNT);

int iFindInstallCommand(const char* szName) {
  for (int i = 0; i < INSTALL_COMMAND_COUNT; i++) {
    const InstallCommandName& row = INSTALL_COMMAND_NAMES[i];
    if (iOsCompareNoCase(szName, row.szName) == 0) return i;
    if (row.szSecondName && iOsCompareNoCase(szName, row.szSecondName) == 0) return i;
  }
  return -1;
}
