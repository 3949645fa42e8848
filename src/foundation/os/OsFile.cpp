// What an open file is on every system; OsFileWindows.cpp and OsFilePosix.cpp have the rest.
#include <utility>

#include "foundation/os/Os.h"

OsFile& OsFile::operator=(OsFile&& other) noexcept {
  if (this == &other) return *this;
  bClose();
  m_handle = std::exchange(other.m_handle, -1);
  return *this;
}
