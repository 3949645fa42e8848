// Small persistent settings: "key=value" lines in a text file whose first line is the entry count in three digits.
#pragma once

#include "foundation/CNString.h"

class CNConfigFile {
 public:
  // Uses "config.ini" in the current directory for a null or empty file; creates a missing file.
  explicit CNConfigFile(const char* szFile = nullptr);

  // Copies the value of szKeyName into csKeyValue ("" when there is no such key, which is no error).
  // Returns 0, 1, 7 (the file cannot be opened) or 9 (a line without '=').
  int iReadConfigString(const char* szKeyName, CNString& csKeyValue);
  // The same into a caller's buffer, which must hold a whole line (4094 bytes).
  int iReadConfigString(const char* szKeyName, char* szKeyValue);
  // Sets or adds the entry. An empty, suspicious or long value is logged and written all the same.
  int iWriteConfigString(const char* szKeyName, const char* szKeyValue);
  // Deletes the entry; a missing one is no error.
  int iRemoveConfigString(const char* szKeyName);

 private:
  CNString m_csFileName;
  int m_iCount = 0;
};
