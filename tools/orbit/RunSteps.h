// The words of `orbit run`'s command line. Texts are UTF-8 on the command line and code page 1250 from here on.
#pragma once

#include <string>
#include <vector>

#include "OrbitText.h"

enum class StepKind { Next, Back, Cancel, Exit, Click, Type, Check, Uncheck, Choose, Command, Vars, Controls };

struct RunStep {
  StepKind kind = StepKind::Next;
  std::string shown;  // as it was written
  std::string name;   // a control's name, or the line of `command`
  std::string text;   // what is typed or chosen
};

struct RunSetting {
  std::string name, value;
};

// Read one word. Throw OrbitError for one that is none, or that code page 1250 cannot hold.
RunStep ReadStep(const std::string& word);
RunSetting ReadSetting(const std::string& word);
// The number of the answer (MessageAnswer).
int ReadAnswer(const std::string& word);
// The word of an answer's number; the number itself when it has none.
std::string AnswerWord(int iAnswer);

// All step words and all answer words, for the help.
extern const char* const RUN_HELP;
