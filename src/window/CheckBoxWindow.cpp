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

// Grouped boxes exclude each other, whatever their native style.
void UncheckPartners(const NativeControl& native) {
  const CNArray<BaseControl>& partners = native.Control().m_Partners;
  for (int i = 0; i < partners.Size(); i++)
    if (const NativeControl* pPartner = native.Dialog().pFind(*partners[i])) bSetText(pPartner->hWnd(), "0");
}

int Notification(NativeControl& native, int iCode) {
  if (iCode != BN_CLICKED) return NativeKind::IGNORED;
  if (SendMessageW(native.hWnd(), BM_GETCHECK, 0, 0) == BST_CHECKED) UncheckPartners(native);
  return NOTIFY_CLICK;
}

}  // namespace

const NativeKind g_CheckBoxWindow = {.kind = ControlKind::CheckBox,
                                     .dwStyle = 0,
                                     .dwRemovedStyle = 0,
                                     .dwExStyle = 0,
                                     .bField = false,
                                     .pPrepare = Prepare,
                                     .pSetText = bSetText,
                                     .pGetText = bGetText,
                                     .pNotification = Notification};
