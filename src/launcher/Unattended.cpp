// What a person would do at each page.
#include "launcher/Unattended.h"

#include <cstring>

#include "controls/Kinds.h"
#include "launcher/PageName.h"
#include "wizard/FieldKinds.h"

namespace {

// More pages than any script has, and any person would go through.
const unsigned MOST_SHOWINGS = 1000;

const CNButton* pButton(const BaseControl& control) {
  return control.Kind() == ControlKind::Button ? static_cast<const CNButton*>(&control) : nullptr;
}

// Which button ends a page, in this order. The first one that fits is meant, whether it can be pressed or not: a page
// that has its Next disabled is not to be left in another way.
bool (*const ENDING_BUTTONS[])(const CNButton& button) = {
    [](const CNButton& button) { return button.m_bDefault; },
    [](const CNButton& button) { return button.m_iNavigationID == ID_NEXT; },
    [](const CNButton& button) { return button.m_bFocus; },
};

BaseControl* pEndingButton(const DialogInfo& dialog) {
  for (const auto bFits : ENDING_BUTTONS)
    for (int i = 0; i < dialog.m_Controls.Size(); i++) {
      const CNButton* pFound = pButton(*dialog.m_Controls[i]);
      if (pFound && bFits(*pFound)) return dialog.m_Controls[i];
    }
  return nullptr;
}

// The item that the variable ticks, or whose cell it is. False without one.
bool bFindItem(const DialogInfo& dialog, const char* szVariable, BaseControl*& pHolder, int& iItem, bool bCell) {
  CNString csFound;
  for (int i = 0; i < dialog.m_Controls.Size(); i++) {
    pHolder = dialog.m_Controls[i];
    const CNItemControl* pItems = pHolder->pItemControl();
    for (iItem = 0; pItems && iItem < pItems->m_Items.Size(); iItem++) {
      const CNItem& item = *pItems->m_Items[iItem];
      if (!bCell) item.FlagArgument("VAR", csFound);
      if (!bCell && csFound.IsEqual(szVariable)) return true;
      for (int iCell = 0; bCell && iCell < item.m_Texts.Size(); iCell++) {
        item.MarkedVariable(iCell, csFound);
        if (csFound.IsEqual(szVariable)) return true;
      }
    }
  }
  return false;
}

// The answers of each kind of box, by MessageButtons, '0' added to their numbers.
const char* const BOX_ANSWERS[] = {"1", "12", "345", "672", "67", "42", "2:;"};

// What refuses, by MessageButtons: the answer to a box that comes again and again.
const int REFUSALS[] = {ANSWER_OK, ANSWER_CANCEL, ANSWER_ABORT, ANSWER_CANCEL, ANSWER_NO, ANSWER_CANCEL, ANSWER_CANCEL};
const int MOST_REPEATS = 3;
const int MOST_MESSAGES = 50;       // on one showing of a page
const unsigned REPEAT_PAUSE = 300;  // milliseconds

// A field of several lines has a carriage return before each line feed, as the system's own.
CNString csWanted(const AnswerLine& line, const BaseControl* pControl) {
  CNString csText;
  csText = line.csValue.Text();
  const bool bLines = pControl && (pControl->Kind() == ControlKind::Edit || pControl->Kind() == ControlKind::RichEdit);
  if (bLines && !csText.bEmpty()) csText.SubstituteAll("csWanted", "csText", "\n", "\r\n");
  return csText;
}

BaseControl* pNamed(const DialogInfo& dialog, const char* szName) {
  return *szName ? dialog.GetBaseControl(szName) : nullptr;
}

}  // namespace

bool Walk::bFail(const char* szFormat, const char* szA, const char* szB) {
  CNString csText;
  csText.Printf("Walk::bFail", "csText", szFormat, szA, szB);
  m_Log.Line("failed: %s", csText.Text());
  m_bFailed = true;
  return false;
}

void Walk::Cancel(const char* szWhy) {
  if (!m_bCancelled) m_Log.Line("%s", szWhy);
  m_bCancelled = m_bClosed = true;
  if (m_pInstaller) m_pInstaller->CancelExtraction();
}

// ---- the answers beside the script ----

bool Walk::bHasControl(const DialogInfo& dialog, const AnswerLine& line) {
  BaseControl *const pControl = pNamed(dialog, line.csName.Text()), *pHolder;
  int iItem;
  if (line.kind == AnswerKind::Tick) return bFindItem(dialog, line.csName.Text(), pHolder, iItem, false);
  if (line.kind == AnswerKind::Press) return pControl && pButton(*pControl);
  return line.kind == AnswerKind::Message || pControl || bFindItem(dialog, line.csName.Text(), pHolder, iItem, true);
}

bool Walk::bAnswersFit() {
  for (int i = 0; i < m_Answers.Size(); i++) {
    const AnswerPage& page = m_Answers[i];
    const DialogInfo* pDialog = nullptr;
    for (int j = 1; j <= m_pInstaller->DialogCount() && !pDialog; j++)
      if (csPageName(m_pInstaller, *m_pInstaller->GetDialog(j)).IsEqual(page.csName.Text()))
        pDialog = m_pInstaller->GetDialog(j);
    CNString csPlace;
    csPlace.Printf("Walk::bAnswersFit", "csPlace", "%s:%d", m_Switches.csAnswers.Text(), page.iLine);
    if (!pDialog && page.iLine) return bFail("%s: the script has no page %s", csPlace.Text(), page.csName.Text());
    for (int j = 0; pDialog && j < page.lines.Size(); j++) {
      const AnswerLine& line = *page.lines[j];
      csPlace.Printf("Walk::bAnswersFit", "csPlace", "%s:%d", m_Switches.csAnswers.Text(), line.iLine);
      if (!bHasControl(*pDialog, line))
        return bFail("%s: the page has nothing of that kind named %s", csPlace.Text(), line.csName.Text());
    }
  }
  return true;
}

// ---- fields ----

bool Walk::bIsSo(HeadlessView& view, const AnswerLine& line) {
  CNString csText;
  BaseControl *pControl = pNamed(*view.Dialog(), line.csName.Text()), *pHolder;
  int iItem;
  bool bTicked = false;
  if (line.kind == AnswerKind::Tick)
    return bFindItem(*view.Dialog(), line.csName.Text(), pHolder, iItem, false) &&
           view.bIsItemChecked(*pHolder->pItemControl(), iItem, bTicked) && bTicked == line.csValue.IsEqual("1");
  if (pControl) return view.bGetText(*pControl, csText) && strcmp(csText.Text(), csWanted(line, pControl).Text()) == 0;
  ItemLook look;
  if (!bFindItem(*view.Dialog(), line.csName.Text(), pHolder, iItem, true)) return false;
  const CNItem& item = *pHolder->pItemControl()->m_Items[iItem];
  for (int iCell = 0; iCell < item.m_Texts.Size() && iCell < item.m_Shown.Size(); iCell++) {
    item.MarkedVariable(iCell, csText);
    if (csText.IsEqual(line.csName.Text())) return strcmp(item.szShown(iCell, look), line.csValue.Text()) == 0;
  }
  return false;
}

bool Walk::bMakeSo(HeadlessView& view, const AnswerLine& line) {
  const char* const szName = line.csName.Text();
  BaseControl* pControl = pNamed(*view.Dialog(), szName);
  const CNString csValue = csWanted(line, pControl);
  const char* const szValue = csValue.Text();
  m_Log.Line("set %s = %s", szName, szValue);
  if (line.kind == AnswerKind::Tick) return view.bTick(szName, line.csValue.IsEqual("1"));
  if (pControl && !view.bUsable(*pControl)) return false;
  if (pControl && pControl->Kind() == ControlKind::CheckBox) {
    // A radio button goes out when another of its group is pressed.
    const bool bRadio = static_cast<const CNCheckBox*>(pControl)->m_bRadio;
    return bRadio && !line.csValue.IsEqual("1") ? false : view.bPress(*pControl);
  }
  const bool bChoice = pControl && (bIsList(pControl->Kind()) || pControl->Kind() == ControlKind::Combo);
  if (!bChoice) return view.bType(szName, szValue);
  if (view.bSelect(szName, szValue) || view.bType(szName, szValue)) return true;
  const bool bSeveral = !*szValue || strchr(szValue, '\n');  // no item, or several
  if (bSeveral) view.SetField(*pControl, szValue);
  return bSeveral;
}

// Before the page is left each field must be as asked for; what another one has changed meanwhile is tried once more.
bool Walk::bVerify(HeadlessView& view, bool& bActed) {
  const int nLines = m_pPage ? m_pPage->lines.Size() : 0;
  for (int i = 0; i < nLines; i++) {
    const AnswerLine& line = *m_pPage->lines[i];
    const bool bField = line.kind == AnswerKind::Set || line.kind == AnswerKind::Tick;
    if (!bField || m_Switches.bSets(line.csName.Text()) || bIsSo(view, line)) continue;
    if (i <= m_iTried)
      return bFail("on the page %s the answer for %s cannot be given", m_csPage.Text(), line.csName.Text());
    m_iTried = i;
    bActed = true;
    bMakeSo(view, line);
    return true;
  }
  return true;
}

// ---- one step ----

void Walk::StartPage(HeadlessView& view) {
  m_uAnswered = m_uShowings;
  m_csPage = csPageName(m_pInstaller, *view.Dialog());
  m_pPage = m_csPage.bEmpty() ? nullptr : m_Answers.pPage(m_csPage.Text());
  m_iLine = 0;
  m_iTried = -1;
  m_bPressed = false;
  m_csPressed = "";
  m_csMessage = "";
}

// True when the wizard was made to act.
bool Walk::bTakeLine(HeadlessView& view, const AnswerLine& line) {
  if (line.kind == AnswerKind::Message) return false;
  if (line.kind == AnswerKind::Press) {
    m_Log.Line("press %s", line.csName.Text());
    if (!view.bPress(line.csName.Text()))
      bFail("on the page %s the button %s cannot be pressed", m_csPage.Text(), line.csName.Text());
    return true;
  }
  if (m_Switches.bSets(line.csName.Text()) || bIsSo(view, line)) return false;
  bMakeSo(view, line);  // whether it could be done is looked at when all lines have had their turn
  return true;
}

bool Walk::bPressLast(HeadlessView& view) {
  const int iLast = m_pPage ? m_pPage->iLastPress() : -1;
  BaseControl* pControl =
      iLast >= 0 ? pNamed(*view.Dialog(), m_pPage->lines[iLast]->csName.Text()) : pEndingButton(*view.Dialog());
  if (!pControl) return bFail("the page %s has no button to go on with%s", m_csPage.Text(), "");
  m_csPressed = pControl->m_csName.bEmpty() ? pControl->m_csCaption.Text() : pControl->m_csName.Text();
  m_bPressed = true;
  m_Log.Line("press %s", m_csPressed.Text());
  const CNButton* pPressed = pButton(*pControl);
  const bool bLast = !m_pInstaller || m_pInstaller->CurrentDialogNumber() >= m_pInstaller->DialogCount();
  if (!bLast && pPressed && pPressed->m_iNavigationID == ID_CANCEL) m_bCancelled = true;
  if (view.bPress(*pControl)) return true;
  return bFail("on the page %s the button %s cannot be pressed", m_csPage.Text(), m_csPressed.Text());
}

bool Walk::bStep(HeadlessView& view) {
  if (!view.Dialog()) return false;
  if (view.bWorks() || view.bHasCommand()) return true;
  if (m_bClosed || m_bFailed) return false;
  if (m_uShowings > MOST_SHOWINGS)
    return bFail("the pages go round in a circle; the last was %s%s", m_csPage.Text(), "");
  if (m_uAnswered != m_uShowings) StartPage(view);
  if (m_bPressed)
    return bFail("the page %s stays although its button was pressed. %s", m_csPage.Text(), m_csMessage.Text());
  const int iLast = m_pPage ? m_pPage->iLastPress() : -1;
  while (m_pPage && m_iLine < m_pPage->lines.Size()) {
    const int iLine = m_iLine++;
    if (iLine != iLast && bTakeLine(view, *m_pPage->lines[iLine])) return !m_bFailed;
  }
  bool bActed = false;
  if (!bVerify(view, bActed) || bActed) return !m_bFailed;
  return bPressLast(view);
}

// ---- what the views tell ----

void Walk::OnEvent(const std::string& event) {
  if (event.compare(0, 7, "dialog ") != 0) return;
  m_uShowings++;
  m_iMessages = 0;
  m_Log.Line("page %s", event.size() > 7 ? event.c_str() + 7 : "without a name");
}

// True for a message that has come too often on its page: what it asks to try again does not change, or changes for
// ever. A worker's messages are not counted; it shows each of them once.
bool Walk::bAgain(const char* szText) {
  if (OsThreadId() != m_ulThread) return false;
  m_iRepeats = m_csMessage.IsEqual(szText) ? m_iRepeats + 1 : 0;
  m_csMessage = szText;
  if (m_iRepeats) OsSleep(REPEAT_PAUSE);
  return m_iRepeats >= MOST_REPEATS || ++m_iMessages > MOST_MESSAGES;
}

int Walk::iAnswer(const HeadlessView& view, const MessageText& message, int iDefault) {
  int iLine = 0;
  const char* szText = message.szText ? message.szText : "";
  const CNString csPage = view.Dialog() ? csPageName(m_pInstaller, *view.Dialog()) : CNString();
  const int iGiven = m_Answers.iMessage(csPage.Text(), szText, &iLine);
  const bool bHas = iGiven && strchr(BOX_ANSWERS[static_cast<int>(message.buttons)], '0' + iGiven);
  if (iGiven && !bHas) bFail("%s: the message has no such answer: %s", Answers::szWord(iGiven), szText);
  const int iAnswer = bAgain(szText) ? REFUSALS[static_cast<int>(message.buttons)] : bHas ? iGiven : iDefault;
  m_Log.Line("message \"%s\": %s -> %s%s", message.szCaption ? message.szCaption : "", szText, Answers::szWord(iAnswer),
             iGiven ? " (from the answers)" : "");
  return iAnswer;
}
