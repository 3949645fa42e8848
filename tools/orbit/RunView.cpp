#include "RunView.h"

#include <algorithm>

#include "OrbitText.h"
#include "RunSteps.h"

namespace {

// What a wizard may do by itself between two steps; one that does more goes round in a circle.
const int MAX_MOVES = 1000;

// The buttons of a box, by MessageButtons.
const std::vector<int> ANSWERS_OF[] = {{ANSWER_OK},
                                       {ANSWER_OK, ANSWER_CANCEL},
                                       {ANSWER_ABORT, ANSWER_RETRY, ANSWER_IGNORE},
                                       {ANSWER_YES, ANSWER_NO, ANSWER_CANCEL},
                                       {ANSWER_YES, ANSWER_NO},
                                       {ANSWER_RETRY, ANSWER_CANCEL},
                                       {ANSWER_CANCEL, ANSWER_TRY_AGAIN, ANSWER_CONTINUE}};

std::string Text(const char* szText) { return szText ? szText : ""; }

}  // namespace

void RunView::Line(const std::string& text) {
  std::fprintf(m_pOut, "%s\n", ToUtf8(OneLine(text).c_str()).c_str());
  std::fflush(m_pOut);
}

void RunView::Fail(const std::string& message) {
  m_bFailed = true;
  std::fprintf(m_pErrors, "error: %s\n", message.c_str());
}

int RunView::iShowMessage(const MessageText& message) {
  const std::vector<int>& buttons = ANSWERS_OF[static_cast<int>(message.buttons)];
  if (!answers.empty() && std::find(buttons.begin(), buttons.end(), answers.front()) == buttons.end()) {
    Fail("the next message box has no button " + AnswerWord(answers.front()));
    answers.clear();
  }
  const int iAnswer = HeadlessView::iShowMessage(message);
  Line("message \"" + Text(message.szCaption) + "\" \"" + Text(message.szText) + "\" -> " + AnswerWord(iAnswer));
  return iAnswer;
}

// A dialog that is to be left at once is drawn when the wizard has gone on to the next already.
int RunView::ShownNumber() const {
  int iNumber = m_pWizard->CurrentDialogNumber();
  if (m_pWizard->GetDialog(iNumber) != Dialog())
    for (iNumber = 1; m_pWizard->GetDialog(iNumber) != Dialog();) iNumber++;
  return iNumber;
}

void RunView::ShowDialog() {
  HeadlessView::ShowDialog();
  if (!Dialog()) return;
  Line("dialog " + std::to_string(ShownNumber()) + " '" + Dialog()->m_csName.Text() + "' \"" + Caption() + "\"");
  Move();
}

void RunView::PostCommand(int iID) {
  HeadlessView::PostCommand(iID);
  Move();
}

void RunView::Move() {
  if (++m_iMoves <= MAX_MOVES || !bHasWindow()) return;
  Fail("the wizard goes on by itself without end");
  CloseWindow();
}

std::string RunView::EndWord() const {
  static const struct {
    int iID;
    const char* szWord;
  } WORDS[] = {{ID_NEXT, "next"}, {ID_CANCEL, "cancel"}, {ID_EXIT, "exit"}};
  for (const auto& row : WORDS)
    if (row.iID == m_pWizard->EndedBy()) return row.szWord;
  return "";
}

// A wizard that is closed because the steps have run out has not ended.
void RunView::CloseWindow() {
  const bool bHadWindow = bHasWindow();
  HeadlessView::CloseWindow();
  if (bHadWindow && !EndWord().empty()) Line("ended " + EndWord());
}

bool RunView::bOpenLink(const char* szTarget, const char* szFolder) {
  Line("open " + Text(szTarget));
  return HeadlessView::bOpenLink(szTarget, szFolder);
}
