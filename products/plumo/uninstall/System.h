// What taking an installation away needs from the shell and the system.
#pragma once

#include "foundation/CNString.h"

// Deletes the shortcuts whose target is a file inside szFolder (full path, ends with a backslash) that pIsOurs says is
// ours, going by its path below szFolder: in the start menu's program folder szProgramFolder, which goes too when it is
// then empty, on the desktop and in the quick-launch bar. One line for each that could not be deleted is added to
// csFailures, and one for a program folder that cannot be one.
void RemoveShortcuts(const char* szFolder, const char* szProgramFolder, bool (*pIsOurs)(const char*, void*),
                     void* pContext, CNString& csFailures);

// Makes an absolute path of it, without a backslash at its end (but for a drive's root). An empty text stays empty.
void MakeFullPath(CNString& csPath);
// True when both paths lead to one and the same file or folder, however they are spelled.
bool bSameObject(const char* szA, const char* szB);

bool bWindowsFolder(CNString& csPath);

// True when both files can be read and hold the same bytes. A file that is about to be deleted can be read as well.
bool bSameFile(const char* szA, const char* szB);
