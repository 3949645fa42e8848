// Windows only: where the shell keeps its special folders, going by the registry.
#pragma once

#include "foundation/CNString.h"

// Reads a folder's path from the key "Shell Folders": that of all users under szCommonName, else that of this user
// under szUserName; either name may be null. Variables in it are filled in, and a path that code page 1250 cannot hold
// is its short name. False when there is none, or no absolute one. Any thread.
bool bGetShellFolder(const char* szCommonName, const char* szUserName, CNString& csFolder);
