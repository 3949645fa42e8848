// How long loading a script takes as it grows, and assignments and substitutions as there are more of them. Prints
// milliseconds for three sizes and the growth from size to size, and fails when something grows faster than it should
// (by more than a third over the factor of ten) or the budget for loading is not kept.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <functional>
#include <string>

#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

namespace {

const int SIZES[] = {1000, 10000, 100000};
const double MAX_GROWTH = 13.3;
const double BUDGET_MS = 50;  // for loading 10,000 lines

std::string Lines(int nLines, const std::function<std::string(int iLine)>& line) {
  std::string text;
  for (int i = 0; i < nLines; i++) text += line(i) + "\n";
  return text;
}

std::string Numbered(const char* szText, int i) { return szText + std::to_string(i); }

std::string Control(int i) {
  return "  TEXT_FIELD '" + Numbered("t", i) + "' \"A text with <%v1%> in it\" 10 20 300 15,BACKGROUND(227,241,228)";
}

std::string Dialog(const std::string& name, const std::string& body, const std::string& flow) {
  return "DIALOG1 DIALOG_SYS '" + name + "' \"Caption\" 200 200 540 440,CENTER\n\"Arial\" 15 500\nBEGIN\n" + body +
         "END\n" + flow + "END_DIALOG1\n";
}

// Twenty lines each: what scripts usually look like.
std::string Dialogs(int nLines) {
  std::string text = "INIT\nv1 = \"1\"\nEND_INIT\n";
  for (int i = 0; i < nLines / 20; i++)
    text += Dialog(Numbered("d", i), Lines(13, Control), "IF (v1 == \"1\") THEN EXIT\nCONTINUE\n");
  return text;
}

std::string OneDialog(int nLines) { return Dialog("d", Lines(nLines, Control), "CONTINUE\n"); }

std::string Variables(int nLines) {
  const auto line = [](int i) { return Numbered("v", i) + " = \"value\\n\" > \"and more\""; };
  return "INIT\n" + Lines(nLines, line) + "END_INIT\n" + Dialog("d", "", "");
}

std::string WithAction(const std::string& statements) {
  return Dialog("d", "START_BEFORE_DRAWING\nSTART_ACTION\n" + statements + "FINISH_ACTION\n", "");
}

std::string NewVariables(int nLines) {
  return WithAction(Lines(nLines, [](int i) { return Numbered("v", i) + " = \"a\" + \"b\""; }));
}

std::string OneVariable(int nLines) {
  return WithAction("w = \"a\"\n" + Lines(nLines, [](int) { return std::string("v = w + \"b\""); }));
}

std::string Growing(int nLines) {
  return WithAction("v = \"a\"\n" + Lines(nLines, [](int) { return std::string("v = v + \"b\""); }));
}

std::string Substitutions(int nLines) {
  return WithAction("v = \"x\"\n" + Lines(nLines, [](int) { return std::string("w = \"<%v%> and <%v%>\""); }));
}

double Milliseconds(const std::function<void()>& work) {
  const auto start = std::chrono::steady_clock::now();
  work();
  return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
}

// The best of several: others use the machine too.
double Measure(const std::string& script, bool bRuns) {
  double best = 1e9;
  for (int iRound = 0; iRound < 5; iRound++) {
    HeadlessView view;
    COrbitWizard wizard(view);
    const double load = Milliseconds([&] { wizard.iLoadMainList(script.c_str()); });
    const double run = bRuns ? Milliseconds([&] { wizard.iDecideNextDialog(1, 1, nullptr, nullptr); }) : load;
    best = std::min(best, run);
  }
  return best;
}

const struct {
  const char* szWhat;
  std::string (*pScript)(int nLines);
  bool bRuns;           // the action of the first dialog is measured, not the loading
  bool bShown = false;  // not judged: each assignment copies the whole text
} ROWS[] = {
    {"load: dialogs of 20 lines", Dialogs, false},
    {"load: one dialog", OneDialog, false},
    {"load: variables", Variables, false},
    {"run: assignments to new variables", NewVariables, true},
    {"run: assignments to one variable", OneVariable, true},
    {"run: a text that grows", Growing, true, true},
    {"run: substitutions", Substitutions, true},
};

}  // namespace

int main() {
  bool bGood = true;
  std::printf("%-36s %10d %10d %10d   growth\n", "milliseconds for lines:", SIZES[0], SIZES[1], SIZES[2]);
  for (const auto& row : ROWS) {
    double times[3];
    for (int i = 0; i < 3; i++) times[i] = Measure(row.pScript(SIZES[i]), row.bRuns);
    const double growth = times[2] / times[1];
    const bool bKept = row.bShown || (growth < MAX_GROWTH && (row.bRuns || times[1] <= BUDGET_MS));
    bGood = bGood && bKept;
    std::printf("%-36s %10.2f %10.2f %10.2f   %.1f, %.1f %s\n", row.szWhat, times[0], times[1], times[2],
                times[1] / times[0], growth, bKept ? "" : "TOO MUCH");
  }
  return bGood ? 0 : 1;
}
