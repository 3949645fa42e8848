// Helpers for files, folders and paths: free-standing operations without any state. A failure writes one diagnostic
// line. Paths are code page 1250 texts with either kind of slash. Any thread.
#pragma once

#include <cstdint>

#include "foundation/CNArray.h"
#include "foundation/CNString.h"

// The system's own headers have a macro of this name. (Include them first, as everywhere.)
#undef CopyFile

class CNSystem {
 public:
  CNSystem() = delete;

  // Copies the content, not times and attributes, over whatever the destination held. Returns 1, or 0; what has been
  // written of a destination when a later read or write fails stays. A file is not copied onto itself.
  static int CopyFile(const char* SrcFile, const char* DestFile);
  // Copies all files and folders below SrcDir into the existing folder DstDir. Returns 1, or 0 when SrcDir cannot be
  // read; entries that cannot be copied have written their lines and do not count. A link to a folder is not followed,
  // and a DstDir that lies below SrcDir is not copied into itself.
  static int CopyAll(const char* SrcDir, const char* DstDir);

  // The folder of the running program, with a trailing '\'. Returns 0 or 9.
  static int GetCurrentApplicationDir(CNString& csPath);
  // The current folder, with a trailing '/'. Returns 0, 1 or 9.
  static int GetCurrentDir(CNString* pcsPath);
  // 1 when there is a file or folder of this name, else 0.
  static int bExistFile(const char* szPath);
  // The part after the last '\' or '/', which may be empty; the whole path when it has none. Returns 0 or 1.
  static int GetFileNameFromPath(const char* szFullPath, CNString& csFileName);
  // Turns every '\' into '/' in place. Returns 0 or 1.
  static int SwapBackSlashToSlash(char* szString);

  // Add to the array, in the system's order, the names that a search finds: szPath + "/*" + szPattern for files and
  // folders alike, "." and ".." included; szPath + "/" + szPattern for folders only, without these two. bMatchesPattern
  // says what the last step of a search finds; the others hold no wildcards. Return 0 (also for a folder that is not
  // there), 1 (bad arguments), or 9 when the system stops before the end, the names until then having been added.
  static int ListFilesAndFolders(const char* szPath, CNStringArray* parcsFileNames, const char* szPattern = "");
  static int ListFolders(const char* szPath, CNStringArray* parcsFolderNames, const char* szPattern = "*");

  // Removes a folder and all it holds, read-only files too; of a link, the link. While one of its ".dll" and ".exe"
  // files cannot be opened for writing, as one that is running, nothing is removed. Returns 0; 1 for a path without a
  // folder's name at its end (a drive, ".."); 9 when something could not be removed, everything else being gone then.
  static int iDeleteFolderAndSubFolders(const char* szPath);

  // The size of a file in bytes (0 for a folder); the time of creation in units of 100 nanoseconds since 1601-01-01
  // UTC. Return 0, 1 or 9.
  static int GetSize(const char* szPath, int64_t* i64Size);
  static int GetFileCreationTime(const char* szPath, int64_t* i64Time);
};
