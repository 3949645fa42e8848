// The whole run of the setup program.
#pragma once

// hInstance is the program's module, pCommandLine the process's command line. Returns the exit code: 0 after a run
// (also one that the user left), -200 when the file named on the command line cannot be opened.
int iRunSetup(void* hInstance, const wchar_t* pCommandLine);
