// Windows only: other programs, started by their full path only, found among the running ones, and found among the
// installed ones. Any thread.
#pragma once

#include "foundation/CNString.h"
#include "installer/SystemHandle.h"

// ---- starting ----

// Starts a program by its full path with its own folder as the current one. pProcess (may be null) gets its handle,
// which stays empty when the system keeps it. False, logged, for a path that is not full or a program that is not there
// or cannot be started.
bool bStartProgram(const char* szPath, const char* szArguments, SystemHandle* pProcess = nullptr);
// Calls a function without arguments, as DllRegisterServer, of the library with this full path. False when there is
// no such library or function, or it reports a failure.
bool bCallLibrary(const char* szPath, const char* szFunction);

// ---- running ----

// True when a program of one of the names (separated by ';') or one below szFolder runs, this one excepted. szFolder
// has no trailing backslash and may be empty. csFound gets their names, one a line.
bool bFindRunning(const char* szNames, const char* szFolder, CNString& csFound);

// ---- installed ----

// The system's list of installed programs, below local machine and current user; ends with a backslash.
extern const char INSTALLED_PROGRAMS[];
// The folder of the program with that name in the list, without a trailing backslash: where its entry says that it is,
// or where its uninstaller is. False when there is none, or the folder is gone.
bool bFindInstalled(const char* szName, CNString& csFolder);
