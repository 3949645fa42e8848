// What the uninstaller must undo besides the files of the list: keys of Uninstall.log behind the names and places. Each
// holds items separated by ';', in the order in which they were made.
#pragma once

#include "controls/Variables.h"

class UninstallRecord {
 public:
  static const char FILE_NAME[];  // "Uninstall.log"

  // The keys in the order in which they are written. context_menu: a key below HKEY_CLASSES_ROOT. file_types: ProgIDs.
  // fonts: files in the system's Fonts folder. scheduled_task: names. net_links: full paths of shortcuts. kv_ini: the
  // file in the destination. registry_key: a key below HKEY_LOCAL_MACHINE.
  static const char* const KEYS[];
  static const int KEY_COUNT = 7;

  // Remembers an item, before it is made. The list of what was installed in szFolder (no trailing backslash), and a
  // record that stands there, get it at once, so that a run that breaks off can be undone.
  void Add(const char* szKey, const char* szItem, const char* szFolder);
  bool bHolds(const char* szKey, const char* szItem);
  // Takes over what the record and the list in szFolder hold: an installation over another one has to undo both.
  void Merge(const char* szFolder);
  const char* szItems(const char* szKey);

 private:
  void Insert(const char* szKey, const char* szItems);

  CNVariables m_Items;
};
