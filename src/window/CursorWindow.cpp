// Cursors of a script. An unseen window keeps each one while its dialog is there.
#include "window/CursorWindow.h"

#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/SimpleWindows.h"

namespace {

const struct {
  const char* szName;
  const wchar_t* pCursor;
} SYSTEM_CURSORS[] = {
    {"ARROW", IDC_ARROW}, {"HAND", IDC_HAND}, {"WAIT", IDC_WAIT},        {"CROSS", IDC_CROSS},  {"IBEAM", IDC_IBEAM},
    {"HELP", IDC_HELP},   {"NO", IDC_NO},     {"BUSY", IDC_APPSTARTING}, {"MOVE", IDC_SIZEALL},
};

HCURSOR hLoad(const char* szName) {
  for (const auto& row : SYSTEM_CURSORS)
    if (strcmp(row.szName, szName) == 0) return LoadCursorW(nullptr, row.pCursor);
  CNString csPath;
  if (!bFindScriptFile(szName, csPath)) return nullptr;
  return static_cast<HCURSOR>(
      LoadImageW(nullptr, Wide(csPath.Text()), IMAGE_CURSOR, 0, 0, LR_LOADFROMFILE | LR_DEFAULTSIZE));
}

HCURSOR hKept(HWND hKeeper) { return reinterpret_cast<HCURSOR>(SendMessageW(hKeeper, STM_GETIMAGE, IMAGE_CURSOR, 0)); }

// The system refuses to destroy its own cursors.
LRESULT CALLBACK KeeperProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == WM_DESTROY)
    DestroyCursor(reinterpret_cast<HCURSOR>(SendMessageW(hWnd, STM_SETIMAGE, IMAGE_CURSOR, 0)));
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

void Created(NativeControl& native) {
  const char* szSource = Simple(native).szSource();
  const HCURSOR hCursor = hLoad(szSource);
  if (!hCursor) LogPrintf("ERROR: CNCursor::Create -> !hLoad(%s)", szSource);
  PutBefore(native.hWnd(), KeeperProc);
  SendMessageW(native.hWnd(), STM_SETIMAGE, IMAGE_CURSOR, reinterpret_cast<LPARAM>(hCursor));
}

HCURSOR hNamed(const ShownDialog& dialog, const char* szName) {
  const CNArray<BaseControl>& controls = dialog.Info().m_Controls;
  for (int i = 0; i < controls.Size(); i++) {
    if (controls[i]->Kind() != ControlKind::Cursor || strcmp(controls[i]->m_csName.Text(), szName) != 0) continue;
    const NativeControl* pKeeper = dialog.pFind(*controls[i]);
    if (const HCURSOR hCursor = pKeeper ? hKept(pKeeper->hWnd()) : nullptr) return hCursor;
  }
  return nullptr;
}

bool bIsLink(const BaseControl& control) {
  return control.Kind() == ControlKind::Static && static_cast<const CNStatic&>(control).m_bLink;
}

}  // namespace

bool bSetScriptCursor(const ShownDialog& dialog, HWND hOver) {
  const NativeControl* pOver = dialog.pFindWindow(hOver);
  const char* szName = pOver ? pOver->Control().m_csName.Text() : "";
  HCURSOR hCursor = *szName ? hNamed(dialog, szName) : nullptr;
  if (!hCursor && pOver && bIsLink(pOver->Control())) hCursor = LoadCursorW(nullptr, IDC_HAND);
  if (!hCursor && !(pOver && pOver->Kind().bField)) hCursor = hNamed(dialog, "");
  if (hCursor) SetCursor(hCursor);
  return hCursor != nullptr;
}

const NativeKind g_CursorWindow = {.kind = ControlKind::Cursor, .pPrepare = PrepareUnseen, .pCreated = Created};
