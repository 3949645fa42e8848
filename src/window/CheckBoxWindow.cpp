// Check boxes and radio buttons. Their text is their state, "1" or "0".
#include <cstring>

#include "window/NativeControls.h"
#include "window/ShownDialog.h"
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

// A box without words of its own is read out by the name of the text to its right. In a box that is as narrow as its
// square the name is not seen.
void TakeNameOfLabel(NativeControl& native) {
  const int SQUARE = 16;
  const RECT place = native.Place();
  const NativeControl* pLabel = native.Dialog().pNextOnRight(native);
  if (place.right - place.left > SQUARE || GetWindowTextLengthW(native.hWnd()) > 0) return;
  if (!pLabel || pLabel->Control().Kind() != ControlKind::Static) return;
  SetWindowTextW(native.hWnd(), WindowText(pLabel->hWnd()).get());
}

}  // namespace

const NativeKind g_CheckBoxWindow = {.kind = ControlKind::CheckBox,
                                     .dwStyle = 0,
                                     .dwRemovedStyle = 0,
                                     .dwExStyle = 0,
                                     .bField = false,
                                     .pPrepare = Prepare,
                                     .pBeforeShow = TakeNameOfLabel,
                                     .pSetText = bSetText,
                                     .pGetText = bGetText,
                                     .pNotification = Notification};
