// The list of what an installation made ("Installed.lst", see docs/formats.md), read back: by the uninstaller and by a
// later installation into the same folder. The file may be damaged or written by anybody; its paths are unchecked.
#pragma once

#include <memory>

#include "archive/CNArchive.h"

class InstalledList {
 public:
  static const char FILE_NAME[];     // "Installed.lst"
  static const char FOLDERS_FILE[];  // "orbit-folders.lst" in the temporary folder: "P" lines, until a list has them

  struct Line {
    char cKind = 0;        // F file, D folder, W in the Windows folder, P folder above, R own record, V value
    int iNumber = 0;       // its index
    bool bMarked = false;  // only files: mark tells what the whole file was; without one the run broke off
    const char* szText = nullptr;
    ArchiveFileMark mark;
  };

  // False when there is no such file, it cannot be read, or there is no memory; the list is then empty. A last line
  // without an end is left out: whoever wrote it was stopped in the middle.
  bool bRead(const char* szFile);

  int Size() const { return m_iSize; }
  const Line& operator[](int i) const { return m_lines[i]; }
  // Lines that are none of ours: the file is damaged.
  int iBadLines() const { return m_iBad; }
  // The last line of the file szPath, letter case aside; null when there is none.
  const Line* pFile(const char* szPath) const;
  // The last value of that key; null when there is none.
  const char* szValue(const char* szKey) const;

 private:
  void TakeLine(char* szLine, size_t nLength);
  void SortFiles();

  std::unique_ptr<char[]> m_text;
  std::unique_ptr<Line[]> m_lines;
  std::unique_ptr<const Line*[]> m_files;  // sorted by path, then by number
  int m_iSize = 0;
  int m_iFiles = 0;
  int m_iBad = 0;
};

enum class InstalledFileState {
  Gone,
  Same,     // as it was installed, or half of it, left by a run that broke off
  Changed,  // somebody has put other content there, or a folder
};
// Size and time decide; only a file of the same size and another time is read. One whose content was stored in several
// pieces counts as changed then.
InstalledFileState CheckInstalledFile(const char* szPath, const InstalledList::Line& line);
