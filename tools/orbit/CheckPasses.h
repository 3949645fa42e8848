// The passes over a scanned script, in the order in which they run.
#pragma once

#include "CheckCommand.h"

// CheckDialogs.cpp: the controls of one dialog among each other, their events and mnemonics.
void CheckDialog(CheckReport& report, ScriptNames& names, CommandCheck& commands, const ScannedDialog& dialog);
// CheckFlow.cpp: a flow text (of the last dialog or another) or an action text.
enum class FlowKind { Flow, LastFlow, Action };
void CheckFlowText(CheckReport& report, CommandCheck& commands, Piece text, FlowKind kind);
// CheckMarkers.cpp: the <%name%> of the whole text.
void CheckMarkers(CheckReport& report, ScriptNames& names);
// CheckEngine.cpp: loads the script through the engine and adds what only the engine has seen.
void CheckThroughEngine(CheckReport& report);
