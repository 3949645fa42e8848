// A file that appears under its name only when it is complete: written beside it under a temporary name and renamed.
#pragma once

#include <string>

#include "foundation/os/Os.h"

class OutputFile {
 public:
  // Creates the temporary file in the folder of `path` (UTF-8). Throws OrbitError.
  explicit OutputFile(const std::string& path);
  // Removes the temporary file unless Commit came before.
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  OsFile& File() { return m_file; }
  // The temporary file's path, in code page 1250.
  const std::string& TemporaryPath() const { return m_temporary; }
  void Write(const void* pBytes, size_t nBytes);
  // Closes the file, gives it the access rights of the file `modelPath` (UTF-8) where the system has such rights and
  // the path is not empty, and renames it, replacing an older file. Throws OrbitError.
  void Commit(const std::string& modelPath);

 private:
  std::string m_path;
  std::string m_temporary;
  OsFile m_file;
};
