// The version of the product that an installation replaces, as the list in its folder tells.
#pragma once

#include "archive/InstalledList.h"

class StaleFiles {
 public:
  // Before the new installation's first line. szFolder ends with a backslash.
  void Read(const char* szFolder);
  // After the new installation's last line, when it has installed everything: deletes the files that only the older one
  // had, and the folders that it made and that are then empty. A file that has been changed since stays. One log line
  // for each. Does nothing when the folder held another product.
  void RemoveAll();

 private:
  void RemoveStale(const InstalledList& list, const InstalledList::Line& line);

  CNString m_csFolder;
  InstalledList m_old;
};
