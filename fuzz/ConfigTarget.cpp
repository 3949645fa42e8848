// A configuration file, then keys and values to be read, written and removed, parted by zero bytes.
#include <filesystem>

#include "Fuzz.h"
#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"

FUZZ_TARGET(config, input) {
  const std::vector<std::string> parts = FuzzParts(input);
  FuzzWriteFile("config.ini", parts[0]);
  {
    CNConfigFile config;
    CNString csValue;
    config.iReadConfigString("path", csValue);
    config.iWriteConfigString("path", "C:\\Plumo");
    for (size_t i = 1; i < parts.size(); i++) {
      const char* szKey = parts[i].c_str();
      const char* szValue = parts[(i + 1) % parts.size()].c_str();
      config.iReadConfigString(szKey, csValue);
      config.iWriteConfigString(szKey, szValue);
      config.iReadConfigString(szKey, csValue);
      if (i % 2) config.iRemoveConfigString(szKey);
    }
    config.iRemoveConfigString("path");
  }
  FUZZ_REQUIRE(bOsDeleteFile("config.ini"));
  // The new content was written beside the file, under a name of its own.
  for (const auto& entry : std::filesystem::directory_iterator(".")) FUZZ_REQUIRE(entry.path() == "./execution.log");
}
