// The registry in memory: a tree of keys whose names, like the system's, are compared without regard to case.
#include <cstring>
#include <mutex>

#include "foundation/CNArray.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsRegistry.h"

namespace {

struct Value {
  CNString csName;
  OsRegType type = OsRegType::None;
  CNString csData;
};

struct Key {
  CNString csName;
  CNArray<Value> values;
  CNArray<Key> subkeys;  // sorted by name, as the system lists them
};

// What an OsRegistryKey holds. The key is looked up by its path for every call: it may have been deleted meanwhile.
struct OpenKey {
  OsRegKey hRoot = nullptr;
  CNString csPath;
  OsRegAccess access = OsRegAccess::Read;
};

struct Store {
  std::mutex mutex;
  Key roots[3];
};

Store& TheStore() {
  static Store store;
  return store;
}

bool bIsText(OsRegType type) {
  return type == OsRegType::String || type == OsRegType::ExpandString || type == OsRegType::MultiString;
}

Key* Root(OsRegKey hRoot) {
  const OsRegKey known[] = {OS_HKEY_CLASSES_ROOT, OS_HKEY_CURRENT_USER, OS_HKEY_LOCAL_MACHINE};
  for (int i = 0; i < 3; i++)
    if (known[i] == hRoot) return &TheStore().roots[i];
  return nullptr;
}

Key* Subkey(Key& parent, const char* szName, bool bCreate) {
  int i = 0;
  for (; i < parent.subkeys.Size(); i++) {
    const int iOrder = iOsCompareNoCase(parent.subkeys[i]->csName.Text(), szName);
    if (iOrder == 0) return parent.subkeys[i];
    if (iOrder > 0) break;
  }
  if (!bCreate) return nullptr;
  Key* const pKey = new Key;
  pKey->csName = szName;
  if (i == parent.subkeys.Size())
    parent.subkeys.Add(pKey, 1);
  else
    parent.subkeys.Insert(pKey, i);
  return pKey;
}

// Walks down a path of names between backslashes; pParent receives the key above the last one.
Key* Walk(OsRegKey hRoot, const char* szPath, bool bCreate, Key** pParent = nullptr) {
  Key* pKey = Root(hRoot);
  CNCharArray names;
  CNString csPath(szPath, 0);
  names.Set(csPath.Ptr(), "\\", false);
  for (int i = 0; pKey && i < names.Size(); i++) {
    if (!*names[i]) continue;
    if (pParent) *pParent = pKey;
    pKey = Subkey(*pKey, names[i], bCreate);
  }
  return pKey;
}

Key* Find(OsRegKey hKey) {
  const OpenKey* const pOpen = static_cast<const OpenKey*>(hKey);
  return pOpen ? Walk(pOpen->hRoot, pOpen->csPath.Text(), false) : nullptr;
}

Key* FindWritable(OsRegKey hKey) {
  const OpenKey* const pOpen = static_cast<const OpenKey*>(hKey);
  return pOpen && pOpen->access != OsRegAccess::Read ? Find(hKey) : nullptr;
}

// A null name is the key's unnamed value, as an empty one.
Value* FindValue(const Key& key, const char* szName) {
  for (int i = 0; i < key.values.Size(); i++)
    if (iOsCompareNoCase(key.values[i]->csName.Text(), szName ? szName : "") == 0) return key.values[i];
  return nullptr;
}

}  // namespace

bool OsRegistryKey::bOpen(OsRegKey hRoot, const char* szSubkey, OsRegAccess access) {
  Close();
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  if (!szSubkey || !Walk(hRoot, szSubkey, access == OsRegAccess::Create)) return false;
  OpenKey* const pOpen = new OpenKey;
  pOpen->hRoot = hRoot;
  pOpen->csPath = szSubkey;
  pOpen->access = access;
  m_hKey = pOpen;
  return true;
}

void OsRegistryKey::Close() {
  delete static_cast<OpenKey*>(m_hKey);
  m_hKey = nullptr;
}

bool OsRegistryKey::bQuery(const char* szName, OsRegType& type, char* pData, long lCapacity, long& lSize) const {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  const Key* const pKey = Find(m_hKey);
  const Value* const pValue = pKey ? FindValue(*pKey, szName) : nullptr;
  if (!pValue || pValue->csData.Length() > lCapacity) return false;
  lSize = pValue->csData.Length();
  if (lSize > 0) std::memcpy(pData, pValue->csData.Ptr(), size_t(lSize));
  type = pValue->type;
  return true;
}

bool OsRegistryKey::bSet(const char* szName, OsRegType type, const void* pData, long lSize) {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  Key* const pKey = FindWritable(m_hKey);
  if (!pKey || lSize < 0 || (lSize > 0 && !pData)) return false;
  Value* pValue = FindValue(*pKey, szName);
  if (!pValue) {
    pValue = new Value;
    pValue->csName = szName ? szName : "";
    pKey->values.Add(pValue, 1);
  }
  pValue->type = type;
  if (!pValue->csData.Copy(pData ? static_cast<const char*>(pData) : "", lSize)) return false;
  // As on the system, a text comes back with its terminator whether it was given with one or not.
  const bool bTerminated = lSize > 0 && !pValue->csData.Ptr()[lSize - 1];
  return !bIsText(type) || bTerminated || pValue->csData.SetLength(lSize + 1);
}

bool OsRegistryKey::bDeleteValue(const char* szName) {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  Key* const pKey = FindWritable(m_hKey);
  Value* const pValue = pKey ? FindValue(*pKey, szName) : nullptr;
  if (pValue) pKey->values.Remove(pValue);
  return pValue != nullptr;
}

bool OsRegistryKey::bEnumValue(unsigned uIndex, CNString& csName) const {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  const Key* const pKey = Find(m_hKey);
  const Value* const pValue = pKey ? pKey->values[int(uIndex)] : nullptr;
  if (pValue) csName = pValue->csName;
  return pValue != nullptr;
}

bool OsRegistryKey::bEnumSubkey(unsigned uIndex, CNString& csName) const {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  const Key* const pKey = Find(m_hKey);
  const Key* const pSubkey = pKey ? pKey->subkeys[int(uIndex)] : nullptr;
  if (pSubkey) csName = pSubkey->csName;
  return pSubkey != nullptr;
}

bool bOsDeleteRegistryKey(OsRegKey hRoot, const char* szSubkey) {
  const std::lock_guard<std::mutex> lock(TheStore().mutex);
  Key* pParent = nullptr;
  Key* const pKey = szSubkey ? Walk(hRoot, szSubkey, false, &pParent) : nullptr;
  if (!pKey || !pParent || pKey->subkeys.Size() > 0) return false;
  pParent->subkeys.Remove(pKey);
  return true;
}
