// Fields of formatted text.
#include <cstring>

#include "foundation/os/Os.h"
#include "window/SimpleWindows.h"
#include "window/SystemDialogs.h"
// after windows.h, which it builds on
#include <richedit.h>

namespace {

const UINT TELL_FAULT = WM_APP;  // to the field: its file could not be opened

const CNRtf& Rtf(const NativeControl& native) { return static_cast<const CNRtf&>(native.Control()); }

// The field is a wide one whatever its description says: another would lose letters that the system's own code page
// does not have.
void Prepare(NativeControl&, CREATESTRUCTW& window) {
  hSystemLibrary(L"riched20.dll");
  window.lpszClass = L"RichEdit20W";
  window.lpszName = nullptr;
  const LONG lWrites = ES_MULTILINE | ES_READONLY;
  if ((window.style & lWrites) == ES_MULTILINE) window.style |= ES_WANTRETURN;
}

DWORD CALLBACK ReadPart(DWORD_PTR pFile, BYTE* pBytes, LONG lBytes, LONG* plRead) {
  const long lRead = reinterpret_cast<OsFile*>(pFile)->lRead(pBytes, static_cast<size_t>(lBytes));
  *plRead = lRead < 0 ? 0 : lRead;
  return lRead < 0;
}

bool bLoadFile(HWND hWnd, const char* szName) {
  CNString csPath;
  OsFile file;
  if (!bFindScriptFile(szName, csPath) || !file.bOpen(csPath.Text(), OsOpenMode::Read)) return false;
  EDITSTREAM stream = {reinterpret_cast<DWORD_PTR>(&file), 0, ReadPart};
  SendMessageW(hWnd, EM_STREAMIN, SF_RTF, reinterpret_cast<LPARAM>(&stream));
  return !stream.dwError;
}

// A text that was typed and remembered is no file name, but in a field that shows a file.
bool bNamesFile(const NativeControl& native, const char* szText) {
  const size_t nLength = strlen(szText);
  return Rtf(native).bIsFile() && nLength > 4 && lstrcmpiA(szText + nLength - 4, ".rtf") == 0;
}

bool bSetText(HWND hWnd, const char* szText) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  if (!pNative || !bNamesFile(*pNative, szText)) return bSetWindowText(hWnd, szText);
  // The message waits until the page is there.
  if (!bLoadFile(hWnd, szText)) PostMessageW(hWnd, TELL_FAULT, 0, 0);
  return true;
}

void TellFault(HWND hWnd) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  iSystemMessage(GetAncestor(hWnd, GA_ROOT), {.szText = "File could not be opened!",
                                              .szCaption = pNative ? pNative->Control().m_csCaption.Text() : "",
                                              .icon = MessageIcon::Error});
}

// The field must not answer the question for its keys itself: it would take Tab, Enter and Escape for a dialog of the
// system's.
LRESULT CALLBACK RtfProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == TELL_FAULT) return TellFault(hWnd), 0;
  if (uMessage != WM_GETDLGCODE) return CallClassProc(hWnd, uMessage, wParam, lParam);
  const LONG lStyle = GetWindowLongW(hWnd, GWL_STYLE);
  const bool bEnter = wParam == VK_RETURN && lStyle & ES_WANTRETURN;
  return DLGC_WANTCHARS | DLGC_WANTARROWS | (bEnter ? DLGC_WANTMESSAGE : 0) |
         (lStyle & ES_MULTILINE ? 0 : DLGC_HASSETSEL);
}

void SetColors(const NativeControl& native) {
  const BaseControl& control = native.Control();
  if (control.m_Background.bSet || control.bHasFlag("GRAY"))
    SendMessageW(
        native.hWnd(), EM_SETBKGNDCOLOR, 0,
        static_cast<LPARAM>(control.m_Background.bSet ? ToColorRef(control.m_Background) : GetSysColor(COLOR_BTNFACE)));
  CHARFORMATW format = {};
  format.cbSize = sizeof(format);
  format.dwMask = CFM_COLOR;
  format.crTextColor = ToColorRef(control.m_TextColor);
  if (control.m_TextColor.bSet)
    SendMessageW(native.hWnd(), EM_SETCHARFORMAT, SCF_DEFAULT, reinterpret_cast<LPARAM>(&format));
}

// A caption with markers is filled in by the wizard.
void Created(NativeControl& native) {
  PutBefore(native.hWnd(), RtfProc);
  SendMessageW(native.hWnd(), EM_EXLIMITTEXT, 0, 0x7FFFFFFE);
  SetColors(native);
  const char* szCaption = native.Control().m_csCaption.Text();
  if (!strstr(szCaption, "<%")) bSetText(native.hWnd(), szCaption);
}

int Notification(NativeControl&, int iCode) {
  return iCode == EN_SETFOCUS || iCode == EN_KILLFOCUS ? iCode : NativeKind::IGNORED;
}

}  // namespace

const NativeKind g_RtfWindow = {.kind = ControlKind::RichEdit,
                                .bField = true,
                                .pPrepare = Prepare,
                                .pCreated = Created,
                                .pSetText = bSetText,
                                .pNotification = Notification};
