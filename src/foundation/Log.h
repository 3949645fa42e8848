// The diagnostic log: one line per failure, appended to "execution.log" in the current directory when that file exists.
// The file's presence is the only switch; nothing here ever creates it. Every function is safe on any thread at any
// time.
#pragma once

// Lets the compiler check a printf-like call. Only the conversions common to every C runtime are used (%s %d %li %u %x
// %c).
#define ORBIT_PRINTF(at, first) __attribute__((format(printf, at, first)))

// Appends one entry: the thread, the local time and the formatted message. Always returns null, so that a function that
// returns a pointer can log and return in one expression.
void* LogPrintf(const char* szFormat, ...) ORBIT_PRINTF(1, 2);

// Logs the message and returns iCode: the one expression with which a failing function leaves.
int iLogReturn(int iCode, const char* szFormat, ...) ORBIT_PRINTF(2, 3);

// Acquire and release the log lock. Return 0, or LOG_LOCK_WAIT_FAILED and LOG_LOCK_RELEASE_FAILED.
int iGetSemaphore();
int iReleaseSemaphore();
