// Headers of columns. A header's text is the heading that was pressed last.
#include "foundation/os/OsWide.h"
#include "window/ItemWindow.h"
#include "wizard/WizardView.h"

namespace {

class HeaderWindow : public ItemWindow {
 public:
  using ItemWindow::ItemWindow;
  static NativeEvent Notify(NativeControl& native, NMHDR& message);

 protected:
  void Fill(const CNCharArray& texts) override;
  void SetValue(const char* szText) override { m_csPressed = szText; }
  void GetValue(CNString& csText) override { csText = m_csPressed.Text(); }

 private:
  CNString m_csPressed;
};

void HeaderWindow::Fill(const CNCharArray& texts) {
  while (Header_DeleteItem(hWnd(), 0)) {
  }
  RECT client;
  GetClientRect(hWnd(), &client);
  const int* pWidths = m_Native.Control().m_iSize + 4;
  int iFree = static_cast<int>(client.right), nFree = 0;
  const auto widthOf = [&](int i) { return i < 4 ? pWidths[i] : 0; };
  for (int i = 0; i < texts.Size(); i++) {
    iFree -= widthOf(i);
    nFree += widthOf(i) == 0;
  }
  for (int i = 0; i < texts.Size(); i++) {
    ItemLook look;
    const CNWideText text(szBehindLook(texts[i], look));
    HDITEMW column = {};
    column.mask = HDI_TEXT | HDI_WIDTH | HDI_FORMAT;
    column.fmt = HDF_STRING | (look.bRight ? HDF_RIGHT : HDF_LEFT);
    column.cxy = widthOf(i) ? widthOf(i) : iFree > 0 ? iFree / nFree : 0;
    column.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
    Send(HDM_INSERTITEMW, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(&column));
  }
}

NativeEvent HeaderWindow::Notify(NativeControl& native, NMHDR& message) {
  if (message.code != HDN_ITEMCLICKW) return Told(message);
  auto& header = Of<HeaderWindow>(native);
  wchar_t text[MAX_PATH] = L"";
  HDITEMW column = {};
  column.mask = HDI_TEXT;
  column.pszText = text;
  column.cchTextMax = MAX_PATH;
  header.Send(HDM_GETITEMW, static_cast<WPARAM>(reinterpret_cast<NMHEADERW&>(message).iItem),
              reinterpret_cast<LPARAM>(&column));
  bNarrow(text, header.m_csPressed);
  header.Tell(NOTIFY_CLICK);
  return NativeEvent();
}

}  // namespace

const NativeKind g_HeaderWindow = {.kind = ControlKind::Header,
                                   .dwStyle = HDS_HORZ,
                                   .pCreated = ItemWindow::Create<HeaderWindow>,
                                   .pSetText = ItemWindow::bSetText,
                                   .pGetText = ItemWindow::bGetText,
                                   .pNotify = HeaderWindow::Notify,
                                   .pSetItems = ItemWindow::SetItems};
