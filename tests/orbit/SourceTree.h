// Files of the source tree.
#pragma once

#include <string>

// Drive letters differ under Wine.
inline std::string SourcePath(const std::string& name) {
#ifdef _WIN32
  return "Z:" ORBIT_SOURCE_DIR "/" + name;
#else
  return ORBIT_SOURCE_DIR "/" + name;
#endif
}
