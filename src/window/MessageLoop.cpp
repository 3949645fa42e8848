#include "window/MessageLoop.h"

#include "window/WindowView.h"

void RunMessageLoop(CNWindowView& view) {
  MSG message;
  while (view.bHasWindow()) {
    view.DropFormerDialogs();
    const BOOL bGot = GetMessageW(&message, nullptr, 0, 0);
    if (bGot == 0) PostQuitMessage(static_cast<int>(message.wParam));  // the outer loops are to end as well
    if (bGot <= 0) return;
    CNWindowView* pView = CNWindowView::pFromWindow(message.hwnd ? GetAncestor(message.hwnd, GA_ROOT) : nullptr);
    if (pView && pView->bPreTranslate(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}
