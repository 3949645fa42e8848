// Status bars, at the lower edge of their dialog. The parts behind the first are as wide as their texts, the first
// takes the rest.
#include <algorithm>

#include "foundation/os/OsWide.h"
#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"

namespace {

const int MOST_PARTS = 32;
const int PART_MARGIN = 16;

int iTextWidth(const NativeControl& native, int iPart) {
  wchar_t text[256] = L"";
  if (LOWORD(SendMessageW(native.hWnd(), SB_GETTEXTLENGTHW, static_cast<WPARAM>(iPart), 0)) < 256)
    SendMessageW(native.hWnd(), SB_GETTEXTW, static_cast<WPARAM>(iPart), reinterpret_cast<LPARAM>(text));
  ScreenDC screen;
  Selected font(screen.Get(), native.hFont());
  SIZE size = {};
  GetTextExtentPoint32W(screen.Get(), text, lstrlenW(text), &size);
  return size.cx + PART_MARGIN;
}

void SetParts(const NativeControl& native, const int* pEdges, int nParts) {
  SendMessageW(native.hWnd(), SB_SETPARTS, static_cast<WPARAM>(nParts), reinterpret_cast<LPARAM>(pEdges));
}

void Arrange(NativeControl& native) {
  SendMessageW(native.hWnd(), WM_SIZE, 0, 0);
  int edges[MOST_PARTS];
  const int nParts =
      static_cast<int>(SendMessageW(native.hWnd(), SB_GETPARTS, MOST_PARTS, reinterpret_cast<LPARAM>(edges)));
  if (nParts < 1) return;
  RECT client;
  GetClientRect(native.hWnd(), &client);
  if (GetWindowLongW(native.hWnd(), GWL_STYLE) & SBARS_SIZEGRIP) client.right -= GetSystemMetrics(SM_CXVSCROLL);
  for (int i = nParts - 1; i >= 0; i--) {
    edges[i] = client.right;
    client.right -= iTextWidth(native, i);
  }
  edges[nParts - 1] = -1;  // to the window's edge
  SetParts(native, edges, nParts);
}

void SetItems(NativeControl& native, const CNCharArray& texts) {
  const int nParts = std::clamp(texts.Size(), 1, MOST_PARTS);
  int edges[MOST_PARTS];
  std::fill_n(edges, MOST_PARTS, -1);
  SetParts(native, edges, nParts);
  for (int i = 0; i < nParts && i < texts.Size(); i++)
    SendMessageW(native.hWnd(), SB_SETTEXTW, static_cast<WPARAM>(i),
                 reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(texts[i]))));
  Arrange(native);
}

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  window.lpszName = nullptr;
  if (native.Dialog().Info().m_dwStyle & WS_THICKFRAME) window.style |= SBARS_SIZEGRIP;
}

void Created(NativeControl& native) {
  const BaseControl& control = native.Control();
  if (!control.m_Background.bSet) return;
  DropTheme(native.hWnd());
  SendMessageW(native.hWnd(), SB_SETBKCOLOR, 0, static_cast<LPARAM>(ToColorRef(control.m_Background)));
}

}  // namespace

const NativeKind g_StatusBarWindow = {.kind = ControlKind::StatusBar,
                                      .dwStyle = CCS_BOTTOM,
                                      .dwRemovedStyle = WS_TABSTOP,
                                      .pPrepare = Prepare,
                                      .pCreated = Created,
                                      .pBeforeShow = Arrange,
                                      .pSetItems = SetItems,
                                      .pResized = Arrange};
