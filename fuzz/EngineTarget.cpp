// The engine as a whole: a script, and behind a zero byte the steps that are taken in it, two bytes each. A script
// without steps gets some that follow from its bytes.
#include <utility>

#include "Fuzz.h"
#include "FuzzWizard.h"
#include "controls/Layout.h"

namespace {

const size_t MAX_STEPS = 60;
const size_t OWN_STEPS = 12;

const char* const TEXTS[] = {"", "1", "C:\\Plumo", "<%path%>", "<%win_ver", "x\"y\\n%s", "a;b;c", "\x8a\xe6 "};

class EngineRun {
 public:
  EngineRun(const std::string& script, std::string steps) : m_steps(std::move(steps)) {
    if (m_wizard.iLoadMainList(script.c_str())) return;
    m_view.onStep = [this] { return bStep(); };
    m_wizard.iRunWindow("FuzzClass", 0);
  }

 private:
  bool bStep() {
    if (m_next + 1 >= m_steps.size() || m_next >= 2 * MAX_STEPS) return false;
    const auto what = static_cast<unsigned char>(m_steps[m_next]);
    m_argument = static_cast<unsigned char>(m_steps[m_next + 1]);
    m_next += 2;
    static void (EngineRun::*const STEPS[])() = {
        &EngineRun::Command, &EngineRun::Next,   &EngineRun::Press, &EngineRun::Type, &EngineRun::Select,
        &EngineRun::Notify,  &EngineRun::Answer, &EngineRun::Look,  &EngineRun::Item, &EngineRun::Arrange};
    (this->*STEPS[what % std::size(STEPS)])();
    return true;
  }

  void Command() {
    static const int IDS[] = {ID_OK, ID_CLOSE, ID_NEXT, ID_BACK, ID_CANCEL, ID_EXIT, ID_SHOW_DIALOG, 0};
    m_view.SendCommand(IDS[m_argument % std::size(IDS)]);
  }
  void Next() { m_view.SendCommand(m_argument % 4 ? ID_NEXT : ID_BACK); }
  void Press() { m_view.bPress(Name()); }
  void Type() { m_view.bType(Name(), TEXTS[m_argument / 32]); }
  void Select() {
    const HeadlessView::ControlState* pState = m_view.pState(Name());
    if (!pState || pState->items.empty()) return;
    const std::string item = pState->items[m_argument / 8 % pState->items.size()];
    m_view.bSelect(Name(), item.c_str());
  }
  void Notify() {
    static const int NOTIFICATIONS[] = {NOTIFY_DOUBLE_CLICK, NOTIFY_EDIT_CHANGE, NOTIFY_DROP_DOWN, NOTIFY_DROP_UP,
                                        NOTIFY_MOUSE_IN,     NOTIFY_MOUSE_OUT,   NOTIFY_MOUSE_UP,  NOTIFY_MOUSE_DOWN};
    BaseControl* pControl = Control();
    if (pControl) m_view.Notify(*pControl, NOTIFICATIONS[m_argument / 32]);
  }
  // Chooses one of the control's items by its text, and ticks it when it can be ticked.
  void Item() {
    const BaseControl* pControl = Control();
    const CNItemControl* pHolder = pControl ? pControl->pItemControl() : nullptr;
    if (!pHolder || !pHolder->m_Items.Size()) {
      m_view.bChooseItem(pControl ? pControl->m_csCaption.Text() : "");
      return;
    }
    const CNItem& item = *pHolder->m_Items[m_argument / 8 % pHolder->m_Items.Size()];
    CNString csVariable;
    item.FlagArgument("VAR", csVariable);
    m_view.bTick(csVariable.Text(), m_argument % 2);
    m_view.bChooseItem(item.szText());
  }
  // Nothing within a window may come out larger than numbers can be, whatever the window's size.
  void Arrange() {
    static const int SIZES[] = {0, 1, 100, 777, 100000};
    const DialogInfo* pDialog = m_view.Dialog();
    if (!pDialog) return;
    const BaseControl* const containers[] = {nullptr, Control()};
    for (const BaseControl* pContainer : containers) {
      CNArray<LayoutPlace> places;
      int iWidth = 0, iHeight = 0;
      LeastSize(*pDialog, pContainer, LayoutSizes(), iWidth, iHeight);
      LayOut(*pDialog, pContainer, SIZES[m_argument % 5], SIZES[m_argument / 5 % 5], LayoutSizes(), places);
    }
    if (const BaseControl* pControl = Control())
      bMoveSplitter(*pDialog, *pControl, LayoutSizes(), static_cast<int>(m_argument) - 128, 500);
  }
  void Answer() {
    m_view.answers.push_back(m_argument % 12);
    m_view.choices.push_back(TEXTS[m_argument / 32]);
  }
  void Look() {
    CNString csText;
    m_wizard.csGetField(Name(), csText);
    m_wizard.iSetField(Name(), TEXTS[m_argument / 32]);
    m_wizard.CWSetProgress(Name(), m_argument);
    m_wizard.iShowMessageBox(Name(), MessageIcon::None);
    for (int i = 0; i < m_wizard.DialogCount(); i++) m_wizard.GetDialog(i + 1)->GetBaseControl(Name());
  }

  BaseControl* Control() const {
    const DialogInfo* pDialog = m_view.Dialog();
    const int iCount = pDialog ? pDialog->m_Controls.Size() : 0;
    return iCount ? pDialog->m_Controls[m_argument % iCount] : nullptr;
  }
  const char* Name() const {
    const BaseControl* pControl = Control();
    return pControl ? pControl->m_csName.Text() : "";
  }

  FuzzView m_view;
  FuzzWizard m_wizard{m_view};
  std::string m_steps;
  size_t m_next = 0;
  unsigned m_argument = 0;
};

std::string OwnSteps(const std::string& script) {
  uint32_t state = 2166136261u;
  for (const unsigned char c : script) state = (state ^ c) * 16777619u;
  std::string steps;
  for (size_t i = 0; i < 2 * OWN_STEPS; i++) steps += static_cast<char>((state = state * 1664525 + 1013904223) >> 24);
  return steps;
}

}  // namespace

FUZZ_TARGET(engine, input) {
  const size_t zero = input.find('\0');
  const std::string script = input.substr(0, zero);
  if (script.find("DIALOG") == std::string::npos) return;  // it would be the name of a file
  EngineRun(script, zero == std::string::npos ? OwnSteps(script) : input.substr(zero + 1));
}
