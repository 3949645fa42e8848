// Push buttons. One with a background colour, a gradient or a picture is drawn here; the others have the system's look.
#include "window/ButtonWindow.h"

#include "window/NativeControls.h"
#include "window/ShownDialog.h"
#include "wizard/WizardView.h"

namespace {

const int CORNER = 5;  // diameter of the rounded corners

// The colour mixed with another one: iPercent of it, the rest of the other.
COLORREF Mix(COLORREF color, COLORREF other, int iPercent) {
  const auto part = [iPercent](int a, int b) { return (a * iPercent + b * (100 - iPercent)) / 100; };
  return RGB(part(GetRValue(color), GetRValue(other)), part(GetGValue(color), GetGValue(other)),
             part(GetBValue(color), GetBValue(other)));
}

COLORREF Darker(COLORREF color, int iPercent) { return Mix(color, RGB(0, 0, 0), iPercent); }

struct ButtonLook {
  const CNButton& button;
  RECT area;
  bool bPressed, bDisabled, bFocused, bDefault, bShowMnemonic;

  COLORREF Face() const {
    if (button.m_Background.bSet) return ToColorRef(button.m_Background);
    return button.m_bGradient ? ToColorRef(button.m_Bottom) : GetSysColor(COLOR_BTNFACE);
  }
};

void FillGradient(HDC hDC, const RECT& area, COLORREF top, COLORREF bottom) {
  const int iHeight = area.bottom - area.top;
  for (int y = 0; y < iHeight; y++) {
    const OwnedBrush brush(CreateSolidBrush(Mix(bottom, top, iHeight > 1 ? 100 * y / (iHeight - 1) : 0)));
    const RECT row = {area.left, area.top + y, area.right, area.top + y + 1};
    FillRect(hDC, &row, brush.Get());
  }
}

// Mixes what is there with a colour, iPercent of it.
void Veil(HDC hDC, const RECT& area, COLORREF color, int iPercent) {
  const RECT dot = {0, 0, 1, 1};
  const OwnedMemoryDC memory(CreateCompatibleDC(hDC));
  const OwnedBitmap bitmap(CreateCompatibleBitmap(hDC, 1, 1));
  const OwnedBrush brush(CreateSolidBrush(color));
  Selected scope(memory.Get(), bitmap.Get());
  FillRect(memory.Get(), &dot, brush.Get());
  GdiAlphaBlend(hDC, area.left, area.top, area.right - area.left, area.bottom - area.top, memory.Get(), 0, 0, 1, 1,
                {AC_SRC_OVER, 0, static_cast<BYTE>(iPercent * 255 / 100), 0});
}

void DrawFace(HDC hDC, const NativeControl& native, const ButtonLook& look) {
  const int iShade = look.bPressed ? 90 : 100;
  if (native.m_pPicture) {
    native.m_pPicture->Draw(hDC, look.area);
    if (look.bDisabled) Veil(hDC, look.area, look.Face(), 60);
    if (look.bPressed) Veil(hDC, look.area, RGB(0, 0, 0), 15);
  } else if (look.button.m_bGradient) {
    FillGradient(hDC, look.area, Darker(ToColorRef(look.button.m_Top), iShade),
                 Darker(ToColorRef(look.button.m_Bottom), iShade));
  } else {
    // A flat colour gets a slight slope, so that a button of the page's own colour still stands out from the page.
    const COLORREF face = Darker(look.Face(), iShade);
    const COLORREF light = look.bPressed ? Darker(face, 96) : Mix(face, RGB(255, 255, 255), 55);
    FillGradient(hDC, look.area, light, Darker(face, 94));
  }
}

void DrawFrame(HDC hDC, RECT frame, COLORREF color) {
  const OwnedPen pen(CreatePen(PS_SOLID, 1, color));
  Selected penScope(hDC, pen.Get()), brushScope(hDC, GetStockObject(NULL_BRUSH));
  RoundRect(hDC, frame.left, frame.top, frame.right, frame.bottom, CORNER, CORNER);
}

void DrawBorder(HDC hDC, const ButtonLook& look) {
  const COLORREF face = look.Face();
  const int iShade = look.bDisabled ? 80 : look.bDefault ? 35 : 55;
  RECT frame = look.area;
  DrawFrame(hDC, frame, Darker(face, iShade));
  if (!look.bDefault || look.bDisabled) return;
  InflateRect(&frame, -1, -1);
  DrawFrame(hDC, frame, Darker(face, 65));
}

void DrawCaption(HDC hDC, const NativeControl& native, const ButtonLook& look) {
  const std::unique_ptr<wchar_t[]> pText = WindowText(native.hWnd());
  const bool bLines = (GetWindowLongW(native.hWnd(), GWL_STYLE) & BS_MULTILINE) != 0;
  Selected font(hDC, native.hFont());
  UINT uFormat = DT_CENTER | (bLines ? DT_WORDBREAK : DT_SINGLELINE | DT_VCENTER);
  if (!look.bShowMnemonic) uFormat |= DT_HIDEPREFIX;
  RECT area = look.area;
  InflateRect(&area, -4, -2);
  if (bLines) {
    RECT needed = area;
    DrawTextW(hDC, pText.get(), -1, &needed, uFormat | DT_CALCRECT);
    area.top += (area.bottom - area.top - (needed.bottom - needed.top)) / 2;
  }
  if (look.bPressed) OffsetRect(&area, 1, 1);
  const ControlColor& own = look.button.m_TextColor;
  const COLORREF color = own.bSet ? ToColorRef(own) : GetSysColor(COLOR_BTNTEXT);
  SetTextColor(hDC, look.bDisabled ? Mix(color, look.Face(), 45) : color);
  SetBkMode(hDC, TRANSPARENT);
  DrawTextW(hDC, pText.get(), -1, &area, uFormat);
}

void DrawFocus(HDC hDC, const ButtonLook& look) {
  RECT area = look.area;
  InflateRect(&area, -3, -3);
  // The pattern is drawn with these two colours.
  SetTextColor(hDC, RGB(0, 0, 0));
  SetBkColor(hDC, RGB(255, 255, 255));
  DrawFocusRect(hDC, &area);
}

void Draw(NativeControl& native, const DRAWITEMSTRUCT& item) {
  const ButtonLook look = {static_cast<const CNButton&>(native.Control()),
                           item.rcItem,
                           (item.itemState & ODS_SELECTED) != 0,
                           (item.itemState & ODS_DISABLED) != 0,
                           (item.itemState & ODS_FOCUS) && !(item.itemState & ODS_NOFOCUSRECT),
                           native.hWnd() == native.Dialog().hDefaultButton(),
                           !(item.itemState & ODS_NOACCEL)};
  BufferedDC buffer(item.hDC, item.rcItem);
  const HDC hDC = buffer.Get();
  native.FillBehind(hDC, look.area);  // behind the rounded corners
  {
    const HRGN hShape =
        CreateRoundRectRgn(look.area.left, look.area.top, look.area.right + 1, look.area.bottom + 1, CORNER, CORNER);
    SelectClipRgn(hDC, hShape);
    DrawFace(hDC, native, look);
    SelectClipRgn(hDC, nullptr);
    DeleteObject(hShape);
  }
  DrawBorder(hDC, look);
  DrawCaption(hDC, native, look);
  if (look.bFocused) DrawFocus(hDC, look);
}

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  const auto& button = static_cast<const CNButton&>(native.Control());
  if (!button.m_csPicture.bEmpty()) {
    native.m_pPicture.reset(new Picture);
    if (!native.m_pPicture->bLoad(window.hInstance, button.m_csPicture.Text(), ControlColor()))
      native.m_pPicture.reset();
  }
  if (!button.m_bOwnerDrawn && !button.m_Background.bSet && !button.m_bGradient && !native.m_pPicture) return;
  window.style = (window.style & ~BS_TYPEMASK) | BS_OWNERDRAW;
}

int Notification(NativeControl& native, int iCode) {
  if (iCode == BN_SETFOCUS || iCode == BN_KILLFOCUS) native.Dialog().OnButtonFocus(native.hWnd(), iCode == BN_SETFOCUS);
  // The second of two quick presses arrives as a double click.
  return iCode == BN_CLICKED || iCode == BN_DOUBLECLICKED ? NOTIFY_CLICK : NativeKind::IGNORED;
}

}  // namespace

void ShowDefaultLook(HWND hButton, bool bDefault) {
  if (!hButton) return;
  const LONG lStyle = GetWindowLongW(hButton, GWL_STYLE);
  if ((lStyle & BS_TYPEMASK) == BS_OWNERDRAW)
    InvalidateRect(hButton, nullptr, FALSE);
  else
    SendMessageW(hButton, BM_SETSTYLE, (lStyle & 0xFFFF & ~BS_TYPEMASK) | (bDefault ? BS_DEFPUSHBUTTON : BS_PUSHBUTTON),
                 TRUE);
}

const NativeKind g_ButtonWindow = {.kind = ControlKind::Button,
                                   .dwStyle = BS_NOTIFY,
                                   .pPrepare = Prepare,
                                   .pNotification = Notification,
                                   .pDraw = Draw};
