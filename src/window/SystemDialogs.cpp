#include "window/SystemDialogs.h"

#include <commdlg.h>
#include <shellapi.h>
#include <shlobj.h>

#include <cstring>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

// In the order of MessageIcon and MessageButtons.
const UINT ICONS[] = {0, MB_ICONERROR, MB_ICONQUESTION, MB_ICONEXCLAMATION, MB_ICONINFORMATION};
const UINT BUTTONS[] = {MB_OK,    MB_OKCANCEL,    MB_ABORTRETRYIGNORE, MB_YESNOCANCEL,
                        MB_YESNO, MB_RETRYCANCEL, MB_CANCELTRYCONTINUE};
static_assert(sizeof(ICONS) / sizeof(*ICONS) == static_cast<int>(MessageIcon::Information) + 1);
static_assert(sizeof(BUTTONS) / sizeof(*BUTTONS) == static_cast<int>(MessageButtons::CancelTryContinue) + 1);

// The folder chooser's new look lives in an OLE apartment.
class OleScope {
 public:
  OleScope() : m_bOpen(SUCCEEDED(OleInitialize(nullptr))) {}
  ~OleScope() {
    if (m_bOpen) OleUninitialize();
  }
  OleScope(const OleScope&) = delete;
  OleScope& operator=(const OleScope&) = delete;

 private:
  bool m_bOpen;
};

int CALLBACK SelectStartFolder(HWND hWnd, UINT uMessage, LPARAM, LPARAM pStart) {
  if (uMessage == BFFM_INITIALIZED && pStart) SendMessageW(hWnd, BFFM_SETSELECTIONW, TRUE, pStart);
  return 0;
}

// The chooser cannot select a folder that does not exist yet.
void CutToExistingFolder(CNString& csFolder) {
  while (!csFolder.bEmpty() && !bOsIsFolder(csFolder.Text())) csFolder.Trim('\\');
}

bool bIsMailAddress(const char* szTarget) { return strchr(szTarget, '@') && !strpbrk(szTarget, ":/\\"); }

}  // namespace

int iSystemMessage(HWND hOwner, const MessageText& message) {
  const UINT uType = ICONS[static_cast<int>(message.icon)] | BUTTONS[static_cast<int>(message.buttons)];
  return MessageBoxW(hOwner, Wide(message.szText), Wide(message.szCaption), uType | MB_SETFOREGROUND);
}

bool bSystemChooseFolder(HWND hOwner, const char* szTitle, CNString& csFolder) {
  OleScope ole;
  CNString csStart(csFolder);
  CutToExistingFolder(csStart);
  const CNWideText title(szTitle), start(csStart.Ptr());
  wchar_t path[MAX_PATH] = L"";
  BROWSEINFOW browse = {};
  browse.hwndOwner = hOwner;
  browse.pszDisplayName = path;
  browse.lpszTitle = reinterpret_cast<const wchar_t*>(title.Ptr());
  browse.ulFlags = BIF_RETURNONLYFSDIRS | BIF_NEWDIALOGSTYLE;
  browse.lpfn = SelectStartFolder;
  browse.lParam = reinterpret_cast<LPARAM>(start.Ptr());
  const OwnedTaskMemory item(SHBrowseForFolderW(&browse));
  return item && SHGetPathFromIDListW(static_cast<LPCITEMIDLIST>(item.Get()), path) && bNarrowPath(path, csFolder);
}

bool bSystemChooseFile(HWND hOwner, const char* szTitle, CNString& csFile) {
  OleScope ole;
  const CNWideText title(szTitle);
  wchar_t path[MAX_PATH] = L"";
  if (!csFile.bEmpty()) lstrcpynW(path, Wide(csFile.Text()), MAX_PATH);
  OPENFILENAMEW open = {};
  open.lStructSize = sizeof(open);
  open.hwndOwner = hOwner;
  open.lpstrFile = path;
  open.nMaxFile = MAX_PATH;
  open.lpstrTitle = reinterpret_cast<const wchar_t*>(title.Ptr());
  open.Flags = OFN_EXPLORER | OFN_FILEMUSTEXIST | OFN_HIDEREADONLY | OFN_NOCHANGEDIR;
  return GetOpenFileNameW(&open) && bNarrowPath(path, csFile);
}

bool bSystemOpen(HWND hOwner, const char* szTarget, const char* szFolder) {
  if (!szTarget || !*szTarget) return false;
  CNString csTarget;
  csTarget = bIsMailAddress(szTarget) ? "mailto:" : "";
  csTarget.Concat(szTarget);
  OleScope ole;  // some of the shell's handlers are objects
  const auto result = ShellExecuteW(hOwner, L"open", Wide(csTarget.Text()), nullptr, Wide(szFolder), SW_SHOWDEFAULT);
  return reinterpret_cast<INT_PTR>(result) > 32;  // the call's own boundary between failure and success
}
