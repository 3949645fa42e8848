#include <windows.h>

#include <climits>
#include <cstring>
#include <memory>
#include <new>

#include "foundation/os/OsRegistry.h"
#include "foundation/os/OsWide.h"

namespace {

const DWORD VALUE_NAME_SIZE = 16384;  // the longest name of a value, with its terminator; keys' names are shorter

HKEY ToKey(OsRegKey key) { return static_cast<HKEY>(key); }

bool bIsText(DWORD dwType) { return dwType == REG_SZ || dwType == REG_EXPAND_SZ || dwType == REG_MULTI_SZ; }

// Texts of several parts hold zeros, so texts are converted part by part. Every result ends with a zero.
bool bNarrowParts(const wchar_t* pText, size_t nUnits, CNString& csOut) {
  csOut = "";
  for (size_t at = 0; at < nUnits;) {
    CNString csPart;
    bNarrow(pText + at, csPart);
    at += std::wcslen(pText + at) + 1;
    if (!csOut.Concat(csPart.Text(), csPart.Length() + 1)) return false;
  }
  return csOut.bEmpty() ? csOut.SetLength(1) != nullptr : true;
}

std::unique_ptr<wchar_t[]> WidenParts(const char* pText, size_t nBytes) {
  std::unique_ptr<wchar_t[]> pWide(new (std::nothrow) wchar_t[nBytes + 1]);
  CNString csText;
  if (!pWide || !csText.Copy(pText, long(nBytes))) return nullptr;
  for (size_t at = 0; at < nBytes; at += std::strlen(csText.Ptr() + at) + 1) {
    const Wide part(csText.Ptr() + at);
    if (!part) return nullptr;
    std::memcpy(pWide.get() + at, part, (std::wcslen(part) + 1) * sizeof(wchar_t));
  }
  pWide[nBytes] = 0;
  return pWide;
}

}  // namespace

bool OsRegistryKey::bOpen(OsRegKey hRoot, const char* szSubkey, OsRegAccess access) {
  Close();
  if (!szSubkey) return false;
  HKEY hKey = nullptr;
  const Wide subkey(szSubkey);
  const LSTATUS status =
      access == OsRegAccess::Create
          ? RegCreateKeyExW(ToKey(hRoot), subkey, 0, nullptr, 0, KEY_ALL_ACCESS, nullptr, &hKey, nullptr)
          : RegOpenKeyExW(ToKey(hRoot), subkey, 0, access == OsRegAccess::Full ? KEY_ALL_ACCESS : KEY_READ, &hKey);
  SetLastError(DWORD(status));
  if (status == ERROR_SUCCESS) m_hKey = hKey;
  return status == ERROR_SUCCESS;
}

void OsRegistryKey::Close() {
  if (m_hKey) RegCloseKey(ToKey(m_hKey));
  m_hKey = nullptr;
}

bool OsRegistryKey::bQuery(const char* szName, OsRegType& type, char* pData, long lCapacity, long& lSize) const {
  const Wide name(szName);
  DWORD dwType = REG_NONE, dwBytes = 0;
  if (!m_hKey || lCapacity < 0) return false;
  if (RegQueryValueExW(ToKey(m_hKey), name, nullptr, &dwType, nullptr, &dwBytes) != ERROR_SUCCESS) return false;
  // Two units more than asked for: stored texts may lack their terminator.
  const size_t nUnits = (size_t(dwBytes) + 1) / 2;
  const std::unique_ptr<wchar_t[]> pBuffer(new (std::nothrow) wchar_t[nUnits + 2]());
  if (!pBuffer || RegQueryValueExW(ToKey(m_hKey), name, nullptr, &dwType, reinterpret_cast<BYTE*>(pBuffer.get()),
                                   &dwBytes) != ERROR_SUCCESS)
    return false;
  CNString csText;
  if (bIsText(dwType) && !bNarrowParts(pBuffer.get(), nUnits, csText)) return false;
  const void* const pBytes = bIsText(dwType) ? static_cast<const void*>(csText.Ptr()) : pBuffer.get();
  const long lBytes = bIsText(dwType) ? csText.Length() : long(dwBytes);
  if (lBytes > lCapacity) return false;
  if (lBytes > 0) std::memcpy(pData, pBytes, size_t(lBytes));
  type = static_cast<OsRegType>(dwType);
  lSize = lBytes;
  return true;
}

bool OsRegistryKey::bSet(const char* szName, OsRegType type, const void* pData, long lSize) {
  if (!m_hKey || lSize < 0 || (lSize > 0 && !pData)) return false;
  const Wide name(szName);
  std::unique_ptr<wchar_t[]> pWide;
  const BYTE* pBytes = static_cast<const BYTE*>(pData);
  DWORD dwBytes = DWORD(lSize);
  if (bIsText(DWORD(type)) && lSize > 0) {
    pWide = WidenParts(static_cast<const char*>(pData), size_t(lSize));
    if (!pWide) return false;
    pBytes = reinterpret_cast<const BYTE*>(pWide.get());
    dwBytes *= sizeof(wchar_t);
  }
  const LSTATUS status = RegSetValueExW(ToKey(m_hKey), name, 0, DWORD(type), pBytes, dwBytes);
  SetLastError(DWORD(status));
  return status == ERROR_SUCCESS;
}

bool OsRegistryKey::bDeleteValue(const char* szName) {
  return m_hKey && RegDeleteValueW(ToKey(m_hKey), Wide(szName)) == ERROR_SUCCESS;
}

bool OsRegistryKey::bEnumValue(unsigned uIndex, CNString& csName) const {
  const std::unique_ptr<wchar_t[]> pName(new (std::nothrow) wchar_t[VALUE_NAME_SIZE]);
  DWORD dwLength = VALUE_NAME_SIZE;
  if (!m_hKey || !pName) return false;
  if (RegEnumValueW(ToKey(m_hKey), uIndex, pName.get(), &dwLength, nullptr, nullptr, nullptr, nullptr) != ERROR_SUCCESS)
    return false;
  bNarrow(pName.get(), csName);
  return true;
}

bool OsRegistryKey::bEnumSubkey(unsigned uIndex, CNString& csName) const {
  wchar_t name[256];
  DWORD dwLength = sizeof name / sizeof *name;
  if (!m_hKey ||
      RegEnumKeyExW(ToKey(m_hKey), uIndex, name, &dwLength, nullptr, nullptr, nullptr, nullptr) != ERROR_SUCCESS)
    return false;
  bNarrow(name, csName);
  return true;
}

bool bOsDeleteRegistryKey(OsRegKey hRoot, const char* szSubkey) {
  return szSubkey && *szSubkey && RegDeleteKeyW(ToKey(hRoot), Wide(szSubkey)) == ERROR_SUCCESS;
}
