// The registry as the portable floors see it. On Windows it is the system's; elsewhere a store in memory that lives as
// long as the process, so that everything above it can be tested without Windows. Texts are code page 1250. Any thread.
#pragma once

#include <cstdint>

#include "foundation/CNString.h"

// A root or an open key. The roots have the system's own values.
using OsRegKey = void*;
inline OsRegKey const OS_HKEY_CLASSES_ROOT = reinterpret_cast<OsRegKey>(static_cast<uintptr_t>(0x80000000u));
inline OsRegKey const OS_HKEY_CURRENT_USER = reinterpret_cast<OsRegKey>(static_cast<uintptr_t>(0x80000001u));
inline OsRegKey const OS_HKEY_LOCAL_MACHINE = reinterpret_cast<OsRegKey>(static_cast<uintptr_t>(0x80000002u));

enum class OsRegType : uint32_t { None = 0, String = 1, ExpandString = 2, Binary = 3, Dword = 4, MultiString = 7 };
enum class OsRegAccess { Read, Full, Create };  // Create: make a missing key, with full access

// An open key, closed by its destructor.
class OsRegistryKey {
 public:
  OsRegistryKey() = default;
  ~OsRegistryKey() { Close(); }
  OsRegistryKey(const OsRegistryKey&) = delete;
  OsRegistryKey& operator=(const OsRegistryKey&) = delete;

  bool bOpen(OsRegKey hRoot, const char* szSubkey, OsRegAccess access);
  void Close();
  // Reads a value; at most lCapacity bytes fit. Strings arrive as code page 1250 with their terminator counted.
  bool bQuery(const char* szName, OsRegType& type, char* pData, long lCapacity, long& lSize) const;
  // For strings lSize counts the terminator.
  bool bSet(const char* szName, OsRegType type, const void* pData, long lSize);
  bool bDeleteValue(const char* szName);
  // Names by index from 0; false beyond the last.
  bool bEnumValue(unsigned uIndex, CNString& csName) const;
  bool bEnumSubkey(unsigned uIndex, CNString& csName) const;

 private:
  OsRegKey m_hKey = nullptr;
};

// Deletes a key without subkeys.
bool bOsDeleteRegistryKey(OsRegKey hRoot, const char* szSubkey);
