#include "archive/ArchiveWriter.h"

#include <cstring>
#include <new>

#include "archive/ArchiveSum.h"
#include "archive/PathGuard.h"
#include "foundation/Log.h"

namespace {
const uint32_t WRITE_BLOCK = 256 * 1024;
const int GZIP_WINDOW_BITS = 15 + 16;
const int MEMORY_LEVEL = 8;
const int UNKNOWN_SYSTEM = 255;  // so that every host makes the same bytes
}  // namespace

ArchiveWriter::ArchiveWriter(OsFile& output, int iLevel, GzipMaker* pMaker)
    : m_output(output), m_iLevel(iLevel), m_pMaker(pMaker), m_nBlock(pMaker ? GzipMaker::MOST : WRITE_BLOCK) {
  m_pBlocks.reset(new (std::nothrow) unsigned char[m_nBlock + WRITE_BLOCK]);
  m_gzipHeader.os = UNKNOWN_SYSTEM;
}

ArchiveWriter::~ArchiveWriter() {
  if (m_bStreamReady) deflateEnd(&m_stream);
}

int ArchiveWriter::iAddFile(ArchiveEntryHeader& header, OsFile& input) {
  CNString csSafe;
  const long lName = header.csName.Length();
  if (lName > static_cast<long>(ARCHIVE_MAX_NAME) || strlen(header.csName.Text()) != static_cast<size_t>(lName) ||
      !bMakeSafePath(header.csName.Ptr(), csSafe))
    return iLogReturn(ErrArchiveName, "ERROR: ArchiveWriter::iAddFile -> !bMakeSafePath -> return ErrArchiveName");
  unsigned char fields[4 + ARCHIVE_FIELDS_SIZE] = {};
  StoreLittleEndian32(fields, static_cast<uint32_t>(lName));
  const uint32_t values[] = {header.creationTimeHigh, header.lastAccessTimeHigh, header.lastWriteTimeHigh,
                             header.attributes};
  for (size_t i = 0; i < 4; i++) StoreLittleEndian32(fields + 4 + 4 * i, values[i]);
  // Both sizes are written once they are known; until then their place holds zeros, which add nothing to the sum.
  if (!bWrite(fields, 4) || !bWrite(reinterpret_cast<const unsigned char*>(header.csName.Ptr()), lName) ||
      !bWrite(fields + 4, ARCHIVE_FIELDS_SIZE))
    return iLogReturn(ErrArchiveWrite, "ERROR: ArchiveWriter::iAddFile -> !bWrite -> return ErrArchiveWrite");
  const uint64_t dataStart = m_size;
  const int iResult = iStoreContent(header, input);
  if (iResult != ArchiveWritten) return iResult;
  header.storedSize = static_cast<uint32_t>(m_size - dataStart);
  return iPatchSizes(header, dataStart - 8);
}

// Fills a block from the file; the count, which is smaller at its end only, or -1.
static long lReadBlock(OsFile& input, unsigned char* pBytes, size_t nBytes) {
  size_t nDone = 0;
  long lRead = 1;
  while (nDone < nBytes && (lRead = input.lRead(pBytes + nDone, nBytes - nDone)) > 0)
    nDone += static_cast<size_t>(lRead);
  return lRead < 0 ? -1 : static_cast<long>(nDone);
}

int ArchiveWriter::iStoreContent(ArchiveEntryHeader& header, OsFile& input) {
  if (!m_pBlocks) return iLogReturn(ErrArchiveMemory, "ERROR: ArchiveWriter -> !m_pBlocks -> return ErrArchiveMemory");
  uint64_t unpacked = 0;
  long lRead;
  while ((lRead = lReadBlock(input, m_pBlocks.get(), m_nBlock)) > 0) {
    const int iResult = iStoreBlock(static_cast<size_t>(lRead), unpacked == 0);
    if (iResult != ArchiveWritten) return iResult;
    unpacked += static_cast<uint64_t>(lRead);
    if (unpacked > UINT32_MAX)
      return iLogReturn(ErrArchiveLarge, "ERROR: ArchiveWriter -> unpacked > UINT32_MAX -> return ErrArchiveLarge");
    if (m_pProgress && !m_pProgress(static_cast<uint32_t>(lRead), m_pContext))
      return iLogReturn(ErrArchiveStopped, "INFO: ArchiveWriter -> !m_pProgress -> return ErrArchiveStopped");
  }
  if (lRead < 0) return iLogReturn(ErrArchiveRead, "ERROR: ArchiveWriter -> !lRead -> return ErrArchiveRead");
  header.unpackedSize = static_cast<uint32_t>(unpacked);
  return unpacked && !m_pMaker ? iDeflate(Z_FINISH) : ArchiveWritten;
}

// Compresses the block that was read: as a member of its own, or as a part of the content's one member.
int ArchiveWriter::iStoreBlock(size_t nBytes, bool bFirst) {
  if (m_pMaker) {
    const unsigned char* pMember;
    const size_t nMember = m_pMaker->Make(m_pBlocks.get(), nBytes, pMember);
    return nMember ? iPut(pMember, nMember)
                   : iLogReturn(ErrArchiveMemory, "ERROR: ArchiveWriter -> !Make -> return ErrArchiveMemory");
  }
  if (bFirst) {
    if (m_bStreamReady) deflateEnd(&m_stream);
    m_bStreamReady =
        deflateInit2(&m_stream, m_iLevel, Z_DEFLATED, GZIP_WINDOW_BITS, MEMORY_LEVEL, Z_DEFAULT_STRATEGY) == Z_OK;
    if (!m_bStreamReady)
      return iLogReturn(ErrArchiveMemory, "ERROR: ArchiveWriter -> !deflateInit2 -> return ErrArchiveMemory");
    deflateSetHeader(&m_stream, &m_gzipHeader);
  }
  m_stream.next_in = m_pBlocks.get();
  m_stream.avail_in = static_cast<uInt>(nBytes);
  return iDeflate(Z_NO_FLUSH);
}

// Compresses what the stream was given and writes what comes out.
int ArchiveWriter::iDeflate(int iFlush) {
  unsigned char* const pOut = m_pBlocks.get() + m_nBlock;
  do {
    m_stream.next_out = pOut;
    m_stream.avail_out = WRITE_BLOCK;
    deflate(&m_stream, iFlush);
    const int iResult = iPut(pOut, WRITE_BLOCK - m_stream.avail_out);
    if (iResult != ArchiveWritten) return iResult;
  } while (m_stream.avail_out == 0);
  return ArchiveWritten;
}

int ArchiveWriter::iPut(const unsigned char* pBytes, size_t nBytes) {
  if (!bWrite(pBytes, nBytes))
    return iLogReturn(ErrArchiveWrite, "ERROR: ArchiveWriter -> !bWrite -> return ErrArchiveWrite");
  if (m_size > UINT32_MAX)
    return iLogReturn(ErrArchiveLarge, "ERROR: ArchiveWriter -> m_size > UINT32_MAX -> return ErrArchiveLarge");
  return ArchiveWritten;
}

int ArchiveWriter::iPatchSizes(const ArchiveEntryHeader& header, uint64_t place) {
  unsigned char sizes[8];
  StoreLittleEndian32(sizes, header.unpackedSize);
  StoreLittleEndian32(sizes + 4, header.storedSize);
  m_sum += ArchiveSum(sizes, sizeof sizes);
  if (!m_output.bSeek(place) || !m_output.bWrite(sizes, sizeof sizes) || !m_output.bSeek(m_size))
    return iLogReturn(ErrArchiveWrite, "ERROR: ArchiveWriter::iPatchSizes -> !bWrite -> return ErrArchiveWrite");
  return ArchiveWritten;
}

int ArchiveWriter::iFinish() {
  // The terminator and the offset are zero: only the check value itself is left out of the sum.
  unsigned char end[ARCHIVE_TERMINATOR_SIZE + ARCHIVE_TRAILER_SIZE] = {};
  StoreLittleEndian32(end + ARCHIVE_TERMINATOR_SIZE, 0u - m_sum);
  if (!bWrite(end, sizeof end))
    return iLogReturn(ErrArchiveWrite, "ERROR: ArchiveWriter::iFinish -> !bWrite -> return ErrArchiveWrite");
  if (m_size > UINT32_MAX)
    return iLogReturn(ErrArchiveLarge,
                      "ERROR: ArchiveWriter::iFinish -> m_size > UINT32_MAX -> return ErrArchiveLarge");
  return ArchiveWritten;
}

bool ArchiveWriter::bWrite(const unsigned char* pBytes, size_t nBytes) {
  m_sum += ArchiveSum(pBytes, nBytes);
  m_size += nBytes;
  return nBytes == 0 || m_output.bWrite(pBytes, nBytes);
}
