#include "archive/CNArchive.h"

#include <cstring>
#include <memory>
#include <new>

#include "archive/ArchiveSum.h"
#include "archive/ArchiveWalk.h"
#include "archive/EntryExtractor.h"
#include "foundation/Log.h"
#include "foundation/ResultCodes.h"

// False without memory: a hostile archive may claim millions of entries. The list is then empty.
static bool bAppend(const ArchiveEntryHeader& header, CNArray<CNArchiveEntry>& entries) {
  std::unique_ptr<CNArchiveEntry> pEntry(new (std::nothrow) CNArchiveEntry);
  if (pEntry) {
    pEntry->csName = header.csName;
    pEntry->unpackedSize = header.unpackedSize;
    pEntry->storedSize = header.storedSize;
    entries.Add(pEntry.get(), 1);
    if (entries[entries.Size() - 1] == pEntry.get()) return pEntry.release(), true;
  }
  entries.RemoveAll();
  return false;
}

struct CNArchive::Walk {
  EntryFeed feed;
  EntryExtractor extractor;
};

CNArchive::CNArchive(const char* szPath) { m_csPath = szPath; }

CNArchive::~CNArchive() { delete m_pWalk; }

int CNArchive::CheckArchive(ArchiveProgress* pProgress) {
  BlockReader file;
  if (!m_csPath.Ptr() || !file.bOpen(m_csPath.Ptr()))
    return iLogReturn(ErrZipFileNotFound, "ERROR: CNArchive::CheckArchive -> !bOpen -> return ErrZipFileNotFound");
  PercentReporter percent(pProgress, 0, 100, file.Size());
  uint32_t sum = 0;
  const unsigned char* pBytes;
  while (const size_t nBytes = file.Peek(BlockReader::BLOCK_SIZE, pBytes)) {
    sum += ArchiveSum(pBytes, nBytes);
    file.Skip(nBytes);
    percent.At(file.Position());
  }
  percent.Send(100);
  unsigned char checkValue[4] = {};
  if (file.Size() >= ARCHIVE_TRAILER_SIZE) {
    file.SeekTo(file.Size() - ARCHIVE_TRAILER_SIZE);
    if (file.Peek(4, pBytes) == 4) memcpy(checkValue, pBytes, 4);
  }
  sum += LittleEndian32(checkValue) - ArchiveSum(checkValue, 4);
  if (sum != 0 || file.Size() < ARCHIVE_TRAILER_SIZE || file.bFailed())
    return iLogReturn(ErrCRCError, "ERROR: CNArchive::CheckArchive -> sum != 0 -> return ErrCRCError");
  return ArchiveOk;
}

int CNArchive::ListEntries(CNArray<CNArchiveEntry>& entries) {
  if (!m_csPath.Ptr())
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNArchive::ListEntries -> !m_csPath -> return FUNCTION_ERROR");
  ArchiveWalk walk;
  if (!walk.bOpen(m_csPath.Ptr()))
    return iLogReturn(ErrArchiveOpen, "ERROR: CNArchive::ListEntries -> !bOpen -> return ErrArchiveOpen");
  ArchiveEntryHeader header;
  ArchiveWalk::Step step;
  while ((step = walk.Next(header)) == ArchiveWalk::Step::Entry) {
    if (!bAppend(header, entries))
      return iLogReturn(FUNCTION_ERROR, "ERROR: CNArchive::ListEntries -> !bAppend -> return FUNCTION_ERROR");
  }
  if (step == ArchiveWalk::Step::End) return ArchiveOk;
  return iLogReturn(ErrCRCError, "ERROR: CNArchive::ListEntries -> damaged after %d entries -> return ErrCRCError",
                    walk.NextIndex());
}

int CNArchive::ExtractEntry(int iIndex, const char* szFolder, ArchiveProgress* pProgress, int iBasePercent,
                            int iSpanPercent, bool bKeepFolder) {
  if (!m_csPath.Ptr() || !szFolder)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNArchive::ExtractEntry -> !m_csPath || !szFolder -> return FUNCTION_ERROR");
  ArchiveEntryHeader header;
  const int iFound = iFindEntry(iIndex, header);
  if (iFound != ArchiveOk) return iFound;
  PercentReporter percent(pProgress, iBasePercent, iSpanPercent, header.unpackedSize);
  return m_pWalk->extractor.iExtract(header, m_pWalk->feed, {szFolder, bKeepFolder, m_pJournal}, percent);
}

bool CNArchive::bOpenWalk(int iIndex) {
  delete m_pWalk;
  m_pWalk = new (std::nothrow) Walk;
  if (m_pWalk && m_pWalk->feed.bOpen(m_csPath.Ptr(), iIndex, m_bReadAhead)) return true;
  delete m_pWalk;
  m_pWalk = nullptr;
  return false;
}

void CNArchive::StartReadAhead() {
  m_bReadAhead = true;
  if (m_csPath.Ptr()) bOpenWalk(0);  // what cannot be opened is told when it is needed
}

// Goes on from the entry that was read last; only an earlier one is looked for from the start.
int CNArchive::iFindEntry(int iIndex, ArchiveEntryHeader& header) {
  if ((!m_pWalk || iIndex < m_pWalk->feed.NextIndex()) && !bOpenWalk(iIndex))
    return iLogReturn(ErrArchiveOpen, "ERROR: CNArchive::ExtractEntry -> !bOpen (entry %d) -> return ErrArchiveOpen",
                      iIndex);
  ArchiveWalk::Step step = ArchiveWalk::Step::End;
  while (iIndex >= m_pWalk->feed.NextIndex() && (step = m_pWalk->feed.Next(header)) == ArchiveWalk::Step::Entry)
    if (m_pWalk->feed.NextIndex() == iIndex + 1) return ArchiveOk;
  if (step == ArchiveWalk::Step::Damaged)
    return iLogReturn(ErrCRCError, "ERROR: CNArchive::ExtractEntry -> damaged before entry %d -> return ErrCRCError",
                      iIndex);
  return iLogReturn(ErrZipFileNotFound, "ERROR: CNArchive::ExtractEntry -> no entry %d -> return ErrZipFileNotFound",
                    iIndex);
}
