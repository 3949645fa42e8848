#include "window/Placement.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"

namespace {

const char POSITION[] = "Position", LAST_SIZE[] = "LastDialogSize", MAXIMIZED[] = "Maximized",
           RESTORED[] = "RestoredPosition";

// The middle of the range, but never before its start: the window's caption must stay within reach.
LONG lCentre(LONG lStart, LONG lEnd, LONG lSize) { return std::max(lStart, lStart + (lEnd - lStart - lSize) / 2); }

SIZE SizeOf(const RECT& area) { return {area.right - area.left, area.bottom - area.top}; }

RECT WorkAreaOf(HMONITOR hMonitor) {
  MONITORINFO info = {};
  info.cbSize = sizeof(info);
  if (!GetMonitorInfoW(hMonitor, &info)) SystemParametersInfoW(SPI_GETWORKAREA, 0, &info.rcWork, 0);
  return info.rcWork;
}

// False for a text of other than four numbers, and for a rectangle of tiny or huge ones, which no window left.
bool bReadRectangle(CNConfigFile& file, const char* szKey, RECT& area) {
  const long TINY = 10, HUGE_NUMBER = 2201;
  CNString csText;
  if (file.iReadConfigString(szKey, csText)) return false;
  LONG* const numbers[] = {&area.left, &area.top, &area.right, &area.bottom};
  const char* p = csText.Text();
  bool bAllTiny = true, bAllHuge = true;
  for (LONG* pNumber : numbers) {
    char* pEnd;
    *pNumber = strtol(p, &pEnd, 10);
    if (pEnd == p) return false;
    p = pEnd;
    bAllTiny &= *pNumber < TINY;
    bAllHuge &= *pNumber >= HUGE_NUMBER;
  }
  return !bAllTiny && !bAllHuge && !IsRectEmpty(&area);
}

// A place whose caption is on no screen any more comes to the nearest one.
RECT BroughtBack(const RECT& area) {
  const RECT caption = {area.left, area.top, area.right, area.top + GetSystemMetrics(SM_CYCAPTION)};
  return MonitorFromRect(&caption, MONITOR_DEFAULTTONULL) ? area : MovedInto(area, WorkAreaOf(area));
}

void WriteRectangle(CNConfigFile& file, const char* szKey, const char* szFormat, const RECT& area) {
  CNString csText;
  csText.Printf("PlaceKeeper::Save", "csText", szFormat, area.left, area.top, area.right, area.bottom);
  file.iWriteConfigString(szKey, csText.Text());
}

}  // namespace

RECT PlaceDialog(const DialogInfo& dialog, const FormerPlace& former, const RECT& workArea) {
  const RECT& inherited = IsRectEmpty(&former.sized) ? former.present : former.sized;
  const bool bSize = dialog.m_bInheritSize && !IsRectEmpty(&inherited);
  const bool bPosition = dialog.m_bInheritPosition && !IsRectEmpty(&former.present);
  SIZE size = {dialog.m_iSize[2], dialog.m_iSize[3]};
  if (bSize) size = SizeOf(inherited);
  POINT at = {dialog.m_iSize[0], dialog.m_iSize[1]};
  if (bSize || bPosition) {
    const RECT& from = bPosition ? former.present : inherited;
    at = {from.left, from.top};
  } else if (dialog.m_bCenter) {
    at = {lCentre(workArea.left, workArea.right, size.cx), lCentre(workArea.top, workArea.bottom, size.cy)};
  }
  return {at.x, at.y, at.x + size.cx, at.y + size.cy};
}

DWORD TopLevelStyle(const DialogInfo& dialog) {
  DWORD dwStyle = dialog.m_dwStyle & ~static_cast<DWORD>(WS_VISIBLE);
  // A child style describes a dialog inside another one; as a window of its own it has no frame.
  if (dwStyle & WS_CHILD) dwStyle = (dwStyle & ~static_cast<DWORD>(WS_CHILD)) | WS_POPUP;
  return dwStyle | WS_CLIPCHILDREN;  // the ground is never painted over the controls: no flicker
}

RECT WorkAreaOf(HWND hWnd) { return WorkAreaOf(MonitorFromWindow(hWnd, MONITOR_DEFAULTTOPRIMARY)); }
RECT WorkAreaOf(const RECT& area) { return WorkAreaOf(MonitorFromRect(&area, MONITOR_DEFAULTTONEAREST)); }

RECT MovedInto(const RECT& area, const RECT& bounds) {
  const SIZE size = SizeOf(area);
  const LONG x = std::max(bounds.left, std::min(area.left, bounds.right - size.cx));
  const LONG y = std::max(bounds.top, std::min(area.top, bounds.bottom - size.cy));
  return {x, y, x + size.cx, y + size.cy};
}

RECT PlacePicture(const DialogInfo& dialog, SIZE client, SIZE picture) {
  // The free room is shared out: 0 leaves none before the picture, 2 all of it.
  static const struct {
    const char* szWord;
    LONG lRight, lDown;
  } PLACES[] = {{"left_up", 0, 0}, {"left_down", 0, 2}, {"right_up", 2, 0}, {"right_down", 2, 2}};
  POINT at = {(client.cx - picture.cx) / 2, (client.cy - picture.cy) / 2};  // "center", and any other word
  for (const auto& row : PLACES)
    if (strcmp(row.szWord, dialog.m_csPicturePlace.Text()) == 0)
      at = {(client.cx - picture.cx) * row.lRight / 2, (client.cy - picture.cy) * row.lDown / 2};
  if (strcmp("change_position", dialog.m_csPicturePlace.Text()) == 0)
    at = {dialog.m_iPictureAt[0], dialog.m_iPictureAt[1]};
  return {at.x, at.y, at.x + picture.cx, at.y + picture.cy};
}

void PlaceKeeper::Open(const char* szFile) {
  m_csFile = szFile;
  m_Area = m_Restored = RECT();
  m_bMaximized = m_bChanged = false;
  // An open configuration file makes a missing one: a run that changes nothing leaves nothing.
  if (m_csFile.bEmpty() || !bOsExists(szFile)) return;
  CNConfigFile file(szFile);
  CNString csMaximized;
  if (bReadRectangle(file, POSITION, m_Area)) m_Restored = m_Area;
  if (!file.iReadConfigString(MAXIMIZED, csMaximized)) m_bMaximized = atoi(csMaximized.Text()) != 0;
  RECT restored;
  if (m_bMaximized && bReadRectangle(file, RESTORED, restored)) m_Restored = restored;
  if (!IsRectEmpty(&m_Restored)) m_Restored = BroughtBack(m_Restored);
}

void PlaceKeeper::Note(const RECT& area, const RECT& restored, bool bMaximized) {
  m_Restored = restored;
  if (EqualRect(&area, &m_Area) && bMaximized == m_bMaximized) return;
  m_Area = area;
  m_bMaximized = bMaximized;
  m_bChanged = !m_csFile.bEmpty();
}

void PlaceKeeper::Save() {
  if (!m_bChanged) return;
  m_bChanged = false;
  CNConfigFile file(m_csFile.Text());
  const SIZE size = SizeOf(m_Area);
  WriteRectangle(file, LAST_SIZE, "%ld,%ld,%ld,%ld", {m_Area.left, m_Area.top, size.cx, size.cy});
  WriteRectangle(file, POSITION, "%ld %ld %ld %ld", m_Area);
  if (!m_bMaximized) {
    file.iRemoveConfigString(MAXIMIZED);
    return;
  }
  file.iWriteConfigString(MAXIMIZED, "1");
  WriteRectangle(file, RESTORED, "%ld %ld %ld %ld", m_Restored);
}
