#include "archive/ArchiveWalk.h"

bool ArchiveWalk::bOpen(const char* szPath) {
  m_iNext = 0;
  m_nextEntry = 0;
  m_bDamaged = true;
  if (!m_file.bOpen(szPath)) return false;
  if (m_file.Size() < ARCHIVE_TRAILER_SIZE) return true;
  m_file.SeekTo(m_file.Size() - 4);
  const unsigned char* pOffset;
  if (!bHas(4, pOffset)) return true;
  m_nextEntry = LittleEndian32(pOffset);
  m_bDamaged = m_nextEntry > m_file.Size();
  return true;
}

ArchiveWalk::Step ArchiveWalk::Next(ArchiveEntryHeader& entry) {
  if (m_bDamaged) return Step::Damaged;
  m_file.SeekTo(m_nextEntry);
  const unsigned char* pLength;
  if (!bHas(4, pLength)) return m_bDamaged = true, Step::Damaged;
  const uint32_t nameLength = LittleEndian32(pLength);
  if (nameLength == 0) return Step::End;
  m_file.Skip(4);
  if (nameLength > ARCHIVE_MAX_NAME || !bReadHeader(nameLength, entry)) return m_bDamaged = true, Step::Damaged;
  m_nextEntry = m_file.Position() + entry.storedSize;
  m_iNext++;
  return Step::Entry;
}

bool ArchiveWalk::bReadHeader(uint32_t nameLength, ArchiveEntryHeader& entry) {
  const unsigned char* p;
  if (!bHas(nameLength + ARCHIVE_FIELDS_SIZE, p)) return false;
  entry.csName.Copy(reinterpret_cast<const char*>(p), static_cast<long>(nameLength));
  uint32_t* const fields[] = {&entry.creationTimeHigh, &entry.lastAccessTimeHigh, &entry.lastWriteTimeHigh,
                              &entry.attributes,       &entry.unpackedSize,       &entry.storedSize};
  p += nameLength;
  for (uint32_t* pField : fields) {
    *pField = LittleEndian32(p);
    p += 4;
  }
  m_file.Skip(nameLength + ARCHIVE_FIELDS_SIZE);
  return entry.csName.Ptr() && entry.storedSize <= m_file.Size() - m_file.Position();
}
