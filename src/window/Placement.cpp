#include "window/Placement.h"

#include <algorithm>

namespace {

// The middle of the range, but never before its start: the window's caption must stay within reach.
LONG lCentre(LONG lStart, LONG lEnd, LONG lSize) { return std::max(lStart, lStart + (lEnd - lStart - lSize) / 2); }

}  // namespace

RECT PlaceDialog(const DialogInfo& dialog, const RECT* pPresent, const RECT& workArea) {
  POINT at = {dialog.m_iSize[0], dialog.m_iSize[1]};
  SIZE size = {dialog.m_iSize[2], dialog.m_iSize[3]};
  if (pPresent && dialog.m_bInheritSize) size = {pPresent->right - pPresent->left, pPresent->bottom - pPresent->top};
  if (pPresent && (dialog.m_bInheritPosition || dialog.m_bInheritSize))
    at = {pPresent->left, pPresent->top};
  else if (dialog.m_bCenter)
    at = {lCentre(workArea.left, workArea.right, size.cx), lCentre(workArea.top, workArea.bottom, size.cy)};
  return {at.x, at.y, at.x + size.cx, at.y + size.cy};
}

DWORD TopLevelStyle(const DialogInfo& dialog) {
  DWORD dwStyle = dialog.m_dwStyle & ~static_cast<DWORD>(WS_VISIBLE);
  // A child style describes a dialog inside another one; as a window of its own it has no frame.
  if (dwStyle & WS_CHILD) dwStyle = (dwStyle & ~static_cast<DWORD>(WS_CHILD)) | WS_POPUP;
  return dwStyle | WS_CLIPCHILDREN;  // the ground is never painted over the controls: no flicker
}
