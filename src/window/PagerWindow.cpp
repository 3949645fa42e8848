// Pagers: a control that is larger than its place, with arrows that scroll it.
#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"

namespace {

const NativeControl* pPaged(const NativeControl& native) {
  const ShownDialog& dialog = native.Dialog();
  const char* szName = native.Control().m_csCaption.Text();
  const BaseControl* pControl = *szName ? dialog.Info().GetBaseControl(szName) : nullptr;
  return pControl && pControl != &native.Control() ? dialog.pFind(*pControl) : nullptr;
}

// What the control says is meant for the dialog.
LRESULT CALLBACK PagerProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  static const UINT HANDED_ON[] = {WM_COMMAND,      WM_DRAWITEM,    WM_MEASUREITEM,    WM_HSCROLL,        WM_VSCROLL,
                                   WM_CTLCOLOREDIT, WM_CTLCOLORBTN, WM_CTLCOLORSTATIC, WM_CTLCOLORLISTBOX};
  for (const UINT uOne : HANDED_ON)
    if (uOne == uMessage) return SendMessageW(GetParent(hWnd), uMessage, wParam, lParam);
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

void Created(NativeControl& native) { PutBefore(native.hWnd(), PagerProc); }

void BeforeShow(NativeControl& native) {
  const NativeControl* pChild = pPaged(native);
  if (!pChild) return;
  SetParent(pChild->hWnd(), native.hWnd());
  SendMessageW(native.hWnd(), PGM_SETCHILD, 0, reinterpret_cast<LPARAM>(pChild->hWnd()));
}

// Which size the control wants: that of its line.
NativeEvent Notify(NativeControl& native, NMHDR& message) {
  const NativeControl* pChild = pPaged(native);
  if (message.code != static_cast<UINT>(PGN_CALCSIZE) || !pChild) return {};
  auto& wanted = reinterpret_cast<NMPGCALCSIZE&>(message);
  wanted.iWidth = pChild->Control().m_iSize[2];
  wanted.iHeight = pChild->Control().m_iSize[3];
  return {.bAnswered = true};
}

}  // namespace

const NativeKind g_PagerWindow = {.kind = ControlKind::Pager,
                                  .dwRemovedStyle = WS_TABSTOP,
                                  .dwExStyle = WS_EX_CONTROLPARENT,
                                  .pPrepare = PrepareWithoutCaption,
                                  .pCreated = Created,
                                  .pBeforeShow = BeforeShow,
                                  .pNotify = Notify};
