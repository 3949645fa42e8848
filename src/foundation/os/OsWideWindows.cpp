#include <windows.h>

#include <cstdlib>
#include <cstring>
#include <memory>
#include <new>

#include "foundation/os/OsWide.h"

namespace {

// Folders may be this long, files twelve characters longer.
const size_t USUAL_PATH_LIMIT = MAX_PATH - 12;
const wchar_t LONG_PREFIX[] = L"\\\\?\\";
const wchar_t LONG_SHARE_PREFIX[] = L"\\\\?\\UNC";

wchar_t* Join(const wchar_t* pPrefix, const wchar_t* pPath) {
  const size_t nPrefix = std::wcslen(pPrefix), nPath = std::wcslen(pPath);
  wchar_t* const pJoined = static_cast<wchar_t*>(std::malloc((nPrefix + nPath + 1) * sizeof(wchar_t)));
  if (!pJoined) return nullptr;
  std::memcpy(pJoined, pPrefix, nPrefix * sizeof(wchar_t));
  std::memcpy(pJoined + nPrefix, pPath, (nPath + 1) * sizeof(wchar_t));
  return pJoined;
}

}  // namespace

WidePath::WidePath(const char* szPath) : m_path(szPath) {
  const wchar_t* const pPath = m_path;
  if (!pPath || std::wcslen(pPath) < USUAL_PATH_LIMIT || std::wcsncmp(pPath, LONG_PREFIX, 4) == 0) return;
  const DWORD dwSize = GetFullPathNameW(pPath, 0, nullptr, nullptr);
  const std::unique_ptr<wchar_t[]> pFull(dwSize ? new (std::nothrow) wchar_t[dwSize] : nullptr);
  if (!pFull || !GetFullPathNameW(pPath, dwSize, pFull.get(), nullptr)) return;
  // \\server\share becomes \\?\UNC\server\share
  const bool bShare = pFull[0] == L'\\' && pFull[1] == L'\\';
  m_pLong = bShare ? Join(LONG_SHARE_PREFIX, pFull.get() + 1) : Join(LONG_PREFIX, pFull.get());
}

WidePath::~WidePath() { std::free(m_pLong); }

bool bNarrowPath(const wchar_t* pPath, CNString& csOut) {
  if (bNarrow(pPath, csOut)) return true;
  const DWORD dwSize = GetShortPathNameW(pPath, nullptr, 0);
  const std::unique_ptr<wchar_t[]> pShort(dwSize ? new (std::nothrow) wchar_t[dwSize] : nullptr);
  return pShort && GetShortPathNameW(pPath, pShort.get(), dwSize) && bNarrow(pShort.get(), csOut);
}
