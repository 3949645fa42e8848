// Keeps what comes out of an archive (or an installation's file list) inside its folder.
#pragma once

#include "foundation/CNString.h"

// Turns an entry's name into a relative path with backslashes. False for a name that is empty, rooted, has a drive or a
// stream colon, a ".." or "." step, an empty step, a control character or one of <>"|?*, a step that ends in a blank or
// a dot, or a device name (nul, con, com1 ... with or without an extension).
bool bMakeSafePath(const char* szName, CNString& csPath);

// False when a folder on the way from szFolder (ends with a backslash) to szFolder + szRelativePath, or the file
// itself, exists and is a junction or a symbolic link. What does not exist yet is no objection.
bool bNoLinkOnPath(const char* szFolder, const char* szRelativePath);
