// What the targets share. A target is one source with one FUZZ_TARGET: a function that takes any bytes and must come
// back from them. It works in the current folder, which its runner made for it alone, and leaves nothing there.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <vector>

using FuzzTarget = void (*)(const std::string& input);

#ifdef ORBIT_FUZZ_REPLAY
// All targets of the program by name (FuzzReplay.cpp).
struct FuzzRegistration {
  FuzzRegistration(const char* szName, FuzzTarget pRun);
};
#define FUZZ_TARGET(name, input)                                \
  static void Fuzz_##name(const std::string& input);            \
  static const FuzzRegistration registered(#name, Fuzz_##name); \
  static void Fuzz_##name([[maybe_unused]] const std::string& input)
#else
#define FUZZ_TARGET(name, input)                                                \
  static void Fuzz_##name(const std::string& input);                            \
  extern "C" int LLVMFuzzerTestOneInput(const uint8_t* pBytes, size_t nBytes) { \
    Fuzz_##name(std::string(reinterpret_cast<const char*>(pBytes), nBytes));    \
    return 0;                                                                   \
  }                                                                             \
  static void Fuzz_##name([[maybe_unused]] const std::string& input)
#endif

// A condition that must hold for every input; stops the program with the place otherwise.
#define FUZZ_REQUIRE(condition) \
  if (!(condition)) FuzzFail(__FILE__, __LINE__, #condition)
[[noreturn]] void FuzzFail(const char* szFile, int iLine, const char* szCondition);

// The input cut at its zero bytes; at least one part.
std::vector<std::string> FuzzParts(const std::string& input);
// A file of the current folder; a failure stops the program.
void FuzzWriteFile(const char* szName, const std::string& bytes);
