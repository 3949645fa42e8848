// The names of the installer's commands, for programs that only list or check them. No window system needed.
#pragma once

struct InstallCommandName {
  const char* szName;
  const char* szSecondName;  // null when there is only one
  bool bTakesParameter;
};

const int INSTALL_COMMAND_COUNT = 63;
// In the order in which names are compared.
extern const InstallCommandName INSTALL_COMMAND_NAMES[INSTALL_COMMAND_COUNT];
// What each does, one sentence. A table of its own: the setup program does without it.
extern const char* const INSTALL_COMMAND_HELP[INSTALL_COMMAND_COUNT];

// The row whose name or second name equals szName without regard to ASCII letter case, or -1.
int iFindInstallCommand(const char* szName);
