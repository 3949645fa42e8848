// The packed file's own command line. The starter only passes it on; all it wants to know is whether anybody looks.
#pragma once

// What stands behind the program's name, verbatim but for the blanks in front.
const wchar_t* pSkipProgramName(const wchar_t* pLine);
// True when one of the switches asks for a run without windows.
bool bAsksForSilence(const wchar_t* pSwitches);
