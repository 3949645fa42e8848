// Reader of the product archive: a sequence of file entries, closed by a check value and the offset of the first entry.
// An object may be used by one thread at a time.
#pragma once

#include <cstdint>

#include "foundation/CNArray.h"
#include "foundation/os/Os.h"

// The reader's own result codes (9 is FUNCTION_ERROR: the archive's path is missing).
enum ArchiveResult : int {
  ArchiveOk = 0,
  ErrArchiveOpen = 1,      // the archive cannot be opened for reading
  ErrDestinationFile = 2,  // the destination file cannot be created or written, or its times cannot be set
  ErrTemporaryFile = 3,
  ErrTemporaryName = 5,
  ErrUnsafeName = 6,  // the entry's name would leave the destination folder, or is no file name
  ErrDestinationFolder = 12,
  ErrZipFileNotFound = 13,  // the archive is missing, or the asked entry is not in it
  ErrCRCError = 14,         // the check value does not match
};

// Where progress goes. Called on the thread that checks or extracts, only when the whole-number percentage changes.
class ArchiveProgress {
 public:
  virtual ~ArchiveProgress() = default;
  virtual void OnPercent(int iPercent) = 0;
};

struct CNArchiveEntry {
  CNString csName;
  uint32_t unpackedSize = 0;
  uint32_t storedSize = 0;
};

// What a whole file was like when it had been written.
struct ArchiveFileMark {
  uint64_t size = 0;
  uint64_t lastWrite = 0;  // as in OsFileTimes
  uint32_t sum = 0;        // CRC-32 of the content; 0 when it is not known
};

// Told of every file and folder before extraction makes it, so that what a broken run leaves behind is known too. False
// when that could not be noted down: it is then not made. szPath is relative to the destination folder, with
// backslashes.
class ArchiveJournal {
 public:
  virtual ~ArchiveJournal() = default;
  virtual bool bOnFolder(const char* szPath) = 0;
  virtual bool bOnFile(const char* szPath) = 0;
  // How it went with the file told of last: it is whole; or nothing was made, and what was there before is untouched.
  // Neither is said of a file of which a part was written.
  virtual void OnFileDone(const ArchiveFileMark& mark) = 0;
  virtual void OnFileNotMade() = 0;
};

struct ArchiveEntryHeader;

class CNArchive {
 public:
  explicit CNArchive(const char* szPath);
  ~CNArchive();
  CNArchive(const CNArchive&) = delete;
  CNArchive& operator=(const CNArchive&) = delete;

  // Verifies the whole file against its check value. Returns 0, 13 or 14.
  int CheckArchive(ArchiveProgress* pProgress = nullptr);
  // Appends one entry per archive entry; the list owns them. Returns 0, 1, 9 (no path; also without memory, the list is
  // then empty), or 14 when the entry area is damaged (the entries before the damage have been appended).
  int ListEntries(CNArray<CNArchiveEntry>& entries);
  // Extracts entry iIndex (from 0) into szFolder, which ends with a backslash: content, times, attributes. Progress
  // runs from iBasePercent over iSpanPercent. With bKeepFolder the destination's last folder name is put before the
  // entry's name. Entries asked for in order cost no search. A failure has written one diagnostic line with the entry's
  // name.
  int ExtractEntry(int iIndex, const char* szFolder, ArchiveProgress* pProgress = nullptr, int iBasePercent = 0,
                   int iSpanPercent = 100, bool bKeepFolder = false);
  // Has a thread read and inflate ahead of the entries that are extracted in order. It begins at once, with the first
  // entry; nothing is written before an entry is extracted.
  void StartReadAhead();
  // The journal must outlive the reader; null (the start value) tells nobody.
  void SetJournal(ArchiveJournal* pJournal) { m_pJournal = pJournal; }

 private:
  struct Walk;  // the open archive, at the next entry

  bool bOpenWalk(int iIndex);
  int iFindEntry(int iIndex, ArchiveEntryHeader& header);

  CNString m_csPath;
  Walk* m_pWalk = nullptr;
  bool m_bReadAhead = false;
  ArchiveJournal* m_pJournal = nullptr;
};
