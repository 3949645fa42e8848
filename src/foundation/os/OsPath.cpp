#include "foundation/os/OsPath.h"

#include "foundation/os/Os.h"

namespace {

struct Visit {
  bool (*pVisit)(const OsFolderEntry& entry, void* pContext);
  void* pContext;
};

bool bVisitNamed(const OsFolderEntry& entry, void* pContext) {
  const Visit& visit = *static_cast<Visit*>(pContext);
  return bOsIsDots(entry.csName.Text()) || visit.pVisit(entry, visit.pContext);
}

}  // namespace

bool bCutLastStep(CNString& csPath) {
  const char* const szPath = csPath.Text();
  long lLength = csPath.Length();
  while (lLength > 0 && bIsSlash(szPath[lLength - 1])) lLength--;
  while (lLength > 0 && !bIsSlash(szPath[lLength - 1]) && szPath[lLength - 1] != ':') lLength--;
  if (lLength == 0 || lLength == csPath.Length()) return false;
  return csPath.SetLength(lLength) != nullptr;
}

bool bAskUpwards(const char* szPath, bool (*bAsk)(const char* szPath, void* pContext), void* pContext) {
  CNString csPath(szPath, 0);
  const bool bRelative = csPath.bEmpty() || !(bIsSlash(csPath.Text()[0]) || csPath.Has(':'));
  do {
    if (!csPath.bEmpty() && bAsk(csPath.Text(), pContext)) return true;
  } while (bCutLastStep(csPath));
  return bRelative && bAsk(".", pContext);
}

bool bOsIsDots(const char* szName) { return szName[0] == '.' && (!szName[1] || (szName[1] == '.' && !szName[2])); }

bool bOsListFolder(const char* szPath, bool (*pVisit)(const OsFolderEntry& entry, void* pContext), void* pContext) {
  Visit visit = {pVisit, pContext};
  return OsListEntries(szPath, bVisitNamed, &visit) == OsListResult::Listed;
}

int iOsCompareNoCase(const char* szA, const char* szB) {
  const auto lower = [](char c) { return static_cast<unsigned char>(c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c); };
  while (*szA && lower(*szA) == lower(*szB)) szA++, szB++;
  return lower(*szA) - lower(*szB);
}
