#include "bootstrap/EntryUnpacker.h"

#include <zlib.h>

#include <new>

#include "archive/PathGuard.h"

namespace {

const uint32_t HEADER_SIZE = 10, TRAILER_SIZE = 8;
const int WINDOW_BITS = 15;

// What the decompressor's two callbacks work on.
struct Work {
  BlockReader& source;
  OsFile& output;
  uint32_t left;  // of the compressed bytes
  uint32_t size = 0;
  uint32_t sum = 0xffffffff;
  bool bWritten = true;
};

unsigned Take(void* pContext, z_const unsigned char** ppBytes) {
  Work& work = *static_cast<Work*>(pContext);
  const unsigned char* pBytes = nullptr;
  size_t nBytes = work.source.Peek(BlockReader::BLOCK_SIZE, pBytes);
  if (nBytes > work.left) nBytes = work.left;
  work.source.Skip(nBytes);
  work.left -= static_cast<uint32_t>(nBytes);
  *ppBytes = const_cast<unsigned char*>(pBytes);
  return static_cast<unsigned>(nBytes);
}

// Bit by bit: zlib's own is quicker and takes 8 KB.
void AddToSum(uint32_t& sum, const unsigned char* pBytes, unsigned nBytes) {
  for (unsigned i = 0; i < nBytes; i++) {
    sum ^= pBytes[i];
    for (int iBit = 0; iBit < 8; iBit++) sum = sum >> 1 ^ (sum & 1 ? 0xedb88320 : 0);
  }
}

int Put(void* pContext, unsigned char* pBytes, unsigned nBytes) {
  Work& work = *static_cast<Work*>(pContext);
  AddToSum(work.sum, pBytes, nBytes);
  work.size += nBytes;
  work.bWritten = work.output.bWrite(pBytes, nBytes);
  return !work.bWritten;
}

bool bIsGzip(BlockReader& source, uint32_t storedSize) {
  const unsigned char* p;
  return storedSize >= 2 && source.Peek(2, p) >= 2 && p[0] == 0x1f && p[1] == 0x8b;
}

// Deflated, and no further fields in the header.
bool bShortHeader(BlockReader& source, uint32_t storedSize) {
  const unsigned char* p;
  return storedSize >= HEADER_SIZE + TRAILER_SIZE && source.Peek(HEADER_SIZE, p) >= HEADER_SIZE && p[2] == 8 &&
         p[3] == 0;
}

bool bTrailerSays(BlockReader& source, uint32_t sum, uint32_t size) {
  const unsigned char* p;
  return source.Peek(TRAILER_SIZE, p) >= TRAILER_SIZE && LittleEndian32(p) == sum && LittleEndian32(p + 4) == size;
}

// The folders between szFolder and the file.
bool bMakeFoldersFor(const char* szFolder, const CNString& csName) {
  for (long i = 0; i < csName.Length(); i++) {
    if (csName.Text()[i] != '\\') continue;
    CNString csPath(szFolder, 0);
    csPath.Concat(csName.Text(), i);
    const OsMakeFolderResult result = OsMakeFolder(csPath.Text());
    if (result != OsMakeFolderResult::Made && result != OsMakeFolderResult::Exists) return false;
  }
  return true;
}

}  // namespace

UnpackResult EntryUnpacker::Unpack(const ArchiveEntryHeader& entry, BlockReader& source, const char* szFolder) {
  CNString csName, csPath(szFolder, 0);
  if (!bMakeSafePath(entry.csName.Ptr(), csName)) return UnpackResult::Damaged;
  csPath.Concat(csName.Text());
  if (!bMakeFoldersFor(szFolder, csName) || !m_output.bOpen(csPath.Text(), OsOpenMode::CreateNew))
    return UnpackResult::NotWritten;
  const bool bGzip = bIsGzip(source, entry.storedSize);
  const UnpackResult result = bGzip ? Inflate(entry, source) : Copy(entry, source);
  return !m_output.bClose() && result == UnpackResult::Unpacked ? UnpackResult::NotWritten : result;
}

UnpackResult EntryUnpacker::Inflate(const ArchiveEntryHeader& entry, BlockReader& source) {
  z_stream stream = {};
  if (!bShortHeader(source, entry.storedSize)) return UnpackResult::Damaged;
  source.Skip(HEADER_SIZE);
  if (!m_pWindow) m_pWindow.reset(new (std::nothrow) unsigned char[1 << WINDOW_BITS]);
  if (!m_pWindow || inflateBackInit(&stream, WINDOW_BITS, m_pWindow.get()) != Z_OK) return UnpackResult::NotWritten;
  Work work = {source, m_output, entry.storedSize - HEADER_SIZE - TRAILER_SIZE};
  const int iEnd = inflateBack(&stream, Take, &work, Put, &work);
  inflateBackEnd(&stream);
  if (!work.bWritten) return UnpackResult::NotWritten;
  const bool bWhole = iEnd == Z_STREAM_END && stream.avail_in == 0 && work.left == 0;
  return bWhole && bTrailerSays(source, ~work.sum, work.size) ? UnpackResult::Unpacked : UnpackResult::Damaged;
}

UnpackResult EntryUnpacker::Copy(const ArchiveEntryHeader& entry, BlockReader& source) {
  Work work = {source, m_output, entry.storedSize};
  while (work.left) {
    unsigned char* pBytes;
    const unsigned nBytes = Take(&work, &pBytes);
    if (!nBytes) return UnpackResult::Damaged;
    if (Put(&work, pBytes, nBytes)) return UnpackResult::NotWritten;
  }
  return UnpackResult::Unpacked;
}
