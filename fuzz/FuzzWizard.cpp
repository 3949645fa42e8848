#include "FuzzWizard.h"

#include <utility>

#include "Fuzz.h"

namespace {

// What a wizard may do by itself in one run.
const int MAX_MOVES = 300;

const char PAGE[] = R"(INIT
path = "C:\Program Files\Plumo"
empty = ""
number = "12"
yes = "1"
shown = "<%path%>\<%number%>"
me = "<%me%>"
END_INIT
DIALOG1 'one' "Page <%number%>" 0 0 320 200
"Arial" 15 500
BEGIN
BUTTON 'next' "Next" ID_NEXT 1 1 1 1,DEFAULT
BUTTON 'press' "Press" 1 1 1 1 ACTION: (path)
TEXT_FIELD 'link_web' "web" 1 1 1 1,LINK ACTION: (http://x)
CHECK_BOX 'yes' "yes" 1 1 1 1
EDIT_FIELD 'path' "<%path%>" 1 1 1 1
LIST_FIELD 'list' "one" "two" 1 1 1 1
COMBO_FIELD 'combo' 1 1 1 1
"one"
END_COMBO
PROGRESS_BAR 'bar' 1 1 1 1
IMAGE 'image' IDB_PLUMO 1 1 1 1
MESSAGE_BOX 'box' "caption",MB_YESNO
> text <%path%>
END_MESSAGE_BOX
END
IF yes == "1" THEN DIALOG "two"
ELSE { number = number + "1" CONTINUE }
END_DIALOG1
DIALOG2 'two' "Two" 0 0 320 200
BEGIN
BUTTON 'back' "Back" ID_BACK 1 1 1 1
END
END_DIALOG2
)";

}  // namespace

bool FuzzView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  m_pWizard = &events;
  m_queue.clear();
  return HeadlessView::bOpenWindow(events, options);
}

int FuzzView::iRun() {
  while (bHasWindow()) {
    if (!m_queue.empty()) {
      const int iID = m_queue.front();
      m_queue.pop_front();
      m_pWizard->OnCommand(iID);
    } else if (!onStep || !onStep()) {
      CloseWindow();
    }
  }
  return 0;
}

void FuzzView::PostCommand(int iID) {
  if (!bHasWindow()) return;
  m_queue.push_back(iID);
  Move();
}

void FuzzView::SendCommand(int iID) {
  Move();
  if (bHasWindow()) m_pWizard->OnCommand(iID);
}

void FuzzView::ShowDialog() {
  HeadlessView::ShowDialog();
  Move();
}

void FuzzView::Move() {
  if (++m_iMoves > MAX_MOVES) CloseWindow();
}

void FuzzView::Notify(BaseControl& control, int iNotification) {
  if (bHasWindow()) m_pWizard->OnControl(control, iNotification);
}

void FuzzOnPage(const std::function<void(FuzzWizard& wizard)>& run) {
  FuzzView view;
  FuzzWizard wizard(view);
  FUZZ_REQUIRE(wizard.iLoadMainList(PAGE) == 0);
  bool bRan = false;
  view.onStep = [&] {
    if (!bRan) run(wizard);
    return !std::exchange(bRan, true);
  };
  wizard.iRunWindow("FuzzClass", 0);
  FUZZ_REQUIRE(bRan);
}
