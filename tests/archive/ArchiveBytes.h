// Archives put together byte by byte from the format's page, sharing nothing with the code under test, so that they can
// be as wrong as a test wants.
#pragma once

#include <zlib.h>

#include <cstdint>
#include <string>

inline std::string Le32(uint32_t value) {
  std::string bytes;
  for (int i = 0; i < 4; i++) bytes += static_cast<char>(value >> (8 * i));
  return bytes;
}

// One gzip member (or, with 15 window bits, one zlib stream).
inline std::string Gzip(const std::string& content, int iLevel = 6, int iWindowBits = 15 + 16) {
  z_stream stream = {};
  deflateInit2(&stream, iLevel, Z_DEFLATED, iWindowBits, 8, Z_DEFAULT_STRATEGY);
  std::string bytes(deflateBound(&stream, static_cast<uLong>(content.size())) + 64, '\0');
  stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(content.data()));
  stream.avail_in = static_cast<uInt>(content.size());
  stream.next_out = reinterpret_cast<Bytef*>(&bytes[0]);
  stream.avail_out = static_cast<uInt>(bytes.size());
  deflate(&stream, Z_FINISH);
  bytes.resize(stream.total_out);
  deflateEnd(&stream);
  return bytes;
}

const uint32_t TEST_CREATED = 0x01c00001, TEST_ACCESSED = 0x01c80002, TEST_WRITTEN = 0x01d00003;

inline std::string RawEntry(const std::string& name, const std::string& stored, uint32_t unpackedSize,
                            uint32_t attributes = 0x20) {
  return Le32(static_cast<uint32_t>(name.size())) + name + Le32(TEST_CREATED) + Le32(TEST_ACCESSED) +
         Le32(TEST_WRITTEN) + Le32(attributes) + Le32(unpackedSize) + Le32(static_cast<uint32_t>(stored.size())) +
         stored;
}

inline std::string Entry(const std::string& name, const std::string& content, uint32_t attributes = 0x20) {
  return RawEntry(name, content.empty() ? "" : Gzip(content), static_cast<uint32_t>(content.size()), attributes);
}

// Closes `body`, which ends with its terminator, by the check value and the first entry's offset.
inline std::string Seal(const std::string& body, uint32_t firstEntryOffset = 0) {
  uint32_t sum = 0;
  for (const unsigned char c : body + Le32(firstEntryOffset)) sum += c;
  return body + Le32(0 - sum) + Le32(firstEntryOffset);
}

inline std::string Archive(const std::string& entries) { return Seal(entries + Le32(0)); }
