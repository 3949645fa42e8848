// Fields for an IP address, "192.168.0.1"; an empty field is an empty text.
#include <algorithm>

#include "window/SimpleWindows.h"

namespace {

bool bSetText(HWND hWnd, const char* szText) {
  int parts[4];
  if (iNumbersOf(szText, parts, 4) < 4) return SendMessageW(hWnd, IPM_CLEARADDRESS, 0, 0), true;
  for (int& iPart : parts) iPart = std::clamp(iPart, 0, 255);
  SendMessageW(hWnd, IPM_SETADDRESS, 0, static_cast<LPARAM>(MAKEIPADDRESS(parts[0], parts[1], parts[2], parts[3])));
  return true;
}

// Not every version hands the font on to the four fields.
void Created(NativeControl& native) {
  for (HWND hPart = nullptr; (hPart = FindWindowExW(native.hWnd(), hPart, nullptr, nullptr));)
    SendMessageW(hPart, WM_SETFONT, reinterpret_cast<WPARAM>(native.hFont()), FALSE);
  ShowSource(native);
}

bool bGetText(HWND hWnd, CNString& csText) {
  DWORD dwAddress = 0;
  const LRESULT lParts = SendMessageW(hWnd, IPM_GETADDRESS, 0, reinterpret_cast<LPARAM>(&dwAddress));
  csText = "";
  if (lParts)
    csText.Printf("IPAddressWindow", "csText", "%d.%d.%d.%d", static_cast<int>(FIRST_IPADDRESS(dwAddress)),
                  static_cast<int>(SECOND_IPADDRESS(dwAddress)), static_cast<int>(THIRD_IPADDRESS(dwAddress)),
                  static_cast<int>(FOURTH_IPADDRESS(dwAddress)));
  return true;
}

NativeEvent Notify(NativeControl&, NMHDR& message) { return ChangeEvent(message.code == IPN_FIELDCHANGED); }

}  // namespace

const NativeKind g_IPAddressWindow = {.kind = ControlKind::IpAddress,
                                      .bField = true,
                                      .pPrepare = PrepareWithoutCaption,
                                      .pCreated = Created,
                                      .pSetText = bSetText,
                                      .pGetText = bGetText,
                                      .pNotify = Notify};
