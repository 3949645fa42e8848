// A configuration file, then keys and values to be read, written and removed, parted by zero bytes.
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
  FUZZ_REQUIRE(!bOsExists("config.ini.new"));
}
