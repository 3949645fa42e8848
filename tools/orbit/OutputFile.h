// A file that appears under its name only when it is complete: written beside it under a temporary name and renamed.
#pragma once

#include <string>
#include <vector>

#include "foundation/os/Os.h"

class OutputFile {
 public:
  // Creates the temporary file in the folder of `path` (UTF-8), or of the file that a link of this name leads to.
  // Throws OrbitError, also for a folder, a device or a pipe of this name.
  explicit OutputFile(const std::string& path);
  // Removes the temporary file unless Commit came before.
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  OsFile& File() { return m_file; }
  // As it was given.
  const std::string& Path() const { return m_path; }
  // The temporary file's path, in code page 1250.
  const std::string& TemporaryPath() const { return m_temporary; }
  void Write(const void* pBytes, size_t nBytes);
  // Closes the file, gives it the access rights of the file `modelPath` (UTF-8) where the system has such rights and
  // the path is not empty, and renames it, replacing an older file. Throws OrbitError.
  void Commit(const std::string& modelPath);

 private:
  std::string m_path;
  std::string m_target;  // m_path, or where a link of this name leads
  std::string m_temporary;
  OsFile m_file;
};

// The output must replace none of the files that go into it, and must not become part of the next pack of the folder
// (empty: none is packed). All are UTF-8 paths. Throws OrbitError.
void CheckOutput(const std::string& output, const std::string& folder, const std::vector<std::string>& inputs);
