// What an installation leaves in the system besides files: entries in context menus, file types, fonts, a scheduled
// task, shortcuts on the network, settings in kv.ini. The records say what; each is taken away only when the system
// says that it leads into the installation's folder (or, of a font, that it is the same file).
#pragma once

#include "Records.h"

// Adds one line to csFailures for each that is still there against the intention. To be called while the files are.
void RemoveTraces(const Installation& installation, CNString& csFailures);
// The folders for shortcuts that setup made in the user's own, when they are empty. After the shortcuts.
void RemoveMadeFolders(const Installation& installation, CNString& csFailures);
