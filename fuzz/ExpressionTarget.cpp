// A condition, an assignment's right side and a text with variables, each made of the whole input.
#include <memory>

#include "Fuzz.h"
#include "FuzzWizard.h"

FUZZ_TARGET(expression, input) {
  FuzzOnPage([&input](FuzzWizard& wizard) {
    // Memory that ends where the text ends: the length counts, not a terminator.
    const std::unique_ptr<char[]> pTight(new char[input.size()]);
    input.copy(pTight.get(), input.size());
    int iResult = 0;
    const int iCode = wizard.iEvaluateExpression(pTight.get(), static_cast<int>(input.size()), &iResult);
    FUZZ_REQUIRE(iCode ? iResult == -1 : iResult >= -1 && iResult <= 1);
    CNString csValue, csText(input.c_str(), 0);
    wizard.iCalculateValue(input.c_str(), csValue, 0);
    wizard.iReplaceVarWithText(csText);
  });
}
