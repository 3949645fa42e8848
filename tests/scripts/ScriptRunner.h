// Runs one case of a script that tests itself in a folder of its own. Made once for each test.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "ScriptExpectations.h"
#include "support/TestFolder.h"

struct ScriptOutcome {
  int exit = 0;
  std::vector<std::string> out, errors, log;  // UTF-8
};

class ScriptRunner {
 public:
  // The file's name is what messages call the script.
  void Write(const std::string& script) { m_folder.Write(FILE_NAME, script); }
  ScriptOutcome Run(const ScriptCase& script);
  // Fails the test where the case's expectations are not met.
  void Expect(const ScriptCase& script);

 private:
  static constexpr const char* FILE_NAME = "script.txt";

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

// A file or folder of the source tree. Drive letters and current folders differ under Wine: the path is taken from the
// tree's drive.
std::filesystem::path SourcePath(const char* szPath);
std::string ReadBytes(const std::filesystem::path& path);
