// Product archives made byte by byte from the format's description, without the code that is under test.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

struct TestEntry {
  std::string name;
  std::string bytes;  // stored as they are: must not begin like a gzip stream
  uint32_t attributes = 0x20;
};

inline std::string Number(uint32_t value) {
  std::string bytes;
  for (int iShift = 0; iShift < 32; iShift += 8) bytes += static_cast<char>(value >> iShift);
  return bytes;
}

inline std::string MakeTestArchive(const std::vector<TestEntry>& entries) {
  std::string bytes;
  for (const TestEntry& entry : entries) {
    const auto nSize = static_cast<uint32_t>(entry.bytes.size());
    bytes += Number(static_cast<uint32_t>(entry.name.size())) + entry.name;
    for (int iTime = 0; iTime < 3; iTime++) bytes += Number(0x01C00000);
    bytes += Number(entry.attributes) + Number(nSize) + Number(nSize) + entry.bytes;
  }
  bytes += Number(0);
  uint32_t sum = 0;  // the first entry's offset, which follows the check value, is 0 and adds nothing
  for (const char c : bytes) sum += static_cast<unsigned char>(c);
  return bytes + Number(0u - sum) + Number(0);
}
