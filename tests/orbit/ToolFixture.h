// What the tests of the tool share: files of the source tree, texts, and what a command prints.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "support/TestFolder.h"

// A file or folder of the source tree. Drive letters differ under Wine.
inline std::string SourcePath(const std::string& name) {
#ifdef _WIN32
  return "Z:" ORBIT_SOURCE_DIR "/" + name;
#else
  return ORBIT_SOURCE_DIR "/" + name;
#endif
}

// What the product and its samples show: scripts without a fault.
inline const char* const GOOD_SCRIPTS[] = {"src/installer/scripts/installer.txt", "src/installer/scripts/exit.txt",
                                           "src/installer/scripts/please_wait.txt", "products/gallery/gallery.txt",
                                           "products/wizard97/wizard97.txt"};

inline std::string Replaced(const std::string& text, const std::string& from, const std::string& to) {
  std::string result;
  size_t at = 0;
  for (size_t found; (found = text.find(from, at)) != std::string::npos; at = found + from.size())
    result.append(text, at, found - at).append(to);
  return result.append(text, at, std::string::npos);
}

struct Printed {
  int iResult = -1;
  std::string out, errors;
};

// Runs a command that prints to two streams.
inline Printed Capture(const std::function<int(FILE* pOut, FILE* pErrors)>& run) {
  const TestFolder folder;
  Printed printed;
  {
    using Stream = std::unique_ptr<FILE, int (*)(FILE*)>;
    const Stream pOut(OsOpenStream(folder.Path("out").c_str(), "wb"), fclose);
    const Stream pErrors(OsOpenStream(folder.Path("errors").c_str(), "wb"), fclose);
    printed.iResult = run(pOut.get(), pErrors.get());
  }
  printed.out = folder.Read("out");
  printed.errors = folder.Read("errors");
  return printed;
}
