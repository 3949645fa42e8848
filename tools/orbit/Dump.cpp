#include "Dump.h"

#include <chrono>

#include "OrbitText.h"
#include "OutputFile.h"
#include "RunView.h"
#include "ScriptWriter.h"
#include "ToolWizard.h"

const char* const DUMP_HELP = R"(Loads the script as the setup program does and writes back what the engine has
understood of it: the variables with their escapes, and of each dialog the
header, the font, the tooltip time, the controls with their groups, the actions,
the tables and the flow text. What is not in the dump is not in the wizard:
comments, unknown lines, repeated blocks. The dump of a dump is the same text.

SCRIPT is in code page 1250, as the setup program reads it; a file with a UTF-8
byte order mark, or with letters in valid UTF-8, is taken as UTF-8. The dump is
printed as UTF-8; --output writes it as a file for the setup program, in code
page 1250.

The message boxes of the loader are lines on the error output. Exit code: the
loader's result: 0, 1 for an empty name and for faults in the block structure,
9 for a file that cannot be read or a bad INIT block, 46 for a script without a
dialog; 1 when the output cannot be written; 2 for wrong usage.)";

int DumpScript(const DumpJob& job, FILE* pOut, FILE* pErrors) {
  RunView view(pErrors, pErrors);
  ToolWizard wizard(view);
  view.SetWizard(&wizard);
  const auto start = std::chrono::steady_clock::now();
  const int iResult = wizard.iLoadScript(job.script, pErrors);
  const std::chrono::duration<double, std::milli> spent = std::chrono::steady_clock::now() - start;
  if (job.bTime) std::fprintf(pErrors, "loaded %d dialogs in %.2f ms\n", wizard.DialogCount(), spent.count());
  if (iResult) return iResult;
  const std::string script = ScriptOf(wizard);
  if (job.output.empty()) {
    std::fputs(ToUtf8(script.c_str()).c_str(), pOut);
    return 0;
  }
  CheckOutput(job.output, "", {job.script});
  OutputFile output(job.output);
  output.Write(script.data(), script.size());
  output.Commit(job.script);
  return 0;
}
