// Writes one archive entry into the destination: folders, content, times, attributes. One opening of each output file.
// One thread at a time.
#pragma once

#include "archive/CNArchive.h"
#include "archive/EntryFeed.h"

// Turns done / total into a whole number and passes on what is new. A total that is wrong does no harm.
class PercentReporter {
 public:
  PercentReporter(ArchiveProgress* pProgress, int iBase, int iSpan, uint64_t total)
      : m_pProgress(pProgress), m_iBase(iBase), m_iSpan(iSpan), m_total(total) {}
  void At(uint64_t done) {
    const uint64_t part = done < m_total ? done * static_cast<unsigned>(m_iSpan) / m_total : m_iSpan;
    Send(m_iBase + static_cast<int>(part));
  }
  void Send(int iPercent) {
    if (m_pProgress && iPercent != m_iLast) m_pProgress->OnPercent(iPercent);
    m_iLast = iPercent;
  }

 private:
  ArchiveProgress* m_pProgress;
  int m_iBase;
  int m_iSpan;
  uint64_t m_total;
  int m_iLast = -1;
};

// Where an entry goes.
struct ExtractTarget {
  const char* szFolder;  // ends with a backslash
  bool bKeepFolder;
  ArchiveJournal* pJournal;  // may be null
};

class EntryExtractor {
 public:
  // Extracts the entry whose data the feed stands at. Returns an ArchiveResult; a failure has written its line.
  int iExtract(const ArchiveEntryHeader& entry, EntryFeed& feed, const ExtractTarget& target, PercentReporter& percent);

 private:
  int iChoosePath(const ArchiveEntryHeader& entry, const ExtractTarget& target, CNString& csRelative);
  int iMakeFolders(const ArchiveEntryHeader& entry, const ExtractTarget& target, const CNString& csRelative);
  int iOpenOutput(const ArchiveEntryHeader& entry, const char* szPath, bool& bIsNew);
  int iMakeFile(const ArchiveEntryHeader& entry, EntryFeed& feed, const char* szPath, PercentReporter& percent,
                ArchiveFileMark& mark, bool& bTouched);
  int iWriteContent(const ArchiveEntryHeader& entry, EntryFeed& feed, PercentReporter& percent, ArchiveFileMark& mark);
  int iFinish(const ArchiveEntryHeader& entry, const char* szPath, bool bIsNew, ArchiveFileMark& mark);

  OsFile m_output;
  CNString m_csReadyFolder;     // the folder of the last entry: there, and no link on the way to it
  bool m_bFreshFolder = false;  // that folder did not exist before, and all files in it are new with usual attributes
};

// An entry's name fit for a diagnostic line: control characters, which could begin a line of their own, become '?'.
CNString csNameForLog(const CNString& csName);
