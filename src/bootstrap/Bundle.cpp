#include "bootstrap/Bundle.h"

#include <cstring>

#include "archive/CNArchive.h"
#include "archive/Payload.h"
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

bool bCopyOut(HANDLE hFile, const BundleRange& range, OsFile& output, bool& bRead) {
  char block[16384];
  LARGE_INTEGER at;
  at.QuadPart = static_cast<LONGLONG>(range.start);
  bRead = SetFilePointerEx(hFile, at, nullptr, FILE_BEGIN) != FALSE;
  for (uint64_t left = range.end - range.start; bRead && left;) {
    DWORD dwRead = 0;
    const DWORD dwWanted = left < sizeof(block) ? static_cast<DWORD>(left) : sizeof(block);
    bRead = ReadFile(hFile, block, dwWanted, &dwRead, nullptr) && dwRead > 0;
    if (!bRead || !output.bWrite(block, dwRead)) return false;
    left -= dwRead;
  }
  return bRead && output.bClose();
}

// szFolder ends with a backslash.
BundleResult Extract(const char* szArchive, const char* szFolder) {
  CNArchive archive(szArchive);
  CNArray<CNArchiveEntry> entries;
  if (archive.CheckArchive() != ArchiveOk || archive.ListEntries(entries) != ArchiveOk) return BundleResult::Damaged;
  for (int i = 0; i < entries.Size(); i++) {
    const int iResult = archive.ExtractEntry(i, szFolder);
    if (iResult == ErrUnsafeName || iResult == ErrCRCError) return BundleResult::Damaged;
    if (iResult != ArchiveOk) return BundleResult::NotWritten;
  }
  return BundleResult::Unpacked;
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
  bool bRead = true;
  if (!bNarrowPath(szFolder, csFolder) || !csFolder.AddSlash()) return BundleResult::NotWritten;
  csArchive = csFolder;
  csArchive.Concat(BUNDLE_FILE);
  if (!output.bOpen(csArchive.Text(), OsOpenMode::CreateNew)) return BundleResult::NotWritten;
  if (!bCopyOut(hFile, range, output, bRead)) return bRead ? BundleResult::NotWritten : BundleResult::Damaged;
  const BundleResult result = Extract(csArchive.Text(), csFolder.Text());
  bOsDeleteFile(csArchive.Text());  // if it stays it goes with the folder
  return result;
}
