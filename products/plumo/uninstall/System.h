// What taking an installation away needs from the shell and the system.
#pragma once

#include "foundation/CNString.h"

class Installation;

// Deletes the shortcuts that lead to a file of the installation: in the start menu's program folder, which goes too
// when it is then empty (or, when its name is not known, in all of them), on the desktop and in the quick-launch bar.
// One line for each that could not be deleted is added to csFailures, and one for a program folder that cannot be one.
void RemoveShortcuts(const Installation& installation, CNString& csFailures);
// The same for one shortcut; a file that is none, or leads elsewhere, is left alone.
void RemoveLink(const char* szLink, const Installation& installation, CNString& csFailures);

// Makes an absolute path of it, without a backslash at its end (but for a drive's root). An empty text stays empty.
void MakeFullPath(CNString& csPath);
// True when both paths lead to one and the same file or folder, however they are spelled.
bool bSameObject(const char* szA, const char* szB);

bool bWindowsFolder(CNString& csPath);
bool bUserDataFolder(CNString& csPath);  // ends with a backslash
bool bFontsFolder(CNString& csPath);     // ends with a backslash

// True when both files can be read and hold the same bytes, or the second is the beginning of the first. A file that is
// about to be deleted can be read as well.
bool bSameFile(const char* szA, const char* szB);
bool bBeginsWith(const char* szWhole, const char* szPart);

// Has the system delete a file that is in use at its next start.
bool bDeleteAtRestart(const char* szPath);
// Moves a file, which may be a running program, to a new name in the temporary folder. False when that is on another
// drive or the system refuses.
bool bMoveAside(const char* szPath, CNString& csMoved);
// Deletes what killed runs of setup and of this program (the same as szOwnPath) have left in the temporary folder.
void RemoveTempFiles(const char* szOwnPath);
