#include "Fuzz.h"

#include <cstdio>

#include "foundation/os/Os.h"

void FuzzFail(const char* szFile, int iLine, const char* szCondition) {
  std::fprintf(stderr, "%s:%d: does not hold: %s\n", szFile, iLine, szCondition);
  std::abort();
}

std::vector<std::string> FuzzParts(const std::string& input) {
  std::vector<std::string> parts(1);
  for (const char c : input)
    if (c)
      parts.back() += c;
    else
      parts.emplace_back();
  return parts;
}

void FuzzWriteFile(const char* szName, const std::string& bytes) {
  OsFile file;
  FUZZ_REQUIRE(file.bOpen(szName, OsOpenMode::Create));
  FUZZ_REQUIRE(file.bWrite(bytes.data(), bytes.size()));
}
