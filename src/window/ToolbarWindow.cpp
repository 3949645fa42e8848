// Toolbars. A button's text is shown beside (LARGE: below) its picture or, when it is not shown, as its tooltip; either
// way screen readers have it.
#include "window/ToolbarWindow.h"

#include <algorithm>

#include "foundation/os/OsWide.h"
#include "window/ShownDialog.h"

namespace {

const int COMBO_GAP = 4, COMBO_LIST = 200;
const DWORD BAR_STYLE =
    TBSTYLE_FLAT | TBSTYLE_TRANSPARENT | TBSTYLE_TOOLTIPS | CCS_NORESIZE | CCS_NOPARENTALIGN | CCS_NODIVIDER;

LRESULT Send(HWND hWnd, UINT uMessage, WPARAM wParam = 0, LPARAM lParam = 0) {
  return SendMessageW(hWnd, uMessage, wParam, lParam);
}

// The toolbar that has a button with the item's identifier.
HWND hToolbarOf(const NativeControl& native, const CNItem& item) {
  if (native.Control().Kind() == ControlKind::Toolbar) return native.hWnd();
  HWND hBar = nullptr;
  while ((hBar = FindWindowExW(native.hWnd(), hBar, TOOLBARCLASSNAMEW, nullptr)))
    if (Send(hBar, TB_COMMANDTOINDEX, static_cast<WPARAM>(item.m_iID)) >= 0) break;
  return hBar;
}

bool bHasVariable(const CNItem& item) {
  CNString csVariable;
  item.FlagArgument("VAR", csVariable);
  return !csVariable.bEmpty();
}

// A combo box stands in the room of a separator.
void AddCombo(HWND hToolbar, NativeControl& native, const CNItem& item) {
  const HWND hCombo =
      CreateWindowExW(0, L"COMBOBOX", nullptr, WS_CHILD | WS_VISIBLE | WS_TABSTOP | WS_VSCROLL | CBS_DROPDOWNLIST, 0, 0,
                      item.m_iSize[0], COMBO_LIST, hToolbar, reinterpret_cast<HMENU>(static_cast<INT_PTR>(item.m_iID)),
                      nullptr, nullptr);
  if (!hCombo) return;
  SetWindowLongPtrW(hCombo, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&native));
  Send(hCombo, WM_SETFONT, reinterpret_cast<WPARAM>(native.hFont()));
  if (!item.bHasFlag("DISABLE")) return;
  EnableWindow(hCombo, FALSE);
}

void AddButton(HWND hToolbar, NativeControl& native, const CNItem& item, const ToolbarLook& look) {
  const bool bCombo = item.bIs("COMBO"), bSeparator = bCombo || item.bIs("SEPARATOR");
  TBBUTTON button = {};
  button.idCommand = item.m_iID;
  button.fsStyle = bSeparator ? BTNS_SEP : BTNS_AUTOSIZE;
  if (bCombo) button.iBitmap = item.m_iSize[0] + 2 * COMBO_GAP;
  if (!bSeparator) {
    const int iPicture = static_cast<BarState&>(*native.m_pState).m_Pictures.iFind(native, item.m_Look.csPicture);
    button.iBitmap = iPicture >= 0 ? iPicture : I_IMAGENONE;
    if (iPicture < 0 || look.bLabels || item.bHasFlag("LABEL")) button.fsStyle |= BTNS_SHOWTEXT;
    const bool bTicks = item.bHasFlag("CHECKED") || bHasVariable(item);
    if (bTicks) button.fsStyle |= BTNS_CHECK;
    button.fsState = static_cast<BYTE>((item.bHasFlag("DISABLE") ? 0 : TBSTATE_ENABLED) |
                                       (item.bHasFlag("CHECKED") ? TBSTATE_CHECKED : 0));
  }
  // The height of the bar follows from what its first buttons show.
  const CNWideText text(item.szText());
  if (!bSeparator && *item.szText()) button.iString = reinterpret_cast<INT_PTR>(text.Ptr());
  if (!bSeparator && !*item.szText()) button.iString = -1;
  Send(hToolbar, TB_ADDBUTTONSW, 1, reinterpret_cast<LPARAM>(&button));
  if (bCombo) AddCombo(hToolbar, native, item);
}

void PlaceCombo(HWND hToolbar, HWND hCombo) {
  RECT room = {}, combo = {};
  Send(hToolbar, TB_GETRECT, static_cast<WPARAM>(GetDlgCtrlID(hCombo)), reinterpret_cast<LPARAM>(&room));
  GetWindowRect(hCombo, &combo);
  const LONG lTop = room.top + (room.bottom - room.top - (combo.bottom - combo.top)) / 2;
  SetWindowPos(hCombo, nullptr, room.left + COMBO_GAP, std::max(0L, lTop), 0, 0,
               SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
}

void SetButtonText(HWND hToolbar, int iID, const char* szText) {
  const CNWideText text(szText);
  TBBUTTONINFOW info = {};
  info.cbSize = sizeof(info);
  info.dwMask = TBIF_TEXT;
  info.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  Send(hToolbar, TB_SETBUTTONINFOW, static_cast<WPARAM>(iID), reinterpret_cast<LPARAM>(&info));
}

void SetComboTexts(HWND hCombo, const CNCharArray& texts, const CNItem& item) {
  Send(hCombo, CB_RESETCONTENT);
  for (int i = 0; i < item.m_Texts.Size(); i++)
    Send(hCombo, CB_ADDSTRING, 0,
         reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(texts[item.m_iFirstText + i]))));
}

const CNItemControl& Holder(const NativeControl& native) { return *native.Control().pItemControl(); }

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  window.style |= static_cast<LONG>(ToolbarLook(native.Control()).dwStyle());
  window.lpszName = nullptr;
}

void Fit(NativeControl& native) { FitBar(native, ToolbarSize(native.hWnd()).cy); }

void Created(NativeControl& native) {
  native.m_pState.reset(new BarState);
  FillToolbar(native.hWnd(), native, 0, ToolbarLook(native.Control()));
  Fit(native);
}

void SetItems(NativeControl& native, const CNCharArray& texts) {
  SetToolbarTexts(native.hWnd(), Holder(native), texts);
}

}  // namespace

DWORD ToolbarLook::dwStyle() const { return BAR_STYLE | (bLarge ? 0 : TBSTYLE_LIST); }

void FillToolbar(HWND hToolbar, NativeControl& native, int iFirst, const ToolbarLook& look) {
  const CNItemControl& holder = Holder(native);
  Send(hToolbar, TB_BUTTONSTRUCTSIZE, sizeof(TBBUTTON));
  if (look.bLarge)
    Send(hToolbar, TB_SETMAXTEXTROWS, look.bLabels);
  else
    Send(hToolbar, TB_SETEXTENDEDSTYLE, 0, TBSTYLE_EX_MIXEDBUTTONS);
  Send(hToolbar, TB_SETPARENT, reinterpret_cast<WPARAM>(GetAncestor(native.hWnd(), GA_PARENT)));
  // The list must be there before the buttons that name its pictures.
  ItemPictures& pictures = static_cast<BarState&>(*native.m_pState).m_Pictures;
  for (int i = iFirst; i < holder.m_Items.Size() && holder.m_Items[i]->Level() != ItemLevel::Closes; i++)
    pictures.iFind(native, holder.m_Items[i]->m_Look.csPicture);
  if (pictures.hList())
    Send(hToolbar, TB_SETIMAGELIST, 0, reinterpret_cast<LPARAM>(pictures.hList()));
  else
    Send(hToolbar, TB_SETBITMAPSIZE, 0, 0);
  CNCharArray texts;
  holder.bItemTexts(texts);
  for (int i = iFirst; i < holder.m_Items.Size() && holder.m_Items[i]->Level() != ItemLevel::Closes; i++)
    AddButton(hToolbar, native, *holder.m_Items[i], look);
  AddToolbarKeys(hToolbar);
  SetToolbarTexts(hToolbar, holder, texts);
}

void SetToolbarTexts(HWND hToolbar, const CNItemControl& holder, const CNCharArray& texts) {
  for (int i = 0; i < holder.m_Items.Size(); i++) {
    const CNItem& item = *holder.m_Items[i];
    if (item.m_Texts.Size() == 0 || Send(hToolbar, TB_COMMANDTOINDEX, static_cast<WPARAM>(item.m_iID)) < 0) continue;
    if (const HWND hCombo = GetDlgItem(hToolbar, item.m_iID))
      SetComboTexts(hCombo, texts, item);
    else
      SetButtonText(hToolbar, item.m_iID, texts[item.m_iFirstText]);
  }
  Send(hToolbar, TB_AUTOSIZE);
  HWND hCombo = nullptr;
  while ((hCombo = FindWindowExW(hToolbar, hCombo, L"COMBOBOX", nullptr))) PlaceCombo(hToolbar, hCombo);
}

SIZE ToolbarSize(HWND hToolbar) {
  SIZE size = {};
  Send(hToolbar, TB_GETMAXSIZE, 0, reinterpret_cast<LPARAM>(&size));
  HWND hCombo = nullptr;
  while ((hCombo = FindWindowExW(hToolbar, hCombo, L"COMBOBOX", nullptr))) {
    RECT combo = {};
    GetWindowRect(hCombo, &combo);
    size.cy = std::max(size.cy, combo.bottom - combo.top);
  }
  return size;
}

bool bCheckToolbarItem(NativeControl& native, int iItem, bool bChecked) {
  const CNItem& item = *Holder(native).m_Items[iItem];
  return Send(hToolbarOf(native, item), TB_CHECKBUTTON, static_cast<WPARAM>(item.m_iID), MAKELPARAM(bChecked, 0));
}

bool bIsToolbarItemChecked(NativeControl& native, int iItem, bool& bChecked) {
  const CNItem& item = *Holder(native).m_Items[iItem];
  const HWND hToolbar = hToolbarOf(native, item);
  if (!hToolbar) return false;
  bChecked = Send(hToolbar, TB_ISBUTTONCHECKED, static_cast<WPARAM>(item.m_iID)) != 0;
  return true;
}

NativeEvent ToolbarNotify(NativeControl& native, NMHDR& message) {
  if (message.code != TBN_GETINFOTIPW) return NativeEvent();
  auto& tip = reinterpret_cast<NMTBGETINFOTIPW&>(message);
  const CNItem* pItem = Holder(native).pFindItem(tip.iItem);
  if (pItem && !pItem->m_csShownToolTip.bEmpty())
    lstrcpynW(tip.pszText, Wide(pItem->m_csShownToolTip.Text()), tip.cchTextMax);
  return NativeEvent();
}

void ShowToolbarChoices(NativeControl& native) {
  for (int i = 0; i < Holder(native).m_Items.Size(); i++) {
    const CNItem& item = *Holder(native).m_Items[i];
    if (!item.bIs("COMBO")) continue;
    const HWND hCombo = GetDlgItem(hToolbarOf(native, item), item.m_iID);
    const LRESULT lFound = Send(hCombo, CB_FINDSTRINGEXACT, static_cast<WPARAM>(-1),
                                reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(item.m_csCaption.Text()))));
    Send(hCombo, CB_SETCURSEL, static_cast<WPARAM>(lFound));
  }
}

CNItem* pToolbarChoice(const NativeControl& native, HWND hFrom, int iID, int iCode) {
  const ControlKind kind = native.Control().Kind();
  if (kind != ControlKind::Toolbar && kind != ControlKind::Rebar) return nullptr;
  CNItem* pItem = Holder(native).pFindItem(iID);
  if (!pItem || !pItem->bIs("COMBO")) return pItem;
  const LRESULT lChosen = iCode == CBN_SELCHANGE ? Send(hFrom, CB_GETCURSEL) : CB_ERR;
  if (lChosen == CB_ERR) return nullptr;
  std::unique_ptr<wchar_t[]> pText(new wchar_t[Send(hFrom, CB_GETLBTEXTLEN, static_cast<WPARAM>(lChosen)) + 1]());
  Send(hFrom, CB_GETLBTEXT, static_cast<WPARAM>(lChosen), reinterpret_cast<LPARAM>(pText.get()));
  bNarrow(pText.get(), pItem->m_csCaption);
  return pItem;
}

void FitBar(NativeControl& native, int iNeededHeight) {
  const int* iSize = native.Control().m_iSize;
  if (iSize[2] && iSize[3]) return;
  const RECT place = native.Place();
  RECT around = {};
  GetClientRect(GetAncestor(native.hWnd(), GA_PARENT), &around);
  const LONG lWidth = iSize[2] ? place.right - place.left : around.right - place.left;
  const LONG lHeight = iSize[3] ? place.bottom - place.top : iNeededHeight;
  if (lWidth == place.right - place.left && lHeight == place.bottom - place.top) return;
  SetWindowPos(native.hWnd(), nullptr, 0, 0, lWidth, lHeight, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}

const NativeKind g_ToolbarWindow = {.kind = ControlKind::Toolbar,
                                    .dwRemovedStyle = WS_TABSTOP,
                                    .dwExStyle = WS_EX_CONTROLPARENT,
                                    .pPrepare = Prepare,
                                    .pCreated = Created,
                                    .pBeforeShow = ShowToolbarChoices,
                                    .pNotify = ToolbarNotify,
                                    .pSetItems = SetItems,
                                    .pCheckItem = bCheckToolbarItem,
                                    .pIsItemChecked = bIsToolbarItemChecked,
                                    .pResized = Fit};
