// Texts for the errors of Windows Sockets.
#pragma once

// Fills the caller's buffer of iMaxErrorStringLength bytes with the text of this thread's last system error ("NAME: one
// sentence.", or "unknown error (number)"), cut to fit. Socket calls leave their error in the same place as all others,
// so no socket library is needed. Returns 0, 1 (bad arguments) or 2 (there is no room for any text). Any thread.
int WSAGetLastErrorString(char* szErrorString, int iMaxErrorStringLength);
