// Splitters: bars that the mouse drags, or the arrow keys move, between what stands on their two sides.
#include <algorithm>

#include "controls/ContainerKinds.h"
#include "window/LayoutWindow.h"

namespace {

const wchar_t SPLITTER_CLASS[] = L"SizerClass";
const int NEAR_EDGE = 4;    // how far a control may be from the bar to move with it
const int LEAST_SIZE = 16;  // of such a control
const int KEY_STEP = 8;     // pixels

struct Grip : NativeState {
  POINT at = {};  // where the bar was taken
};

bool bHorizontal(const NativeControl& native) { return native.Control().bHasFlag("HORIZONTAL"); }

// The numbers of a rectangle in the direction in which the bar moves, and across it.
struct Side {
  LONG RECT::*pFirst;
  LONG RECT::*pLast;
  LONG RECT::*pCrossFirst;
  LONG RECT::*pCrossLast;
};
const Side ACROSS = {&RECT::left, &RECT::right, &RECT::top, &RECT::bottom};
const Side DOWN = {&RECT::top, &RECT::bottom, &RECT::left, &RECT::right};

bool bNear(LONG lEdge, LONG lOther) { return lEdge - lOther <= NEAR_EDGE && lOther - lEdge <= NEAR_EDGE; }

// One control beside the bar, and which of its edges moves.
struct Neighbour {
  NativeControl& native;
  RECT place;
  LONG RECT::*pMoves;
};

// The controls whose edges touch the bar, outside tables.
void FindNeighbours(const NativeControl& bar, const Side& side, CNArray<Neighbour>& found) {
  const RECT own = bar.Place();
  const CNArray<NativeControl>& controls = bar.Dialog().Controls();
  for (int i = 0; i < controls.Size(); i++) {
    NativeControl& other = *controls[i];
    if (&other == &bar || other.Control().m_pParent != bar.Control().m_pParent || !other.m_bVisible ||
        GetParent(other.hWnd()) != GetParent(bar.hWnd()))
      continue;
    const RECT place = other.Place();
    if (place.*side.pCrossFirst >= own.*side.pCrossLast || place.*side.pCrossLast <= own.*side.pCrossFirst) continue;
    if (bNear(place.*side.pLast, own.*side.pFirst)) found.Add(new Neighbour{other, place, side.pLast}, 1);
    if (bNear(place.*side.pFirst, own.*side.pLast)) found.Add(new Neighbour{other, place, side.pFirst}, 1);
  }
}

// As far as the neighbours can become smaller and the bar stays in sight.
LONG lLimited(const NativeControl& bar, const Side& side, const CNArray<Neighbour>& neighbours, LONG lPixels) {
  RECT client;
  GetClientRect(GetParent(bar.hWnd()), &client);
  const RECT own = bar.Place();
  LONG lLeast = -(own.*side.pFirst), lMost = client.*side.pLast - own.*side.pLast;
  for (int i = 0; i < neighbours.Size(); i++) {
    const Neighbour& neighbour = *neighbours[i];
    const LONG lSpare = std::max(0L, neighbour.place.*side.pLast - neighbour.place.*side.pFirst - LEAST_SIZE);
    if (neighbour.pMoves == side.pLast)
      lLeast = std::max(lLeast, -lSpare);
    else
      lMost = std::min(lMost, lSpare);
  }
  return std::max(lLeast, std::min(lMost, lPixels));
}

HDWP hMove(HDWP hMoves, HWND hWnd, const RECT& place) {
  return hMoves ? DeferWindowPos(hMoves, hWnd, nullptr, place.left, place.top, place.right - place.left,
                                 place.bottom - place.top, SWP_NOZORDER | SWP_NOACTIVATE)
                : nullptr;
}

void MoveNeighbours(const NativeControl& bar, LONG lPixels) {
  const Side& side = bHorizontal(bar) ? DOWN : ACROSS;
  CNArray<Neighbour> neighbours;
  FindNeighbours(bar, side, neighbours);
  lPixels = lLimited(bar, side, neighbours, lPixels);
  RECT own = bar.Place();
  own.*side.pFirst += lPixels;
  own.*side.pLast += lPixels;
  HDWP hMoves = hMove(BeginDeferWindowPos(neighbours.Size() + 1), bar.hWnd(), own);
  for (int i = 0; i < neighbours.Size(); i++) {
    neighbours[i]->place.*(neighbours[i]->pMoves) += lPixels;
    hMoves = hMove(hMoves, neighbours[i]->native.hWnd(), neighbours[i]->place);
  }
  if (hMoves) EndDeferWindowPos(hMoves);
  for (int i = 0; i < neighbours.Size(); i++) {
    NativeControl& moved = neighbours[i]->native;
    if (moved.Kind().pResized) moved.Kind().pResized(moved);
    InvalidateRect(moved.hWnd(), nullptr, TRUE);
  }
}

void Move(NativeControl& bar, LONG lPixels) {
  if (lPixels == 0) return;
  ShownDialog& dialog = bar.Dialog();
  const BaseControl* pContainer = bar.Control().m_pParent;
  const HWND hInside = GetParent(bar.hWnd());
  const RECT room = LayoutRoom(dialog, pContainer, hInside);
  const LONG lRoom = bHorizontal(bar) ? room.bottom - room.top : room.right - room.left;
  if (bMoveSplitter(dialog.Info(), bar.Control(), NativeSizes(dialog), lPixels, lRoom))
    LayOutInside(dialog, pContainer, hInside);
  else
    MoveNeighbours(bar, lPixels);
}

LONG lAlong(const NativeControl& bar, POINT at) { return bHorizontal(bar) ? at.y : at.x; }

void Take(NativeControl& bar, POINT at) {
  std::unique_ptr<Grip> pGrip(new Grip);
  pGrip->at = at;
  bar.m_pState = static_cast<std::unique_ptr<Grip>&&>(pGrip);
  SetCapture(bar.hWnd());
  SetFocus(bar.hWnd());  // last: what loses the keyboard may lead to another page
}

void Press(NativeControl& bar, WPARAM wKey) {
  const bool bDown = bHorizontal(bar);
  const int iStep = static_cast<int>(KEY_STEP * bar.Dialog().Info().m_dScale);
  if (wKey == (bDown ? VK_UP : VK_LEFT)) Move(bar, -iStep);
  if (wKey == (bDown ? VK_DOWN : VK_RIGHT)) Move(bar, iStep);
}

void Paint(const NativeControl& bar) {
  PAINTSTRUCT paint;
  const HDC hDC = BeginPaint(bar.hWnd(), &paint);
  RECT client;
  GetClientRect(bar.hWnd(), &client);
  bar.FillGround(hDC, bar.hWnd(), client);
  if (GetFocus() == bar.hWnd()) DrawFocusRect(hDC, &client);
  EndPaint(bar.hWnd(), &paint);
}

LRESULT CALLBACK SplitterProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  NativeControl* pBar = NativeControl::pFromWindow(hWnd);
  if (!pBar) return DefWindowProcW(hWnd, uMessage, wParam, lParam);
  const POINT at = {static_cast<SHORT>(LOWORD(lParam)), static_cast<SHORT>(HIWORD(lParam))};
  if (uMessage == WM_PAINT) return Paint(*pBar), 0;
  if (uMessage == WM_ERASEBKGND) return TRUE;  // Paint covers everything
  if (uMessage == WM_GETDLGCODE) return DLGC_WANTARROWS;
  if (uMessage == WM_SETFOCUS || uMessage == WM_KILLFOCUS) return InvalidateRect(hWnd, nullptr, FALSE), 0;
  if (uMessage == WM_LBUTTONDOWN) return Take(*pBar, at), 0;
  if (uMessage == WM_LBUTTONUP) return ReleaseCapture(), 0;
  if (uMessage == WM_KEYDOWN) return Press(*pBar, wParam), 0;
  // The bar follows the mouse: the point where it was taken is to be under it again.
  if (uMessage == WM_MOUSEMOVE && GetCapture() == hWnd && pBar->m_pState)
    return Move(*pBar, lAlong(*pBar, at) - lAlong(*pBar, static_cast<Grip&>(*pBar->m_pState).at)), 0;
  if (uMessage != WM_SETCURSOR) return DefWindowProcW(hWnd, uMessage, wParam, lParam);
  SetCursor(LoadCursorW(nullptr, bHorizontal(*pBar) ? IDC_SIZENS : IDC_SIZEWE));
  return TRUE;
}

// Once per process; a second registration is refused, which is as good.
void Prepare(NativeControl&, CREATESTRUCTW& window) {
  WNDCLASSEXW description = {};
  description.cbSize = sizeof(description);
  description.style = CS_VREDRAW | CS_HREDRAW;
  description.lpfnWndProc = SplitterProc;
  description.hInstance = window.hInstance;
  description.lpszClassName = SPLITTER_CLASS;
  RegisterClassExW(&description);
}

}  // namespace

const NativeKind g_SplitterWindow = {.kind = ControlKind::Splitter, .pPrepare = Prepare};
