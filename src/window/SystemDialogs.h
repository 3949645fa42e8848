// The system's own dialogs: message box, folder and file chooser, and what the shell opens. hOwner may be null.
#pragma once

#include "controls/MessageSink.h"
#include "foundation/CNString.h"
#include "window/Handles.h"

// Returns the answer (MessageAnswer), 0 when the box cannot be shown. Any thread.
int iSystemMessage(HWND hOwner, const MessageText& message);
// csFolder: where to start (its nearest existing parent), and the choice. False when cancelled.
bool bSystemChooseFolder(HWND hOwner, const char* szTitle, CNString& csFolder);
bool bSystemChooseFile(HWND hOwner, const char* szTitle, CNString& csFile);
// Opens a program, document, web or mail address. False when the shell refuses.
bool bSystemOpen(HWND hOwner, const char* szTarget, const char* szFolder);
