// The payload: one zlib stream at the end of a stamped executable, announced by a 28-byte stamp in its DOS header.
#pragma once

#include <cstdint>

#include "foundation/CNString.h"
#include "foundation/os/Os.h"

const long SFX_STAMP_OFFSET = 28;
const long SFX_STAMP_SIZE = 28;
const uint32_t SFX_MAGIC = 0x58465372;  // "rSFX"
const unsigned SFX_CHUNK_SIZE = 4096;

// The stamp's fields that mean something; the reserved ones are written as zero.
struct SfxStamp {
  uint32_t payloadOffset = 0;  // from the start of the file
  uint32_t payloadLength = 0;
};

// Reads the stamp of an open file. False when the file has none (or is too short to have one).
bool bReadSfxStamp(OsFile& file, SfxStamp& stamp);
// Encodes the stamp into 28 bytes, little-endian.
void EncodeSfxStamp(const SfxStamp& stamp, unsigned char* pBytes);

// The expander's parameter block.
struct SfxStreamParams {
  OsFile* pInput = nullptr;  // positioned at the payload
  OsFile* pOutput = nullptr;
  uint32_t chunkSize = SFX_CHUNK_SIZE;        // inflated at a time
  uint32_t payloadLength = 0;                 // no more is read from the input; 0: up to its end
  uint32_t (*pProgress)(uint32_t) = nullptr;  // told after each chunk how many bytes there are; its result is ignored
  uint32_t total = 0;                         // bytes written, set when the expander stops
};

// Inflates the payload from input to output through fixed buffers. Returns 0 when the stream came to its end, else
// nonzero (read, write or decompression failure). Any thread.
int ExpandStream(SfxStreamParams& params);
