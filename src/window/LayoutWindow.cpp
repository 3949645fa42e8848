#include "window/LayoutWindow.h"

#include <algorithm>

#include "controls/ContainerKinds.h"

namespace {

SIZE SizeOf(const RECT& area) { return {area.right - area.left, area.bottom - area.top}; }

RECT WindowArea(HWND hWnd) {
  RECT area = {};
  GetWindowRect(hWnd, &area);
  return area;
}

bool bIsInCell(const DialogInfo& info, const BaseControl& control) {
  for (int iTable = 0; iTable < info.m_Tables.Size(); iTable++)
    for (int i = 0; i < info.m_Tables[iTable]->m_Cells.Size(); i++)
      if (info.m_Tables[iTable]->m_Cells[i]->pControl == &control) return true;
  return false;
}

// A bar that lies along an edge of the dialog: a status bar, or one of toolbars whose line gives it no width.
bool bIsEdgeBar(const NativeControl& native) {
  const BaseControl& control = native.Control();
  const bool bTools = control.Kind() == ControlKind::Rebar || control.Kind() == ControlKind::Toolbar;
  if (control.m_pParent || !native.m_bVisible) return false;
  return control.Kind() == ControlKind::StatusBar ||
         (bTools && control.m_iSize[2] == 0 && !bIsInCell(native.Dialog().Info(), control));
}

// Bars, and what else follows by itself what it stands in.
void TellResized(const ShownDialog& dialog, const BaseControl* pContainer) {
  const CNArray<NativeControl>& controls = dialog.Controls();
  for (int i = 0; i < controls.Size(); i++)
    if (controls[i]->Kind().pResized && controls[i]->Control().m_pParent == pContainer)
      controls[i]->Kind().pResized(*controls[i]);
}

// Moves the windows of one level together, but for those that a bar or pager has taken in: windows of several parents
// cannot be moved together. A window of another size is painted anew: what it shows may stand elsewhere.
void MoveWindows(const ShownDialog& dialog, const CNArray<LayoutPlace>& places, HWND hInside, POINT origin) {
  HDWP hMoves = BeginDeferWindowPos(places.Size());
  for (int i = 0; i < places.Size() && hMoves; i++) {
    const LayoutPlace& place = *places[i];
    const NativeControl* pNative = dialog.pFind(*place.pControl);
    if (!pNative || place.bHidden || GetParent(pNative->hWnd()) != hInside) continue;
    const RECT former = pNative->Place();
    const LONG x = origin.x + place.iX, y = origin.y + place.iY;
    const bool bMoves = former.left != x || former.top != y;
    const bool bGrows = SizeOf(former).cx != place.iWidth || SizeOf(former).cy != place.iHeight;
    if (bMoves || bGrows)
      hMoves = DeferWindowPos(hMoves, pNative->hWnd(), nullptr, x, y, place.iWidth, place.iHeight,
                              SWP_NOZORDER | SWP_NOACTIVATE | SWP_NOOWNERZORDER | (bGrows ? SWP_NOCOPYBITS : 0));
  }
  if (hMoves) EndDeferWindowPos(hMoves);
}

}  // namespace

void NativeSizes::Own(const BaseControl& control, int& iWidth, int& iHeight) const {
  LayoutSizes::Own(control, iWidth, iHeight);
  const NativeControl* pNative = m_Dialog.pFind(control);
  if (!pNative) return;
  const SIZE size = SizeOf(WindowArea(pNative->hWnd()));
  iWidth = size.cx;
  iHeight = size.cy;
}

void NativeSizes::Around(const BaseControl& container, int& iWidth, int& iHeight) const {
  RECT around = {};
  NativeControl* pNative = m_Dialog.pFind(container);
  if (pNative && bIsTabControl(&container)) {
    SendMessageW(pNative->hWnd(), TCM_ADJUSTRECT, TRUE, reinterpret_cast<LPARAM>(&around));
  } else if (pNative && pNative->Kind().pInner) {
    RECT inside;
    GetClientRect(pNative->Kind().pInner(*pNative), &inside);
    around = WindowArea(pNative->hWnd());
    around.right -= inside.right;
    around.bottom -= inside.bottom;
  }
  iWidth = SizeOf(around).cx;
  iHeight = SizeOf(around).cy;
}

RECT LayoutRoom(const ShownDialog& dialog, const BaseControl* pContainer, HWND hInside) {
  RECT room;
  GetClientRect(hInside, &room);
  const CNArray<NativeControl>& controls = dialog.Controls();
  for (int i = 0; i < controls.Size() && !pContainer; i++) {
    if (!bIsEdgeBar(*controls[i])) continue;
    const RECT place = controls[i]->Place();
    if (controls[i]->Control().Kind() == ControlKind::StatusBar)
      room.bottom = std::min(room.bottom, place.top);
    else
      room.top = std::max(room.top, place.bottom);
  }
  return room;
}

void LayOutInside(ShownDialog& dialog, const BaseControl* pContainer, HWND hInside) {
  TellResized(dialog, pContainer);
  const RECT room = LayoutRoom(dialog, pContainer, hInside);
  const SIZE size = SizeOf(room);
  CNArray<LayoutPlace> places;
  LayOut(dialog.Info(), pContainer, std::max(0L, size.cx), std::max(0L, size.cy), NativeSizes(dialog), places);
  if (places.Size() == 0) return;
  for (int i = 0; i < places.Size(); i++) {
    NativeControl* pNative = places[i]->bHidden ? dialog.pFind(*places[i]->pControl) : nullptr;
    if (pNative) pNative->m_bVisible = false;
  }
  MoveWindows(dialog, places, hInside, {room.left, room.top});
  for (int i = 0; i < places.Size(); i++) {
    NativeControl* pNative = dialog.pFind(*places[i]->pControl);
    if (pNative && pNative->Kind().pResized) pNative->Kind().pResized(*pNative);
  }
}

void LayOutDialog(ShownDialog& dialog, HWND hDialog) {
  ForgetMoves(dialog.Info());
  LayOutInside(dialog, nullptr, hDialog);
  const CNArray<NativeControl>& controls = dialog.Controls();
  for (int i = 0; i < controls.Size(); i++) {
    NativeControl& native = *controls[i];
    if (native.Kind().pInner && !bIsTabControl(&native.Control()))
      LayOutInside(dialog, &native.Control(), native.Kind().pInner(native));
  }
}

void LimitSize(const ShownDialog& dialog, HWND hDialog, MINMAXINFO& limits) {
  const DialogInfo& info = dialog.Info();
  if (info.m_Tables.Size() == 0) return;
  int iWidth, iHeight;
  LeastSize(info, nullptr, NativeSizes(dialog), iWidth, iHeight);
  const SIZE window = SizeOf(WindowArea(hDialog)), room = SizeOf(LayoutRoom(dialog, nullptr, hDialog));
  const LONG lWidth = std::min<LONG>(info.m_iSize[2], iWidth + window.cx - room.cx);
  const LONG lHeight = std::min<LONG>(info.m_iSize[3], iHeight + window.cy - room.cy);
  limits.ptMinTrackSize.x = std::max(limits.ptMinTrackSize.x, lWidth);
  limits.ptMinTrackSize.y = std::max(limits.ptMinTrackSize.y, lHeight);
}
