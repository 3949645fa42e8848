// A menu entry drawn by the wizard, from left to right: room for tick and picture, the text, the picture that stands on
// the right, the key. The system itself adds the arrow of a submenu.
#include "window/MenuDrawing.h"

#include <algorithm>
#include <memory>

#include "foundation/os/OsWide.h"

namespace {

const int PAD = 3;

// The width of a picture's or tick's place.
int iGutter(const ItemPictures& pictures) {
  return std::max<int>(pictures.Size().cx, GetSystemMetrics(SM_CXMENUCHECK)) + 2 * PAD;
}

OwnedFont FontOf(const CNItem& item) {
  NONCLIENTMETRICSW metrics = {};
  metrics.cbSize = sizeof(metrics);
  SystemParametersInfoW(SPI_GETNONCLIENTMETRICS, sizeof(metrics), &metrics, 0);
  LOGFONTW& font = metrics.lfMenuFont;
  if (item.bHasFlag("BOLD")) font.lfWeight = FW_BOLD;
  if (item.bHasFlag("ITALIC")) font.lfItalic = TRUE;
  if (item.bHasFlag("UNDERLINE")) font.lfUnderline = TRUE;
  return OwnedFont(CreateFontIndirectW(&font));
}

// The two halves of an entry's text.
struct EntryText {
  explicit EntryText(const MenuEntry& entry) : csText(entry.csText) {
    const int iTab = csText.bEmpty() ? -1 : static_cast<int>(csText.Find("\t"));
    if (iTab < 0) return;
    csKey = csText.Ptr() + iTab + 1;
    csText.SetLength(iTab);
  }
  CNString csText, csKey;
};

SIZE Measure(HDC hDC, const char* szText) {
  RECT area = {};
  DrawTextW(hDC, Wide(szText), -1, &area, DT_CALCRECT | DT_SINGLELINE);
  return {area.right, area.bottom};
}

struct EntryLook {
  const MenuEntry& entry;
  HDC hDC;
  RECT area;
  int iGutter;
  bool bSelected, bDisabled, bChecked;

  COLORREF TextColor() const {
    if (bDisabled) return GetSysColor(COLOR_GRAYTEXT);
    if (bSelected) return GetSysColor(COLOR_HIGHLIGHTTEXT);
    const ControlColor& own = entry.pItem->m_Look.text;
    return own.bSet ? ToColorRef(own) : GetSysColor(COLOR_MENUTEXT);
  }
};

void DrawGround(const EntryLook& look) {
  BOOL bFlat = FALSE;
  SystemParametersInfoW(SPI_GETFLATMENU, 0, &bFlat, 0);
  const int iSelected = bFlat ? COLOR_MENUHILIGHT : COLOR_HIGHLIGHT;
  FillRect(look.hDC, &look.area, GetSysColorBrush(look.bSelected && !look.bDisabled ? iSelected : COLOR_MENU));
}

void DrawTick(const EntryLook& look, HINSTANCE hInstance) {
  const int iHeight = look.area.bottom - look.area.top, iWidth = look.iGutter;
  Picture picture;
  const char* szName = look.bSelected ? "IDB_MENU_CHECKED_SEL" : "IDB_MENU_CHECKED";
  // Asked for first: a missing picture would be logged.
  if (FindResourceW(hInstance, Wide(szName), MAKEINTRESOURCEW(2)) && picture.bLoad(hInstance, szName, ControlColor())) {
    const SIZE size = picture.Size();
    const LONG x = look.area.left + (iWidth - size.cx) / 2, y = look.area.top + (iHeight - size.cy) / 2;
    picture.Draw(look.hDC, {x, y, x + size.cx, y + size.cy});
    return;
  }
  const int iSize = iWidth / 4;
  const int x = look.area.left + (iWidth - 2 * iSize) / 2, y = look.area.top + iHeight / 2;
  const POINT tick[] = {{x, y}, {x + iSize * 2 / 3, y + iSize * 2 / 3}, {x + 2 * iSize, y - iSize * 2 / 3}};
  const OwnedPen pen(CreatePen(PS_SOLID, std::max(2, iSize / 3), look.TextColor()));
  Selected penScope(look.hDC, pen.Get());
  Polyline(look.hDC, tick, 3);
}

// A picture that is ticked stands in a frame.
void DrawPicture(const EntryLook& look, const ItemPictures& pictures, LONG lLeft) {
  const SIZE size = pictures.Size();
  const LONG lTop = look.area.top + (look.area.bottom - look.area.top - size.cy) / 2;
  const UINT uStyle = look.bDisabled ? ILD_BLEND50 : ILD_NORMAL;
  ImageList_DrawEx(pictures.hList(), look.entry.iImage, look.hDC, lLeft, lTop, 0, 0, CLR_NONE, GetSysColor(COLOR_MENU),
                   uStyle);
  const RECT frame = {lLeft - 2, lTop - 2, lLeft + size.cx + 2, lTop + size.cy + 2};
  if (look.bChecked) FrameRect(look.hDC, &frame, GetSysColorBrush(COLOR_HOTLIGHT));
}

}  // namespace

void MeasureMenuEntry(const MenuEntry& entry, const ItemPictures& pictures, MEASUREITEMSTRUCT& item) {
  const int iRoom = iGutter(pictures);
  const EntryText text(entry);
  const OwnedFont font = FontOf(*entry.pItem);
  ScreenDC screen;
  Selected fontScope(screen.Get(), font.Get());
  const SIZE size = Measure(screen.Get(), text.csText.Text());
  const int iKey = text.csKey.bEmpty() ? 0 : Measure(screen.Get(), text.csKey.Text()).cx + 2 * iRoom;
  const int iRight = entry.pItem->m_Look.bRight ? iRoom : 0;
  // The system adds the width of a tick of its own, which serves for the arrow of a submenu.
  item.itemWidth = static_cast<UINT>(iRoom + PAD + size.cx + iRight + iKey + PAD);
  item.itemHeight = static_cast<UINT>(std::max(size.cy, pictures.Size().cy) + 2 * PAD);
}

void DrawMenuEntry(const MenuEntry& entry, const ItemPictures& pictures, HINSTANCE hInstance,
                   const DRAWITEMSTRUCT& item) {
  const EntryText text(entry);
  BufferedDC buffer(item.hDC, item.rcItem);
  const EntryLook look = {entry,
                          buffer.Get(),
                          item.rcItem,
                          iGutter(pictures),
                          (item.itemState & ODS_SELECTED) != 0,
                          (item.itemState & (ODS_GRAYED | ODS_DISABLED)) != 0,
                          (item.itemState & ODS_CHECKED) != 0};
  DrawGround(look);
  const OwnedFont font = FontOf(*entry.pItem);
  Selected fontScope(look.hDC, font.Get());
  SetBkMode(look.hDC, TRANSPARENT);
  SetTextColor(look.hDC, look.TextColor());
  RECT area = {look.area.left + look.iGutter + PAD, look.area.top, look.area.right - look.iGutter, look.area.bottom};
  const UINT uFormat = DT_SINGLELINE | DT_VCENTER | (item.itemState & ODS_NOACCEL ? DT_HIDEPREFIX : 0);
  DrawTextW(look.hDC, Wide(text.csKey.Text()), -1, &area, uFormat | DT_RIGHT);
  DrawTextW(look.hDC, Wide(text.csText.Text()), -1, &area, uFormat);
  const bool bPicture = entry.iImage >= 0, bRight = entry.pItem->m_Look.bRight;
  const LONG lRight = area.left + Measure(look.hDC, text.csText.Text()).cx + 2 * PAD;
  if (bPicture) DrawPicture(look, pictures, bRight ? lRight : look.area.left + PAD);
  if (look.bChecked && !(bPicture && !bRight)) DrawTick(look, hInstance);
}
