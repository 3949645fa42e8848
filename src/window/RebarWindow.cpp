// Rebars: bands of toolbars and of other controls of the dialog, which the user moves and sizes.
#include <cstdlib>

#include "foundation/os/OsWide.h"
#include "window/LayoutWindow.h"
#include "window/SimpleWindows.h"
#include "window/ToolbarWindow.h"

namespace {

const CNItemControl& Bands(const NativeControl& native) { return *native.Control().pItemControl(); }

void SetBand(HWND hRebar, const CNItem& item, UINT uMask, REBARBANDINFOW& band) {
  band.cbSize = REBARBANDINFOW_V6_SIZE;
  band.fMask = uMask;
  const auto lBand = SendMessageW(hRebar, RB_IDTOINDEX, static_cast<WPARAM>(item.m_iID), 0);
  SendMessageW(hRebar, lBand < 0 ? RB_INSERTBANDW : RB_SETBANDINFOW, static_cast<WPARAM>(lBand),
               reinterpret_cast<LPARAM>(&band));
}

void SetLabel(HWND hRebar, const CNItem& item, const char* szText) {
  const CNWideText text(szText);
  REBARBANDINFOW band = {};
  band.lpText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  if (*szText) SetBand(hRebar, item, RBBIM_TEXT, band);
}

// The flag minWidth(n), or the number of a BAND's line, else what shows the whole.
UINT MinWidth(const CNItem& item, LONG lWhole) {
  CNString csWidth;
  item.FlagArgument("minWidth", csWidth);
  if (!csWidth.bEmpty()) return static_cast<UINT>(atoi(csWidth.Text()) * item.m_dScale);
  return static_cast<UINT>(item.bIs("BAND") && item.m_iSize[0] ? item.m_iSize[0] : lWhole);
}

void SetChild(HWND hRebar, const CNItem& item, HWND hChild, SIZE size) {
  REBARBANDINFOW band = {};
  band.hwndChild = hChild;
  band.cxMinChild = MinWidth(item, size.cx);
  band.cyMinChild = static_cast<UINT>(size.cy);
  SetBand(hRebar, item, RBBIM_CHILD | RBBIM_CHILDSIZE, band);
}

void AddBand(HWND hRebar, const CNItem& item) {
  REBARBANDINFOW band = {};
  band.fStyle = RBBS_GRIPPERALWAYS | (item.bHasFlag("BREAK") ? RBBS_BREAK : 0);
  band.wID = static_cast<UINT>(item.m_iID);
  band.cx = static_cast<UINT>(item.m_iSize[0]);
  SetBand(hRebar, item, RBBIM_STYLE | RBBIM_ID | (band.cx ? RBBIM_SIZE : 0), band);
  SetLabel(hRebar, item, item.szText());
}

void AddToolbar(NativeControl& native, int iBand) {
  const CNItem& item = *Bands(native).m_Items[iBand];
  const ToolbarLook look(item);
  const HWND hToolbar =
      CreateWindowExW(WS_EX_CONTROLPARENT, TOOLBARCLASSNAMEW, nullptr,
                      WS_CHILD | WS_VISIBLE | WS_CLIPSIBLINGS | WS_CLIPCHILDREN | CCS_NODIVIDER | look.dwStyle(), 0, 0,
                      0, 0, native.hWnd(), reinterpret_cast<HMENU>(static_cast<INT_PTR>(item.m_iID)), nullptr, nullptr);
  if (!hToolbar) return;
  SetWindowLongPtrW(hToolbar, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&native));
  SendMessageW(hToolbar, WM_SETFONT, reinterpret_cast<WPARAM>(native.hFont()), FALSE);
  FillToolbar(hToolbar, native, iBand + 1, look);
  SetChild(native.hWnd(), item, hToolbar, ToolbarSize(hToolbar));
}

void Prepare(NativeControl&, CREATESTRUCTW& window) { window.lpszName = nullptr; }

void Fit(NativeControl& native) {
  FitBar(native, static_cast<int>(SendMessageW(native.hWnd(), RB_GETBARHEIGHT, 0, 0)));
}

LRESULT CALLBACK GroundProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage != WM_ERASEBKGND) return CallClassProc(hWnd, uMessage, wParam, lParam);
  RECT area;
  GetClientRect(hWnd, &area);
  NativeControl::pFromWindow(hWnd)->FillGround(reinterpret_cast<HDC>(wParam), area);
  return TRUE;
}

// Its themed look knows no colours, and its own look no pictures.
bool bHasOwnGround(const NativeControl& native) {
  return native.Control().m_Background.bSet || native.Dialog().bHasPicture() ||
         native.Dialog().GroundColor() != GetSysColor(COLOR_BTNFACE);
}

void Created(NativeControl& native) {
  native.m_pState.reset(new BarState);
  if (bHasOwnGround(native)) {
    DropTheme(native.hWnd());
    PutBefore(native.hWnd(), GroundProc);
  }
  for (int i = 0; i < Bands(native).m_Items.Size(); i++) {
    const CNItem& item = *Bands(native).m_Items[i];
    if (item.Level() != ItemLevel::Opens && !item.bIs("BAND")) continue;
    AddBand(native.hWnd(), item);
    if (item.Level() == ItemLevel::Opens) AddToolbar(native, i);
  }
  Fit(native);
}

// The controls that bands take in are made after the bar.
void BeforeShow(NativeControl& native) {
  for (int i = 0; i < Bands(native).m_Items.Size(); i++) {
    const CNItem& item = *Bands(native).m_Items[i];
    if (!item.bIs("BAND") || item.m_csName.bEmpty()) continue;
    const BaseControl* pControl = native.Dialog().Info().GetBaseControl(item.m_csName.Text());
    const NativeControl* pTaken = pControl ? native.Dialog().pFind(*pControl) : nullptr;
    if (!pTaken || pTaken == &native || GetAncestor(pTaken->hWnd(), GA_PARENT) == native.hWnd()) continue;
    const RECT place = pTaken->Place();
    SetParent(pTaken->hWnd(), native.hWnd());
    SetChild(native.hWnd(), item, pTaken->hWnd(), {place.right - place.left, place.bottom - place.top});
  }
  ShowToolbarChoices(native);
  Fit(native);
}

void SetItems(NativeControl& native, const CNCharArray& texts) {
  const CNItemControl& bands = Bands(native);
  HWND hToolbar = nullptr;
  while ((hToolbar = FindWindowExW(native.hWnd(), hToolbar, TOOLBARCLASSNAMEW, nullptr))) {
    SetToolbarTexts(hToolbar, bands, texts);
    if (const CNItem* pItem = bands.pFindItem(GetDlgCtrlID(hToolbar)))
      SetChild(native.hWnd(), *pItem, hToolbar, ToolbarSize(hToolbar));
  }
  for (int i = 0; i < bands.m_Items.Size(); i++) {
    const CNItem& item = *bands.m_Items[i];
    if (item.m_Texts.Size() > 0 && (item.Level() == ItemLevel::Opens || item.bIs("BAND")))
      SetLabel(native.hWnd(), item, texts[item.m_iFirstText]);
  }
}

// The user may move a band to a line of its own; what stands under the bar makes room.
NativeEvent Notify(NativeControl& native, NMHDR& message) {
  if (message.code == static_cast<UINT>(RBN_HEIGHTCHANGE) && message.hwndFrom == native.hWnd())
    LayOutInside(native.Dialog(), native.Control().m_pParent, GetParent(native.hWnd()));
  return ToolbarNotify(native, message);
}

}  // namespace

const NativeKind g_RebarWindow = {
    .kind = ControlKind::Rebar,
    .dwStyle = RBS_VARHEIGHT | RBS_BANDBORDERS | WS_CLIPCHILDREN | CCS_NODIVIDER | CCS_NORESIZE | CCS_NOPARENTALIGN,
    .dwRemovedStyle = WS_TABSTOP,
    .dwExStyle = WS_EX_CONTROLPARENT,
    .pPrepare = Prepare,
    .pCreated = Created,
    .pBeforeShow = BeforeShow,
    .pNotify = Notify,
    .pSetItems = SetItems,
    .pCheckItem = bCheckToolbarItem,
    .pIsItemChecked = bIsToolbarItemChecked,
    .pResized = Fit};
