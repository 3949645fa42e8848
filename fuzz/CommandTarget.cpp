// The input as a command line, as an event's command, and as the flow text of a page.
#include "Fuzz.h"
#include "FuzzWizard.h"

FUZZ_TARGET(command, input) {
  FuzzOnPage([&input](FuzzWizard& wizard) {
    int iResult = 0;
    wizard.iExecuteCommand(input.c_str(), 0, &iResult);
    wizard.iDecideNextDialog(1, 3, input.c_str(), &iResult);
    wizard.iProcessDecideNextDialogAction(iResult);
    wizard.CurrentDialog()->m_csFlow = input.c_str();
    wizard.iNextDialog();
  });
}
