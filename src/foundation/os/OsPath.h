// Path arithmetic that both systems' files share. Internal to this folder.
#pragma once

#include "foundation/CNString.h"

inline bool bIsSlash(char c) { return c == '/' || c == '\\'; }

// Cuts the last step off, keeping the separator before it ("C:\a\b" becomes "C:\a\"). False when nothing is left to
// cut.
bool bCutLastStep(CNString& csPath);
// Asks bAsk about the path, then about one after the other of the folders above it, until it says yes.
bool bAskUpwards(const char* szPath, bool (*bAsk)(const char* szPath, void* pContext), void* pContext);
