// The input as a stamped program and as a bare payload.
#include <cstring>

#include "Fuzz.h"
#include "archive/Payload.h"

namespace {

// The bytes that the stream at this place gives.
void Expand(OsFile& input, uint32_t offset, uint32_t length) {
  OsFile output;
  FUZZ_REQUIRE(output.bOpen("out", OsOpenMode::Create));
  SfxStreamParams params;
  params.pInput = &input;
  params.pOutput = &output;
  params.payloadLength = length;
  if (!input.bSeek(offset)) return;
  ExpandStream(params);
  FUZZ_REQUIRE(output.Size() >= params.total);
}

}  // namespace

FUZZ_TARGET(payload, input) {
  FuzzWriteFile("setup.exe", input);
  {
    OsFile file;
    FUZZ_REQUIRE(file.bOpen("setup.exe", OsOpenMode::Read));
    SfxStamp stamp;
    if (bReadSfxStamp(file, stamp)) {
      unsigned char bytes[SFX_STAMP_SIZE];
      EncodeSfxStamp(stamp, bytes);
      FUZZ_REQUIRE(memcmp(bytes, input.data() + SFX_STAMP_OFFSET, 4) == 0);
      FUZZ_REQUIRE(memcmp(bytes + 16, input.data() + SFX_STAMP_OFFSET + 16, 8) == 0);
      Expand(file, stamp.payloadOffset, stamp.payloadLength);
    }
    Expand(file, 0, 0);
  }
  bOsDeleteFile("setup.exe");
  bOsDeleteFile("out");
}
