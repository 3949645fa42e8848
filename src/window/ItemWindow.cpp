#include "window/ItemWindow.h"

#include <cstdlib>
#include <cstring>

#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"
#include "wizard/WizardView.h"

namespace {

// Messages of our own, far from those that the classes use.
const UINT ITEMS_SET_VALUE = WM_APP + 0x300;  // lParam: const char*
const UINT ITEMS_GET_VALUE = WM_APP + 0x301;  // lParam: CNString*
const UINT ITEMS_TELL = WM_APP + 0x302;       // wParam: notification, lParam: CNItem*

const UINT NOTIFY_TELL = 0x4F52;  // no code of the system, which are negative

struct TellMessage {
  NMHDR header;
  NativeEvent event;
};

}  // namespace

void ItemWindow::Attach(NativeControl& native, ItemWindow* pNew) {
  native.m_pState.reset(pNew);
  PutBefore(native.hWnd(), Procedure);
  pNew->Created();
}

bool ItemWindow::bSetText(HWND hWnd, const char* szText) {
  return SendMessageW(hWnd, ITEMS_SET_VALUE, 0, reinterpret_cast<LPARAM>(szText)) != 0;
}

bool ItemWindow::bGetText(HWND hWnd, CNString& csText) {
  return SendMessageW(hWnd, ITEMS_GET_VALUE, 0, reinterpret_cast<LPARAM>(&csText)) != 0;
}

void ItemWindow::SetItems(NativeControl& native, const CNCharArray& texts) {
  auto& window = Of<ItemWindow>(native);
  const Quiet quiet(window.m_nQuiet);
  if (window.m_bPressed) window.EndDrag(nullptr);        // the item that is moved goes
  const bool bVisible = IsWindowVisible(native.hWnd());  // a window that is hidden would become visible
  CNString csValue;
  window.GetValue(csValue);
  if (bVisible) window.Send(WM_SETREDRAW, FALSE);
  window.Fill(texts);
  if (!csValue.bEmpty()) window.SetValue(csValue.Text());
  if (bVisible) window.Send(WM_SETREDRAW, TRUE);
  InvalidateRect(native.hWnd(), nullptr, TRUE);
}

// ---- events ----

// Several changes of the selection at one stroke are told once.
void ItemWindow::Tell(int iNotification, CNItem* pItem) {
  if (m_nQuiet || (iNotification == NOTIFY_SELECTION_CHANGED && m_bChangeIsDue)) return;
  if (iNotification == NOTIFY_SELECTION_CHANGED) m_bChangeIsDue = true;
  PostMessageW(hWnd(), ITEMS_TELL, static_cast<WPARAM>(iNotification), reinterpret_cast<LPARAM>(pItem));
}

void ItemWindow::TellChosen(CNItem* pItem) {
  CNString csCommand;
  if (pItem && !pItem->bHasFlag("DISABLE")) ItemCommand(*pItem, csCommand);
  Tell(NOTIFY_DOUBLE_CLICK, csCommand.bEmpty() ? nullptr : pItem);
}

NativeEvent ItemWindow::Told(const NMHDR& message) {
  return message.code == NOTIFY_TELL ? reinterpret_cast<const TellMessage&>(message).event : NativeEvent();
}

// ---- messages ----

LRESULT CALLBACK ItemWindow::Procedure(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  const MSG message = {hWnd, uMessage, wParam, lParam, 0, {}};
  LRESULT lResult = 0;
  if (pNative && pNative->m_pState) {
    auto& window = Of<ItemWindow>(*pNative);
    if (window.bOwnMessage(message, lResult) || window.bDragMessage(message, lResult) ||
        window.bMessage(message, lResult))
      return lResult;
  }
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

bool ItemWindow::bOwnMessage(const MSG& message, LRESULT& lResult) {
  if (message.message == ITEMS_TELL) {
    m_bChangeIsDue = m_bChangeIsDue && message.wParam != NOTIFY_SELECTION_CHANGED;
    const NMHDR header = {message.hwnd, static_cast<UINT_PTR>(GetDlgCtrlID(message.hwnd)), NOTIFY_TELL};
    const TellMessage note = {header,
                              {static_cast<int>(message.wParam), reinterpret_cast<CNItem*>(message.lParam), true}};
    SendMessageW(GetParent(message.hwnd), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&note));
    return true;
  }
  if (message.message == ITEMS_SET_VALUE || message.message == ITEMS_GET_VALUE) {
    const Quiet quiet(m_nQuiet);
    lResult = TRUE;
    if (message.message == ITEMS_SET_VALUE) {
      SetValue(reinterpret_cast<const char*>(message.lParam));
    } else {
      CNString& csText = *reinterpret_cast<CNString*>(message.lParam);
      csText = "";
      GetValue(csText);
    }
    return true;
  }
  // Enter that was taken is no letter to look for.
  if (message.message == WM_CHAR && message.wParam == VK_RETURN) return true;
  if (message.message != WM_GETDLGCODE) return false;
  const auto* pKey = reinterpret_cast<const MSG*>(message.lParam);
  const bool bEnter = pKey && pKey->message == WM_KEYDOWN && pKey->wParam == VK_RETURN && bTakesEnter();
  if (!m_bPressed && !bEnter) return false;
  lResult = CallClassProc(message.hwnd, message.message, message.wParam, message.lParam) | DLGC_WANTMESSAGE;
  return true;
}

// ---- moving items with the mouse ----

void ItemWindow::StartDrag(LPARAM lItem, POINT point) {
  ClientToScreen(hWnd(), &point);
  m_bPressed = true;
  m_bMoving = false;
  m_lDragged = lItem;
  m_Pressed = point;
  SetCapture(hWnd());
}

// The mouse is the window's until the button is up, Escape is pressed or another window takes the mouse.
bool ItemWindow::bDragMessage(const MSG& message, LRESULT&) {
  if (!m_bPressed) return false;
  POINT screen = {static_cast<short>(LOWORD(message.lParam)), static_cast<short>(HIWORD(message.lParam))};
  ClientToScreen(hWnd(), &screen);
  if (message.message == WM_MOUSEMOVE) {
    const bool bFar = labs(screen.x - m_Pressed.x) > GetSystemMetrics(SM_CXDRAG) ||
                      labs(screen.y - m_Pressed.y) > GetSystemMetrics(SM_CYDRAG);
    if (bFar) m_bMoving = true;
    if (m_bMoving) DragTo(screen);
  } else if (message.message == WM_LBUTTONUP || message.message == WM_RBUTTONUP) {
    EndDrag(&screen);
  } else if (message.message == WM_CAPTURECHANGED || (message.message == WM_KEYDOWN && message.wParam == VK_ESCAPE)) {
    EndDrag(nullptr);
  } else {
    return false;
  }
  return true;
}

ItemWindow* ItemWindow::pTarget(POINT screen) const {
  const NativeControl* pNative = m_Native.Dialog().pFindWindow(WindowFromPoint(screen));
  const char* szClass = pNative ? pNative->Control().szWindowClass() : nullptr;
  if (!szClass || strcmp(szClass, m_Native.Control().szWindowClass()) != 0) return nullptr;
  auto& target = Of<ItemWindow>(*pNative);
  const bool bAllowed = &target == this ? m_Dragging.bReorders : m_Dragging.bGlobal && target.m_Dragging.bGlobal;
  return bAllowed ? &target : nullptr;
}

void ItemWindow::DragTo(POINT screen) {
  ItemWindow* const pNow = pTarget(screen);
  if (m_pTarget && m_pTarget != pNow) m_pTarget->MarkDrop(nullptr);
  m_pTarget = pNow;
  if (pNow) pNow->MarkDrop(&screen);
  SetCursor(LoadCursorW(nullptr, pNow ? IDC_ARROW : IDC_NO));
}

void ItemWindow::EndDrag(const POINT* pScreen) {
  ItemWindow* const pDropped = m_bMoving && pScreen ? pTarget(*pScreen) : nullptr;
  m_bPressed = m_bMoving = false;
  if (m_pTarget) m_pTarget->MarkDrop(nullptr);
  m_pTarget = nullptr;
  if (GetCapture() == hWnd()) ReleaseCapture();
  if (pDropped) Drop(m_lDragged, *pDropped, *pScreen);
}
