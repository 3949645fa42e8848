// Writes back, as a script, what the engine has understood of one. Texts are code page 1250.
#pragma once

#include <string>

#include "wizard/COrbitWizard.h"

// The loaded script: variables, then the dialogs. Loading what this returns and writing it again gives the same text.
std::string ScriptOf(COrbitWizard& wizard);

// name = "value", with the escapes of the block of variables.
std::string VariableLine(const CNVariable& variable);
// The control's line, and for some kinds the lines that belong to it; no line feed at the end.
std::string ControlText(const BaseControl& control);
