// The registry operations of wizards' commands.
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "wizard/COrbitWizard.h"

namespace {

const long VALUE_CAPACITY = 512;  // bytes of the caller's buffer, terminator included

const char HEX_DIGITS[] = "0123456789abcdef";

// Groups of three characters, two hexadecimal digits and a separator: a last pair without separator is deliberately
// not written.
void ParseBinary(const char* szValue, CNString& csBytes) {
  const long lCount = static_cast<long>(strlen(szValue) / 3);
  csBytes.SetLength(lCount);
  if (!csBytes.Ptr() || csBytes.Length() != lCount) return;
  for (long l = 0; l < lCount; l++) {
    char szGroup[9] = {};
    strncpy(szGroup, szValue + l * 3, sizeof szGroup - 1);
    csBytes.Ptr()[l] = static_cast<char>(strtoul(szGroup, nullptr, 16));
  }
}

// Each byte takes three characters, the last separator being dropped; what the buffer cannot hold is left out.
void BinaryToText(char* szValue, long lSize) {
  unsigned char bytes[VALUE_CAPACITY];
  memcpy(bytes, szValue, static_cast<size_t>(lSize));
  const long lCount = lSize > VALUE_CAPACITY / 3 ? VALUE_CAPACITY / 3 : lSize;
  char* pOut = szValue;
  for (long l = 0; l < lCount; l++) {
    *pOut++ = HEX_DIGITS[bytes[l] >> 4];
    *pOut++ = HEX_DIGITS[bytes[l] & 15];
    *pOut++ = ' ';
  }
  if (lCount > 0) pOut--;
  *pOut = 0;
}

// Deliberately only the lowest byte, as a signed character: 200 reads as "ffffffc8".
void NumberToText(char* szValue, long lSize) {
  const int iLowByte = lSize > 0 ? static_cast<signed char>(szValue[0]) : 0;
  snprintf(szValue, VALUE_CAPACITY, "%x", static_cast<unsigned>(iLowByte));
}

// The system may hand out a string without its terminator.
void Terminate(char* szValue, long lSize) { szValue[lSize < VALUE_CAPACITY ? lSize : VALUE_CAPACITY - 1] = 0; }

bool bWrite(OsRegistryKey& key, const char* szName, const char* szValue, const char* szType) {
  if (szType && strstr(szType, "HEX_VALUE")) {
    // The word says hexadecimal, the digits are read as decimal: deliberate.
    const int32_t iNumber = static_cast<int32_t>(strtoll(szValue, nullptr, 10));
    return key.bSet(szName, OsRegType::Dword, &iNumber, sizeof iNumber);
  }
  if (szType && strstr(szType, "BIN_VALUE")) {
    CNString csBytes;
    ParseBinary(szValue, csBytes);
    return key.bSet(szName, OsRegType::Binary, csBytes.Text(), csBytes.Length());
  }
  return key.bSet(szName, OsRegType::String, szValue, static_cast<long>(strlen(szValue)) + 1);
}

}  // namespace

int COrbitWizard::iReadRegistryKey(OsRegKey hKeyName, const char* szSubkey, const char* szName, char* szValue) {
  if (!hKeyName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iReadRegistryKey -> !hKeyName -> return PRECONDITIONS_NOT_VALID");
  if (!szSubkey || !*szSubkey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iReadRegistryKey -> !szSubkey || !*szSubkey -> return PRECONDITIONS_NOT_VALID");
  if (!szValue)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iReadRegistryKey -> !szValue -> return PRECONDITIONS_NOT_VALID");
  OsRegistryKey key;
  if (!key.bOpen(hKeyName, szSubkey, OsRegAccess::Read)) return REG_KEY_ERROR;  // an ordinary answer: not logged
  OsRegType type = OsRegType::None;
  long lSize = 0;
  if (!key.bQuery(szName, type, szValue, VALUE_CAPACITY, lSize))
    return iLogReturn(REG_KEY_ERROR,
                      "INFO: COrbitWizard::iReadRegistryKey -> lResult!=ERROR_SUCCESS -> RegQueryValueEx(%s) -> return "
                      "REG_KEY_ERROR",
                      szName ? szName : "");
  static const struct {
    OsRegType type;
    void (*pConvert)(char* szValue, long lSize);
  } CONVERSIONS[] = {{OsRegType::Binary, BinaryToText}, {OsRegType::Dword, NumberToText}};
  for (const auto& row : CONVERSIONS)
    if (row.type == type) return row.pConvert(szValue, lSize), EVERYTHING_IS_OK;
  Terminate(szValue, lSize);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iWriteRegistryKey(OsRegKey hKeyName, const char* szSubkey, const char* szName, const char* szValue,
                                    const char* szType) {
  if (!hKeyName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iWriteRegistryKey -> !hKeyName -> return PRECONDITIONS_NOT_VALID");
  if (!szSubkey || !*szSubkey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iWriteRegistryKey -> !szSubkey || !*szSubkey -> return PRECONDITIONS_NOT_VALID");
  if (!szValue)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iWriteRegistryKey -> !szValue -> return PRECONDITIONS_NOT_VALID");
  OsRegistryKey key;
  if (!key.bOpen(hKeyName, szSubkey, OsRegAccess::Create))
    return iLogReturn(REG_KEY_ERROR,
                      "ERROR: COrbitWizard::iWriteRegistryKey -> lResult!=ERROR_SUCCESS -> RegCreateKeyEx(%s) return "
                      "REG_KEY_ERROR",
                      szSubkey);
  if (!bWrite(key, szName, szValue, szType))
    return iLogReturn(REG_KEY_ERROR,
                      "ERROR: COrbitWizard::iWriteRegistryKey -> lResult!=ERROR_SUCCESS -> RegSetValueEx(%s,%s) return "
                      "REG_KEY_ERROR",
                      szName ? szName : "", szValue);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iDeleteRegistryKey(OsRegKey hKeyName, const char* szSubkey) {
  if (!hKeyName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iDeleteRegistryKey -> !hKeyName -> return PRECONDITIONS_NOT_VALID");
  if (!szSubkey || !*szSubkey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iDeleteRegistryKey -> !szSubkey || !*szSubkey -> return PRECONDITIONS_NOT_VALID");
  OsRegistryKey key;
  if (!key.bOpen(hKeyName, szSubkey, OsRegAccess::Full)) return EVERYTHING_IS_OK;  // a missing key counts as deleted
  CNString csChild, csPath, csNext;
  for (unsigned uKept = 0; key.bEnumSubkey(uKept, csChild);) {
    csPath.Printf("COrbitWizard::iDeleteRegistryKey", "csPath", "%s\\%s", szSubkey, csChild.Text());
    iDeleteRegistryKey(hKeyName, csPath.Text());
    // A child that the system does not let go must not be tried for ever.
    if (key.bEnumSubkey(uKept, csNext) && strcmp(csNext.Text(), csChild.Text()) == 0) uKept++;
  }
  key.Close();
  if (!bOsDeleteRegistryKey(hKeyName, szSubkey))
    return iLogReturn(REG_KEY_ERROR,
                      "INFO: COrbitWizard::iDeleteRegistryKey -> lResult!=ERROR_SUCCESS -> RegDeleteKey(%s) -> return "
                      "REG_KEY_ERROR",
                      szSubkey);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iDeleteRegistryValue(OsRegKey hKeyName, const char* szSubkey, const char* szKey) {
  if (!hKeyName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iDeleteRegistryValue -> !hKeyName -> return PRECONDITIONS_NOT_VALID");
  if (!szSubkey || !*szSubkey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iDeleteRegistryValue -> !szSubkey || !*szSubkey -> return PRECONDITIONS_NOT_VALID");
  if (!szKey || !*szKey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iDeleteRegistryValue -> !szKey || !*szKey -> return PRECONDITIONS_NOT_VALID");
  OsRegistryKey key;
  if (!key.bOpen(hKeyName, szSubkey, OsRegAccess::Full))
    return iLogReturn(
        REG_KEY_ERROR,
        "INFO: COrbitWizard::iDeleteRegistryValue -> lResult!=ERROR_SUCCESS -> RegOpenKeyEx(%s) -> return "
        "REG_KEY_ERROR",
        szSubkey);
  if (!key.bDeleteValue(szKey))
    return iLogReturn(REG_KEY_ERROR,
                      "INFO: COrbitWizard::iDeleteRegistryValue -> lResult!=ERROR_SUCCESS -> RegDeleteValue(%s) -> "
                      "return REG_KEY_ERROR",
                      szKey);
  return EVERYTHING_IS_OK;
}

// Despite its name it deliberately lists the names of values.
int COrbitWizard::iEnumRegistryKey(OsRegKey hKeyName, const char* szSubkey, CNCharArray& names) {
  if (!hKeyName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iEnumRegistryKey -> !hKeyName -> return PRECONDITIONS_NOT_VALID");
  if (!szSubkey || !*szSubkey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iEnumRegistryKey -> !szSubkey || !*szSubkey -> return PRECONDITIONS_NOT_VALID");
  OsRegistryKey key;
  if (!key.bOpen(hKeyName, szSubkey, OsRegAccess::Full))
    return iLogReturn(REG_KEY_ERROR,
                      "INFO: COrbitWizard::iEnumRegistryKey -> lResult!=ERROR_SUCCESS -> RegOpenKeyEx(%s) -> return "
                      "REG_KEY_ERROR",
                      szSubkey);
  CNString csName;
  for (unsigned u = 0; key.bEnumValue(u, csName); u++) names.Add(csName.Text(), 1);
  return EVERYTHING_IS_OK;
}
