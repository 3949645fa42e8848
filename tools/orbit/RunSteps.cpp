#include "RunSteps.h"

#include "controls/MessageSink.h"

namespace {

enum class StepArgument { None, Name, NameAndText };

const struct {
  const char* szWord;  // up to the colon
  StepArgument argument;
  StepKind kind;
} STEPS[] = {
    {"next", StepArgument::None, StepKind::Next},
    {"back", StepArgument::None, StepKind::Back},
    {"cancel", StepArgument::None, StepKind::Cancel},
    {"exit", StepArgument::None, StepKind::Exit},
    {"click", StepArgument::Name, StepKind::Click},
    {"type", StepArgument::NameAndText, StepKind::Type},
    {"check", StepArgument::Name, StepKind::Check},
    {"uncheck", StepArgument::Name, StepKind::Uncheck},
    {"choose", StepArgument::NameAndText, StepKind::Choose},
    {"command", StepArgument::Name, StepKind::Command},
    {"vars", StepArgument::None, StepKind::Vars},
    {"controls", StepArgument::None, StepKind::Controls},
};

const struct {
  const char* szWord;
  int iAnswer;
} ANSWERS[] = {
    {"ok", ANSWER_OK},         {"cancel", ANSWER_CANCEL},      {"yes", ANSWER_YES},
    {"no", ANSWER_NO},         {"abort", ANSWER_ABORT},        {"retry", ANSWER_RETRY},
    {"ignore", ANSWER_IGNORE}, {"tryagain", ANSWER_TRY_AGAIN}, {"continue", ANSWER_CONTINUE},
};

// The text in code page 1250; word is what it is a part of.
std::string Inside(const std::string& utf8, const std::string& word) {
  std::string text;
  if (!ToCp1250(utf8, text)) throw OrbitError("code page 1250 cannot hold " + word);
  return text;
}

}  // namespace

RunStep ReadStep(const std::string& word) {
  const size_t colon = word.find(':');
  for (const auto& row : STEPS) {
    const bool bTakesName = row.argument != StepArgument::None;
    if (word.substr(0, colon) != row.szWord || bTakesName != (colon != std::string::npos)) continue;
    RunStep step{row.kind, word, "", ""};
    if (!bTakesName) return step;
    step.name = Inside(word.substr(colon + 1), word);
    if (row.argument == StepArgument::NameAndText) {
      const size_t equals = step.name.find('=');
      if (equals == std::string::npos) throw OrbitError(word + ": '=' and a text must follow the control's name");
      step.text = step.name.substr(equals + 1);
      step.name.resize(equals);
    }
    if (step.name.empty()) throw OrbitError(word + ": nothing is named behind the colon");
    return step;
  }
  throw OrbitError(word + " is no step: orbit run --help lists them");
}

RunSetting ReadSetting(const std::string& word) {
  const std::string text = Inside(word, word);
  const size_t equals = text.find('=');
  if (equals == std::string::npos || equals == 0) throw OrbitError("--set " + word + ": it must be NAME=VALUE");
  return {text.substr(0, equals), text.substr(equals + 1)};
}

int ReadAnswer(const std::string& word) {
  for (const auto& row : ANSWERS)
    if (word == row.szWord) return row.iAnswer;
  throw OrbitError("--answer " + word + ": no such answer");
}

std::string AnswerWord(int iAnswer) {
  for (const auto& row : ANSWERS)
    if (iAnswer == row.iAnswer) return row.szWord;
  return std::to_string(iAnswer);
}

const char* const RUN_HELP = R"(Runs the wizard without a screen: the same engine as the setup program's, with
the commands of the installer ignored. SCRIPT is in code page 1250, as the setup
program reads it; a file with a UTF-8 byte order mark, or with letters in valid
UTF-8, is taken as UTF-8. All texts below are UTF-8.

Steps, taken one after the other, each when the wizard waits for the user:
  next, back, cancel, exit   the navigation command, whatever buttons there are
  click:NAME                 press a button, a link or a check box; or choose an
                             entry of a menu or bar by its name or text, or
                             press a key as its line writes it (Ctrl+F5)
  type:NAME=TEXT             replace the text of a field (TEXT as it stands), or
                             of the list view's cell that is <%NAME%>
  check:NAME, uncheck:NAME   press a check box unless it is already so; or tick
                             the item whose variable is NAME
  choose:NAME=ITEM           select an item of a list, combo, list view or tree;
                             press a heading
  command:LINE               run a line as the command of an event; then the
                             wizard moves as its result says, but a failed
                             line does not cancel the wizard
  vars                       print the variables, also after the wizard's end
  controls                   print the controls of the shown dialog

Answers (--answer) for message boxes, in the order of the boxes: ok, cancel, yes,
no, abort, retry, ignore, tryagain, continue. A box without an answer gets its
default button.

Output, one line each, in the order of what happens; line feeds in texts as \n:
  dialog N 'NAME' "CAPTION"               a dialog is shown
  message "CAPTION" "TEXT" -> ANSWER      a message box
  open TARGET                             a link
  result CODE COMMANDRESULT               after command:
  ended next|cancel|exit                  the wizard's end
  NAME = "VALUE"                          vars: in the order of the store, with
                                          the escapes of the script's INIT block
  a control line, as a script has it      controls

The diagnostic lines of the engine go to execution.log in the current folder
when that file exists.

Exit code: when loading fails, the loader's result: 1 for an empty name and for
faults in the block structure, 9 for a file that cannot be read or a bad INIT
block, 46 for a script without a dialog. 2 for wrong usage: an unknown word, or
a step that cannot be done because the wizard has ended, the control is not
there to be used, a box has no such button, or the wizard goes on by itself
without end; that step is named in a line "error: ..." on the error output and
the steps after it are not taken. Else 0.)";
