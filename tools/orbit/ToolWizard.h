// The engine as the orbit tool runs it: script files of both encodings, and no process that ends under the tool. It
// knows no installer command, and like any wizard it ignores the commands that it does not know.
#pragma once

#include <cstdio>
#include <string>

#include "ScriptFile.h"
#include "wizard/COrbitWizard.h"

class ToolWizard : public COrbitWizard {
 public:
  explicit ToolWizard(WizardView& view) : COrbitWizard(view) {}

  // Loads the script file (UTF-8 path). Returns the loader's result, or the exit code of a fault that ends the setup
  // program. What the encoding of the file makes of it is told to pErrors.
  int iLoadScript(const std::string& path, FILE* pErrors);

 protected:
  void EndProcess(int iExitCode) override { m_iExitCode = iExitCode; }
  int iReadScriptFile(const char* szFileName, CNString& csText) override;

 private:
  ScriptFile m_script;
  bool m_bRead = false;
  int m_iExitCode = 0;
};
