#include "SetupImage.h"

#include <algorithm>

#include "OrbitText.h"
#include "archive/BlockReader.h"
#include "archive/Payload.h"

namespace {

const size_t DOS_HEADER_SIZE = 64;
const size_t NEW_HEADER_FIELD = 0x3c;  // holds the place of the "PE" header
const unsigned char PE_SIGNATURE[] = {'P', 'E', 0, 0};

bool bReadAt(OsFile& file, uint64_t place, unsigned char* pBytes, size_t nBytes) {
  if (!file.bSeek(place)) return false;
  size_t nDone = 0;
  for (long lRead = 1; nDone < nBytes && lRead > 0; nDone += lRead > 0 ? lRead : 0)
    lRead = file.lRead(pBytes + nDone, nBytes - nDone);
  return nDone == nBytes;
}

}  // namespace

ImageKind KindOfImage(OsFile& file) {
  unsigned char header[DOS_HEADER_SIZE];
  if (!bReadAt(file, 0, header, 2) || header[0] != 'M' || header[1] != 'Z') return ImageKind::NotExecutable;
  if (!bReadAt(file, 0, header, sizeof header)) return ImageKind::Damaged;
  SfxStamp stamp;
  if (bReadSfxStamp(file, stamp)) return ImageKind::Stamped;
  const uint32_t newHeader = LittleEndian32(header + NEW_HEADER_FIELD);
  unsigned char signature[sizeof PE_SIGNATURE];
  if (!bReadAt(file, newHeader, signature, sizeof signature) ||
      !std::equal(signature, signature + sizeof signature, PE_SIGNATURE))
    return ImageKind::Damaged;
  const unsigned char* const pStamp = header + SFX_STAMP_OFFSET;
  const bool bFree = newHeader >= DOS_HEADER_SIZE &&
                     std::all_of(pStamp, pStamp + SFX_STAMP_SIZE, [](unsigned char c) { return c == 0; });
  return bFree ? ImageKind::Unstamped : ImageKind::NoRoom;
}

void OpenSetup(const std::string& path, OsFile& file) {
  if (!file.bOpen(SystemPath(path).c_str(), OsOpenMode::Read)) throw OrbitError("cannot open " + path);
  static const char* const REFUSALS[] = {" is no Windows program", " is no Windows program",
                                         " has no room for a stamp in its DOS header",
                                         " is stamped already: give the setup program without a payload", nullptr};
  const char* const szRefusal = REFUSALS[static_cast<int>(KindOfImage(file))];
  if (szRefusal) throw OrbitError(path + szRefusal);
}
