#include "window/ItemLooks.h"

#include <algorithm>
#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/ShownDialog.h"

namespace {

const int SMALL_PICTURE = 16;
const int GAP = 2;  // around a picture and beside a text

}  // namespace

ItemPictures::~ItemPictures() {
  if (m_hList) ImageList_Destroy(m_hList);
}

SIZE ItemPictures::Size() const {
  int iWidth = 0, iHeight = 0;
  if (m_hList) ImageList_GetIconSize(m_hList, &iWidth, &iHeight);
  return {iWidth, iHeight};
}

// The first picture of a list is one of nothing.
bool ItemPictures::bMakeList(const NativeControl& native, SIZE size) {
  if (m_hList) return true;
  const double dScale = native.Control().m_dScale;
  const int iWidth = static_cast<int>(size.cx * dScale), iHeight = static_cast<int>(size.cy * dScale);
  m_hList = ImageList_Create(iWidth, iHeight, ILC_COLOR24 | ILC_MASK, 4, 4);
  ScreenDC screen;
  const OwnedBitmap nothing(CreateCompatibleBitmap(screen.Get(), iWidth, iHeight));
  if (m_hList && nothing) ImageList_AddMasked(m_hList, nothing.Get(), CLR_DEFAULT);
  m_Names.Add("empty.bmp", 1);
  return m_hList != nullptr;
}

int ItemPictures::iFind(const NativeControl& native, const CNString& csName) {
  if (csName.bEmpty()) return -1;
  for (int i = 0; i < m_Names.Size(); i++)
    if (strcmp(m_Names[i], csName.Text()) == 0) return i;
  return iLoad(native, csName.Text());
}

int ItemPictures::iLoad(const NativeControl& native, const char* szName) {
  Picture picture;
  const bool bEmpty = strcmp(szName, "empty.bmp") == 0;
  const auto hInstance = reinterpret_cast<HINSTANCE>(GetWindowLongPtrW(native.hWnd(), GWLP_HINSTANCE));
  const bool bLoaded = !bEmpty && picture.bLoad(hInstance, szName, ControlColor());
  if (!bMakeList(native, bLoaded ? picture.Size() : SIZE{SMALL_PICTURE, SMALL_PICTURE}) || bEmpty) return 0;
  const SIZE size = Size();
  ScreenDC screen;
  const OwnedBitmap fitted(CreateCompatibleBitmap(screen.Get(), size.cx, size.cy));
  {
    const OwnedMemoryDC memory(CreateCompatibleDC(screen.Get()));
    const Selected bitmap(memory.Get(), fitted.Get());
    const RECT all = {0, 0, size.cx, size.cy};
    // One that is missing is remembered as well: it is looked for, and logged, once.
    PatBlt(memory.Get(), 0, 0, size.cx, size.cy, WHITENESS);
    if (bLoaded) picture.Draw(memory.Get(), all);
  }
  m_Names.Add(szName, 1);
  return std::max(0, ImageList_AddMasked(m_hList, fitted.Get(), CLR_DEFAULT));
}

int iTextWidth(const NativeControl& native, const char* szText) {
  ScreenDC screen;
  Selected font(screen.Get(), native.hFont());
  const Wide text(szText);
  SIZE size = {};
  GetTextExtentPoint32W(screen.Get(), text, lstrlenW(text), &size);
  return size.cx;
}

int iItemHeight(const NativeControl& native, const ItemPictures& pictures) {
  ScreenDC screen;
  Selected font(screen.Get(), native.hFont());
  TEXTMETRICW metrics = {};
  GetTextMetricsW(screen.Get(), &metrics);
  return static_cast<int>(std::max(metrics.tmHeight, pictures.Size().cy) + GAP);
}

void DrawItem(const NativeControl& native, const DRAWITEMSTRUCT& item, const char* szText, const ItemLook& look,
              ItemPictures& pictures) {
  BufferedDC buffer(item.hDC, item.rcItem);
  const HDC hDC = buffer.Get();
  const bool bSelected = (item.itemState & ODS_SELECTED) != 0, bDisabled = (item.itemState & ODS_DISABLED) != 0;
  RECT area = item.rcItem;
  const HBRUSH hGround = native.hColors(hDC, WM_CTLCOLORLISTBOX);
  FillRect(hDC, &area, bSelected ? GetSysColorBrush(COLOR_HIGHLIGHT) : hGround);
  if (look.text.bSet) SetTextColor(hDC, ToColorRef(look.text));
  if (bSelected) SetTextColor(hDC, GetSysColor(COLOR_HIGHLIGHTTEXT));
  if (bDisabled) SetTextColor(hDC, GetSysColor(COLOR_GRAYTEXT));

  const int iPicture = pictures.iFind(native, look.csPicture);
  if (iPicture >= 0) {
    const SIZE size = pictures.Size();
    const int iLeft = static_cast<int>(look.bRight ? area.right - GAP - size.cx : area.left + GAP);
    ImageList_Draw(pictures.hList(), iPicture, hDC, iLeft,
                   static_cast<int>(area.top + (area.bottom - area.top - size.cy) / 2), ILD_TRANSPARENT);
    (look.bRight ? area.right : area.left) = look.bRight ? iLeft - GAP : iLeft + size.cx + GAP;
  }
  InflateRect(&area, -GAP, 0);
  SetBkMode(hDC, TRANSPARENT);
  Selected font(hDC, native.hFont());
  DrawTextW(hDC, Wide(szText), -1, &area, DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX | DT_END_ELLIPSIS);
  if (item.itemState & ODS_FOCUS && !(item.itemState & ODS_NOFOCUSRECT)) DrawFocusRect(hDC, &item.rcItem);
}
