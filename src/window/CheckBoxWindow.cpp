// Check boxes and radio buttons. Their text is their state, "1" or "0".
#include <algorithm>
#include <cstring>

#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"
#include "window/StaticWindow.h"
#include "wizard/WizardView.h"

namespace {

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  const auto& box = static_cast<const CNCheckBox&>(native.Control());
  window.style = (window.style & ~BS_TYPEMASK) | (box.m_bRadio ? BS_AUTORADIOBUTTON : BS_AUTOCHECKBOX);
}

bool bSetText(HWND hWnd, const char* szText) {
  SendMessageW(hWnd, BM_SETCHECK, strcmp(szText, "1") == 0 ? BST_CHECKED : BST_UNCHECKED, 0);
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) {
  csText = SendMessageW(hWnd, BM_GETCHECK, 0, 0) == BST_CHECKED ? "1" : "0";
  return true;
}

int Notification(NativeControl&, int iCode) { return iCode == BN_CLICKED ? NOTIFY_CLICK : NativeKind::IGNORED; }

// The system marks the focus around the words. A box without any is marked itself, cut to its window.
void DrawFocus(HWND hWnd) {
  RECT client;
  GetClientRect(hWnd, &client);
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  const LONG lSide = static_cast<LONG>(17 * (pNative ? pNative->Control().m_dScale : 1.0));  // the square, and a gap
  const LONG lTop = (client.bottom - lSide) / 2;
  const RECT square = {0, std::max(0L, lTop), std::min(client.right, lSide), std::min(client.bottom, lTop + lSide)};
  const HDC hDC = GetDC(hWnd);
  DrawFocusRect(hDC, &square);
  ReleaseDC(hWnd, hDC);
}

// After these a part of the box may have been drawn without WM_PAINT.
bool bDraws(UINT uMessage) {
  static const UINT DRAWING[] = {WM_SETFOCUS, WM_KILLFOCUS, WM_ENABLE, BM_SETCHECK, BM_SETSTATE, BM_SETSTYLE};
  return std::find(std::begin(DRAWING), std::end(DRAWING), uMessage) != std::end(DRAWING);
}

// With BS_NOTIFY the box would tell of its focus, but take the second of two quick clicks for none. The focus may go
// when nothing is left of the dialog but windows.
LRESULT CALLBACK BareBoxProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  const auto hText = static_cast<HWND>(GetPropW(hWnd, LABEL_PARTNER));
  if ((uMessage == WM_SETFOCUS || uMessage == WM_KILLFOCUS) && hText) InvalidateRect(hText, nullptr, TRUE);
  if (hText || (uMessage != WM_PAINT && !bDraws(uMessage)) || GetWindowTextLengthW(hWnd))
    return CallClassProc(hWnd, uMessage, wParam, lParam);
  // The focus is drawn by inverting pixels: all of them must be new.
  const bool bFocusPaint = uMessage == WM_PAINT && GetFocus() == hWnd;
  if (bFocusPaint) InvalidateRect(hWnd, nullptr, TRUE);
  const LRESULT lResult = CallClassProc(hWnd, uMessage, wParam, lParam);
  if (bFocusPaint) DrawFocus(hWnd);
  if (uMessage != WM_PAINT) InvalidateRect(hWnd, nullptr, TRUE);
  return lResult;
}

// The procedure comes before the tooltip's, which a later one would cut off. The system's themed look has no text
// colour.
void Created(NativeControl& native) {
  PutBefore(native.hWnd(), BareBoxProc);
  if (native.Control().m_TextColor.bSet) DropTheme(native.hWnd());
}

bool bIsChecked(const ShownDialog& dialog, const BaseControl& box) {
  const NativeControl* pNative = dialog.pFind(box);
  return pNative && SendMessageW(pNative->hWnd(), BM_GETCHECK, 0, 0) == BST_CHECKED;
}

// Tab stops at the radio button of a group that is chosen, or at the first one: the arrows lead to the others. The
// system sees to it from then on.
void SetTabStop(const NativeControl& native) {
  const BaseControl& box = native.Control();
  bool bStops = (box.m_dwStyle & STYLE_GROUP) != 0;
  for (int i = 0; bStops && i < box.m_Partners.Size(); i++) bStops = !bIsChecked(native.Dialog(), *box.m_Partners[i]);
  const DWORD dwStyle = static_cast<DWORD>(GetWindowLongW(native.hWnd(), GWL_STYLE)) & ~WS_TABSTOP;
  bStops = bStops || bIsChecked(native.Dialog(), box);
  SetWindowLongW(native.hWnd(), GWL_STYLE, static_cast<LONG>(dwStyle | (bStops ? WS_TABSTOP : 0)));
}

// The text to the right of a box that has no room for words of its own; null without.
const NativeControl* pLabelOf(const NativeControl& box) {
  const double dSquare = 16 * box.Control().m_dScale;
  const NativeControl* pLabel = box.Dialog().pNextOnRight(box);
  const bool bIsText = pLabel && pLabel->Control().Kind() == ControlKind::Static;
  return bIsText && box.Place().right - box.Place().left <= dSquare ? pLabel : nullptr;
}

// A box without words of its own is read out by the name of the text to its right, which is not seen in so narrow a
// box, and that text shows when the box has the focus.
void TakeNameOfLabel(const NativeControl& native) {
  const NativeControl* pLabel = pLabelOf(native);
  if (!pLabel) return;
  if (GetWindowTextLengthW(native.hWnd()) == 0) SetWindowTextW(native.hWnd(), WindowText(pLabel->hWnd()).get());
  ShowFocusOf(native.hWnd(), pLabel->hWnd());
}

void BeforeShow(NativeControl& native) {
  const BaseControl& box = native.Control();
  if (box.m_bGrouped && static_cast<const CNCheckBox&>(box).m_bRadio) SetTabStop(native);
  TakeNameOfLabel(native);
}

}  // namespace

const NativeKind g_CheckBoxWindow = {.kind = ControlKind::CheckBox,
                                     .pPrepare = Prepare,
                                     .pCreated = Created,
                                     .pBeforeShow = BeforeShow,
                                     .pSetText = bSetText,
                                     .pGetText = bGetText,
                                     .pNotification = Notification};
