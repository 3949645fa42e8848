// The loader: any text that holds a dialog, else any script file. What was understood can be written back.
#include "Fuzz.h"
#include "FuzzWizard.h"
#include "foundation/os/Os.h"

FUZZ_TARGET(script, input) {
  FuzzView view;
  FuzzWizard wizard(view);
  if (input.find("DIALOG") != std::string::npos && input.find('\0') == std::string::npos) {
    wizard.iLoadMainList(input.c_str());
  } else {
    FuzzWriteFile("script.txt", input);
    wizard.iLoadMainList("script.txt");
    bOsDeleteFile("script.txt");
  }
  for (int i = 1; i <= wizard.DialogCount(); i++) {
    const CNArray<BaseControl>& controls = wizard.GetDialog(i)->m_Controls;
    CNString csOut;
    for (int iControl = 0; iControl < controls.Size(); iControl++) controls[iControl]->WriteControl(csOut);
  }
}
