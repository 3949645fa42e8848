// For tests only: makes chosen calls of this door fail on the build host, to see what the floors above make of it.
// There is nothing of it in a build without ORBIT_FAULTS, as every product is.
#pragma once

#include <cstdio>

// The calls that can fail, by what they do; those of streams (OsOpenStream) are among them.
enum class OsCall {
  Open,
  Read,
  Write,  // half of the bytes are written all the same
  Seek,
  Size,
  Close,  // the file is closed all the same; one that was written with OsFile is cut to half its size
  SetTimes,
  GetInfo,
  SetAttributes,
  Exists,
  IsFolder,
  MakeFolder,
  DeleteFile,
  DeleteFolder,
  Rename,
  List,      // the start of a listing
  ListNext,  // a step of it
};

#ifdef ORBIT_FAULTS
// Asked before every call while it is not null, on the caller's thread. True makes the call fail as a broken disk
// would.
extern bool (*OsFaultHook)(OsCall call);
bool bOsFault(OsCall call);
// As bOsFault(OsCall::Close), for an OsFile.
bool bOsFaultOfClose(int fd);
// A stream that works as pFile, which it replaces, and asks the hook. Null for null.
FILE* OsFaultStream(FILE* pFile, const char* szMode);
#else
inline bool bOsFault(OsCall) { return false; }
inline bool bOsFaultOfClose(int) { return false; }
inline FILE* OsFaultStream(FILE* pFile, const char*) { return pFile; }
#endif
