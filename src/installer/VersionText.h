// The version that the welcome page shows: the day on which the setup program was built.
#pragma once

#include "foundation/CNString.h"

// Turns a compiler's date ("Nov  5 2026") into "2026.11.05"; a text of another form is taken as it is.
void MakeVersionText(const char* szDate, CNString& csVersion);
