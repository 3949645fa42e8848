#include "bootstrap/Bundle.h"

#include <cstring>

#include "archive/ArchiveSum.h"
#include "archive/Payload.h"
#include "bootstrap/EntryUnpacker.h"
#include "foundation/os/OsWide.h"

namespace {

const char BUNDLE_FILE[] = "@bundle.tmp";

// The end of the last section's bytes.
uint64_t EndOfImage(const IMAGE_NT_HEADERS32& headers) {
  const IMAGE_SECTION_HEADER* const pSections = IMAGE_FIRST_SECTION(&headers);
  uint64_t end = headers.OptionalHeader.SizeOfHeaders;
  for (int i = 0; i < headers.FileHeader.NumberOfSections; i++) {
    const IMAGE_SECTION_HEADER& section = pSections[i];
    const uint64_t sectionEnd = static_cast<uint64_t>(section.PointerToRawData) + section.SizeOfRawData;
    if (section.SizeOfRawData && sectionEnd > end) end = sectionEnd;
  }
  return end;
}

bool bReadAt(HANDLE hFile, uint64_t offset, void* pBytes, DWORD dwBytes) {
  LARGE_INTEGER at;
  DWORD dwRead = 0;
  at.QuadPart = static_cast<LONGLONG>(offset);
  return SetFilePointerEx(hFile, at, nullptr, FILE_BEGIN) && ReadFile(hFile, pBytes, dwBytes, &dwRead, nullptr) &&
         dwRead == dwBytes;
}

// Copies the archive and holds it against its check value: with that the sum of all its bytes is 0.
BundleResult CopyOut(HANDLE hFile, const BundleRange& range, OsFile& output) {
  unsigned char block[16384];
  uint32_t sum = 0;
  if (range.end - range.start < ARCHIVE_TRAILER_SIZE || !bReadAt(hFile, range.end - ARCHIVE_TRAILER_SIZE, block, 4))
    return BundleResult::Damaged;
  sum = LittleEndian32(block) - ArchiveSum(block, 4);
  for (uint64_t at = range.start; at < range.end;) {
    const uint64_t left = range.end - at;
    const DWORD dwBytes = left < sizeof(block) ? static_cast<DWORD>(left) : sizeof(block);
    if (!bReadAt(hFile, at, block, dwBytes)) return BundleResult::Damaged;
    if (!output.bWrite(block, dwBytes)) return BundleResult::NotWritten;
    sum += ArchiveSum(block, dwBytes);
    at += dwBytes;
  }
  if (!output.bClose()) return BundleResult::NotWritten;
  return sum == 0 ? BundleResult::Unpacked : BundleResult::Damaged;
}

// szFolder ends with a backslash.
BundleResult Extract(const char* szArchive, const char* szFolder) {
  ArchiveWalk walk;
  ArchiveWalk::Step step;
  ArchiveEntryHeader entry;
  EntryUnpacker unpacker;
  if (!walk.bOpen(szArchive)) return BundleResult::NotWritten;
  while ((step = walk.Next(entry)) == ArchiveWalk::Step::Entry) {
    const UnpackResult result = unpacker.Unpack(entry, walk.Data(), szFolder);
    if (result != UnpackResult::Unpacked)
      return result == UnpackResult::Damaged ? BundleResult::Damaged : BundleResult::NotWritten;
  }
  return step == ArchiveWalk::Step::End ? BundleResult::Unpacked : BundleResult::Damaged;
}

}  // namespace

BundleResult FindBundle(const void* pImage, uint64_t fileSize, BundleRange& range) {
  const auto pBytes = static_cast<const unsigned char*>(pImage);
  const auto number = [&](long lOffset) {
    uint32_t value;
    memcpy(&value, pBytes + lOffset, sizeof(value));
    return value;
  };
  if (number(SFX_STAMP_OFFSET) != SFX_MAGIC) return BundleResult::None;
  const auto pDos = reinterpret_cast<const IMAGE_DOS_HEADER*>(pBytes);
  range.start = EndOfImage(*reinterpret_cast<const IMAGE_NT_HEADERS32*>(pBytes + pDos->e_lfanew));
  range.end = number(SFX_STAMP_OFFSET + 16);
  if (range.end == range.start) return BundleResult::None;
  return range.end > range.start && range.end <= fileSize ? BundleResult::Unpacked : BundleResult::Damaged;
}

BundleResult UnpackBundle(HANDLE hFile, const BundleRange& range, const wchar_t* szFolder) {
  CNString csFolder, csArchive;
  OsFile output;
  if (!bNarrowPath(szFolder, csFolder) || !csFolder.AddSlash()) return BundleResult::NotWritten;
  csArchive = csFolder;
  csArchive.Concat(BUNDLE_FILE);
  if (!output.bOpen(csArchive.Text(), OsOpenMode::CreateNew)) return BundleResult::NotWritten;
  BundleResult result = CopyOut(hFile, range, output);
  if (result == BundleResult::Unpacked) result = Extract(csArchive.Text(), csFolder.Text());
  bOsDeleteFile(csArchive.Text());  // if it stays it goes with the folder
  return result;
}
