// Reads a shortcut file back.
#pragma once

#include <string>

struct ShellLink {
  std::wstring wsTarget, wsArguments, wsFolder;
};

// False when the file is no shortcut.
bool bReadShellLink(const std::wstring& wsFile, ShellLink& link);
