// Little-endian numbers in bytes that come from outside, read with every place checked, and in bytes that are made.
#pragma once

#include <cstdint>
#include <vector>

#include "OrbitText.h"

// A part of an untrusted file, which must outlive it. A read that reaches out of it throws OrbitError with its text.
class ByteRange {
 public:
  ByteRange(const std::vector<uint8_t>& file, const char* szOutside) : ByteRange(file.data(), file.size(), szOutside) {}

  uint64_t Size() const { return m_size; }
  // The bytes at a place.
  const uint8_t* At(uint64_t place, uint64_t nBytes) const {
    if (place > m_size || nBytes > m_size - place) throw OrbitError(m_szOutside);
    return m_pBytes + place;
  }
  uint8_t U8(uint64_t place) const { return *At(place, 1); }
  uint16_t U16(uint64_t place) const { return static_cast<uint16_t>(Number(place, 2)); }
  uint32_t U32(uint64_t place) const { return Number(place, 4); }
  ByteRange Part(uint64_t place, uint64_t nBytes, const char* szOutside) const {
    return ByteRange(At(place, nBytes), nBytes, szOutside);
  }
  std::vector<uint8_t> Copy(uint64_t place, uint64_t nBytes) const {
    const uint8_t* const pBytes = At(place, nBytes);
    return std::vector<uint8_t>(pBytes, pBytes + nBytes);
  }

 private:
  ByteRange(const uint8_t* pBytes, uint64_t nBytes, const char* szOutside)
      : m_pBytes(pBytes), m_size(nBytes), m_szOutside(szOutside) {}
  uint32_t Number(uint64_t place, int nBytes) const {
    const uint8_t* const pBytes = At(place, nBytes);
    uint32_t value = 0;
    for (int i = 0; i < nBytes; i++) value |= static_cast<uint32_t>(pBytes[i]) << (8 * i);
    return value;
  }

  const uint8_t* m_pBytes;
  uint64_t m_size;
  const char* m_szOutside;
};

// The place must be inside.
inline void Store(std::vector<uint8_t>& bytes, size_t place, uint32_t value, int nBytes) {
  for (int i = 0; i < nBytes; i++) bytes.at(place + i) = static_cast<uint8_t>(value >> (8 * i));
}
inline void Store16(std::vector<uint8_t>& bytes, size_t place, uint32_t value) { Store(bytes, place, value, 2); }
inline void Store32(std::vector<uint8_t>& bytes, size_t place, uint32_t value) { Store(bytes, place, value, 4); }

inline void Append16(std::vector<uint8_t>& bytes, uint32_t value) {
  bytes.resize(bytes.size() + 2);
  Store16(bytes, bytes.size() - 2, value);
}
inline void Append32(std::vector<uint8_t>& bytes, uint32_t value) {
  bytes.resize(bytes.size() + 4);
  Store32(bytes, bytes.size() - 4, value);
}
inline void Append(std::vector<uint8_t>& bytes, const std::vector<uint8_t>& more) {
  bytes.insert(bytes.end(), more.begin(), more.end());
}

// The next multiple of a power of two.
inline uint64_t AlignedUp(uint64_t value, uint64_t alignment) { return (value + alignment - 1) & ~(alignment - 1); }
inline void PadTo(std::vector<uint8_t>& bytes, uint64_t alignment) { bytes.resize(AlignedUp(bytes.size(), alignment)); }
