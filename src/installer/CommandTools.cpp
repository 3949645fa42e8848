#include "installer/CommandTools.h"

#include <cstring>

#include "foundation/NamePattern.h"
#include "foundation/os/Os.h"

CNString Joined(const char* szA, const char* szB, const char* szC) {
  CNString csText(szA, 0);
  csText.Concat(szB);
  csText.Concat(szC);
  return csText;
}

TextList::TextList(const char* szText, const char* szSeparators) {
  CNString csPiece;
  while (*szText) {
    szText += strspn(szText, " ");
    size_t nLength = strcspn(szText, szSeparators);
    const char* pEnd = szText + nLength;
    while (nLength && szText[nLength - 1] == ' ') nLength--;
    if (nLength && csPiece.Copy(szText, static_cast<long>(nLength))) m_Pieces.Add(csPiece.Text(), 1);
    szText = *pEnd ? pEnd + 1 : pEnd;
  }
}

bool TextList::bHas(const char* szPiece) const {
  for (int i = 0; i < Size(); i++)
    if (iOsCompareNoCase(m_Pieces[i], szPiece) == 0) return true;
  return false;
}

void NoteWhole(InstallJournal& journal, const char* szFile) {
  OsFileInfo info;
  if (bOsGetFileInfo(szFile, info)) journal.OnFileDone({info.size, info.times.lastWrite, 0});
}

bool bWriteListed(const char* szFolder, const char* szName, const CNString& csText) {
  InstallJournal journal(Joined(szFolder, "\\").Text());
  const CNString csFile = Joined(szFolder, "\\", szName);
  OsFile file;
  if (!journal.bOnFile(szName) || !file.bOpen(csFile.Text(), OsOpenMode::Create) ||
      !file.bWrite(csText.Text(), static_cast<size_t>(csText.Length())) || !file.bClose())
    return false;
  NoteWhole(journal, csFile.Text());
  return true;
}

bool bIsBelow(const char* szPath, const char* szFolder) {
  const size_t nLength = strlen(szFolder);
  if (!nLength || strlen(szPath) < nLength || (szPath[nLength] && szPath[nLength] != '\\')) return false;
  CNString csHead;
  csHead.Copy(szPath, static_cast<long>(nLength));
  return iOsCompareNoCase(csHead.Text(), szFolder) == 0;
}

bool bIsFullPath(const char* szPath) {
  return (szPath[0] && szPath[1] == ':' && szPath[2] == '\\') || strncmp(szPath, "\\\\", 2) == 0;
}

namespace {

struct ByteCount {
  const char* szFolder;
  const char* szPattern;
  uint64_t bytes;
};

bool bCountBytes(const OsFolderEntry& entry, void* pContext) {
  ByteCount& count = *static_cast<ByteCount*>(pContext);
  if (entry.info.attributes & OS_REPARSE_POINT) return true;
  if (entry.info.attributes & OS_DIRECTORY)
    count.bytes += FolderBytes(Joined(count.szFolder, "\\", entry.csName.Text()).Text(), count.szPattern);
  else if (bMatchesPattern(entry.csName.Text(), count.szPattern))
    count.bytes += entry.info.size;
  return true;
}

}  // namespace

uint64_t FolderBytes(const char* szFolder, const char* szPattern) {
  ByteCount count = {szFolder, szPattern, 0};
  bOsListFolder(szFolder, bCountBytes, &count);
  return count.bytes;
}
