#include "installer/VersionText.h"

#include <cstdlib>
#include <cstring>

void MakeVersionText(const char* szDate, CNString& csVersion) {
  static const char MONTHS[] = "JanFebMarAprMayJunJulAugSepOctNovDec";
  char szMonth[4] = {};
  if (strlen(szDate) == 11) memcpy(szMonth, szDate, 3);
  const char* pMonth = szMonth[0] ? strstr(MONTHS, szMonth) : nullptr;
  if (!pMonth || (pMonth - MONTHS) % 3 != 0) {
    csVersion = szDate;
    return;
  }
  csVersion.Printf("MakeVersionText", "csVersion", "%04d.%02d.%02d", atoi(szDate + 7),
                   static_cast<int>(pMonth - MONTHS) / 3 + 1, atoi(szDate + 4));
}
