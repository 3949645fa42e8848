// A wizard script as an author keeps it: in code page 1250, which is what the setup program reads, or in UTF-8.
#pragma once

#include <string>

struct ScriptFile {
  std::string text;        // code page 1250; a zero byte has become a blank
  bool bUtf8 = false;      // the file begins with a byte order mark, or is UTF-8 and not plain ASCII
  bool bReplaced = false;  // it held characters that code page 1250 does not have; each is '?' in the text
};

// Reads the file (UTF-8 path). False when it cannot be read.
bool bReadScriptFile(const std::string& path, ScriptFile& script);
