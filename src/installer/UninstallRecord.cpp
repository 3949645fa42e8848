#include "installer/UninstallRecord.h"

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "installer/CommandTools.h"

const char UninstallRecord::FILE_NAME[] = "Uninstall.log";
const char* const UninstallRecord::KEYS[KEY_COUNT] = {"context_menu", "file_types", "fonts",       "scheduled_task",
                                                      "net_links",    "kv_ini",     "registry_key"};

const char* UninstallRecord::szItems(const char* szKey) {
  const CNVariable* pFound = m_Items.pFind(szKey);
  return pFound ? pFound->csValue.Text() : "";
}

bool UninstallRecord::bHolds(const char* szKey, const char* szItem) { return TextList(szItems(szKey)).bHas(szItem); }

void UninstallRecord::Insert(const char* szKey, const char* szItems) {
  const TextList items(szItems);
  for (int i = 0; i < items.Size(); i++)
    if (!bHolds(szKey, items[i])) {
      const char* szBefore = this->szItems(szKey);
      m_Items.Set(szKey, Joined(szBefore, *szBefore ? ";" : "", items[i]).Text());
    }
}

// A run that broke off has left its items in the list only.
void UninstallRecord::Merge(const char* szFolder) {
  const CNString csFile = Joined(szFolder, "\\", FILE_NAME);
  const bool bRecord = bOsExists(csFile.Text());
  InstalledList list;
  list.bRead(Joined(szFolder, "\\", InstalledList::FILE_NAME).Text());
  for (const char* szKey : KEYS) {
    CNString csItems;
    // A damaged record is written anew.
    if (bRecord && CNConfigFile(csFile.Text()).iReadConfigString(szKey, csItems) == EVERYTHING_IS_OK)
      Insert(szKey, csItems.Text());
    if (const char* szListed = list.szValue(szKey)) Insert(szKey, szListed);
  }
}

void UninstallRecord::Add(const char* szKey, const char* szItem, const char* szFolder) {
  if (!bOsIsFolder(szFolder)) return Insert(szKey, szItem);
  InstalledList list;
  list.bRead(Joined(szFolder, "\\", InstalledList::FILE_NAME).Text());
  const char* szListed = list.szValue(szKey);
  Merge(szFolder);
  Insert(szKey, szItem);
  if (!szListed || !TextList(szListed).bHas(szItem))
    InstallJournal(Joined(szFolder, "\\").Text()).bOnValue(szKey, szItems(szKey));
  const CNString csFile = Joined(szFolder, "\\", FILE_NAME);
  if (bOsExists(csFile.Text())) CNConfigFile(csFile.Text()).iWriteConfigString(szKey, szItems(szKey));
}
