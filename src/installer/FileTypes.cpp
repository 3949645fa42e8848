// What the Explorer knows of the product: its entry in the context menu of files, and its file types. All of it stands
// below HKEY_CLASSES_ROOT for all users.
#include <windows.h>
// after windows.h
#include <shlobj.h>

#include <cstring>

#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"

static const char CLASSES[] = "Software\\Classes\\";

// Writes the default value of a key below the classes.
static bool bWriteClass(const char* szKey, const char* szBelow, const char* szText) {
  return COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, Joined(CLASSES, szKey, szBelow).Text(), "", szText,
                                         nullptr) == EVERYTHING_IS_OK;
}

// "C:\folder\program.exe" "%1"
void CNInstallWizard::GetOpenCommand(CNString& csProgram, CNString& csCommand) {
  GetDestination(csProgram);
  csProgram.Concat(Joined("\\", szValue("program_file")).Text());
  csCommand.Printf("GetOpenCommand", "csCommand", "\"%s\" \"%%1\"", csProgram.Text());
}

// ---- the context menu ----

// Uninstalling deletes the key with all below it: it must be one entry of a kind of files, never a branch with others'.
static bool bIsMenuKey(const char* szKey) {
  const char* pShell = szKey;
  while (*pShell && strncmp(pShell, "\\shell\\", 7) != 0) pShell++;
  return pShell != szKey && pShell[0] && pShell[7] && !strchr(pShell + 7, '\\') && !strchr(szKey, ';');
}

void CNInstallWizard::GetMenuKey(CNString& csKey) {
  csKey = szValue("context_menu_key");
  if (csKey.bEmpty()) csKey = Joined("*\\shell\\", szValue("program_name"));
}

int CNInstallWizard::iAddToContextMenu(const char* szParam, int* pCommandResult) {
  CNString csKey, csText, csProgram, csCommand;
  if (!*szValue("program_file") || !*szValue("default_path"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddToContextMenu -> !program_file -> return FUNCTION_ERROR");
  if (strcmp(szValue("context_menu"), "0") == 0) return iAnswer(pCommandResult, COMMAND_NEGATIVE);  // not wanted
  GetMenuKey(csKey);
  csText = szParam;
  if (csText.bEmpty()) csText = Joined("Open with ", szValue("program_name"));
  GetOpenCommand(csProgram, csCommand);
  if (!bIsMenuKey(csKey.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddToContextMenu -> !bIsMenuKey(%s) -> return FUNCTION_ERROR",
                      csKey.Text());
  AddUndo("context_menu", csKey.Text());
  if (!bWriteClass(csKey.Text(), "", csText.Text()) || !bWriteClass(csKey.Text(), "\\command", csCommand.Text()))
    return FUNCTION_ERROR;
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- file types ----

// One piece of "file_types": ".extension|ProgID|description".
bool CNInstallWizard::bAddFileType(const char* szType) {
  const TextList parts(szType, "|");
  CNString csProgram, csCommand;
  char szTaken[512] = "";
  if (parts.Size() < 2 || parts[0][0] != '.' || !parts[0][1] || strchr(parts[0], '\\') || parts[1][0] == '.' ||
      parts[1][0] == '*' || strchr(parts[1], '\\'))
    return iLogReturn(0, "ERROR: CNInstallWizard::bAddFileType -> !%s -> return false", szType);
  GetOpenCommand(csProgram, csCommand);
  AddUndo("file_types", parts[1]);
  if (!bWriteClass(parts[1], "", parts.Size() > 2 ? parts[2] : parts[1]) ||
      !bWriteClass(parts[1], "\\DefaultIcon", Joined(csProgram.Text(), ",0").Text()) ||
      !bWriteClass(parts[1], "\\shell\\open\\command", csCommand.Text()))
    return false;
  // A type that another program has taken stays that program's.
  iReadRegistryKey(OS_HKEY_CLASSES_ROOT, parts[0], "", szTaken);
  return (*szTaken && strcmp(szTaken, parts[1]) != 0) || bWriteClass(parts[0], "", parts[1]);
}

int CNInstallWizard::iRegisterWithShell() {
  const TextList types(szValue("file_types"));
  int iResult = COMMAND_DONE;
  bool bDone = true;
  if (strcmp(szValue("context_menu"), "1") == 0) bDone = iAddToContextMenu("", &iResult) == EVERYTHING_IS_OK;
  for (int i = 0; i < types.Size(); i++) bDone = bAddFileType(types[i]) && bDone;
  if (types.Size()) SHChangeNotify(SHCNE_ASSOCCHANGED, SHCNF_IDLIST, nullptr, nullptr);
  const char* szDictionaries = szValue("dict_path");
  if (*szDictionaries && strcmp(szDictionaries, "none") != 0)
    bDone = bWriteProductValue("DictPath", szDictionaries) && bDone;
  return bDone ? EVERYTHING_IS_OK : FUNCTION_ERROR;
}
