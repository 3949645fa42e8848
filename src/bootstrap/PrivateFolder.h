// The folder that a packed file unpacks its setup program into, closed to everybody whom the system would not let
// change the installed program anyway. One thread.
#pragma once

#include <windows.h>

class PrivateFolder {
 public:
  PrivateFolder() = default;
  ~PrivateFolder() { Remove(); }
  PrivateFolder(const PrivateFolder&) = delete;
  PrivateFolder& operator=(const PrivateFolder&) = delete;

  // Makes it, under a name of 128 random bits, and holds it so that nobody can rename or delete it. An elevated process
  // makes it below the Windows folder's Temp for administrators and the system, any other one in the user's temporary
  // folder for that user. False when that very folder cannot be made: there is no other place.
  bool bMake();
  // Full path without a trailing backslash; "" when there is none.
  const wchar_t* Path() const { return m_szPath; }
  // Deletes the folder and all that is in it; what is still in use is tried again for a few seconds. Links in it are
  // deleted, never followed. Folders of other starters, which were killed, go as well (see RemoveLeft).
  void Remove();

 private:
  void RemoveLeft() const;
  bool bIsLeft(const wchar_t* szPath) const;

  wchar_t m_szPath[MAX_PATH] = L"";
  HANDLE m_hFolder = INVALID_HANDLE_VALUE;
};

// Deletes a folder with all that is in it. False when something of it stays. szPath has no trailing backslash.
bool bRemoveTree(const wchar_t* szPath);
