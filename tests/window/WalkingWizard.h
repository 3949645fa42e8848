// A wizard of two pages that walks through them by itself: each call of the command Walk looks at the fields, changes
// them and takes the next step (Next, Back, Next, Back, end).
#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "window/Win32View.h"
#include "wizard/COrbitWizard.h"

struct WalkedField {
  const char *szName, *szFirst, *szChanged;
  bool bForgets = false;  // it comes back with its first value
};

class WalkingWizard : public COrbitWizard {
 public:
  WalkingWizard(WizardView& view, const std::vector<WalkedField>& fields)
      : COrbitWizard(view), m_View(view), m_Fields(fields) {}
  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override {
    if (strcmp(szCommand, "Walk") != 0)
      return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
    static const int STEPS[] = {ID_NEXT, ID_BACK, ID_NEXT, ID_BACK, ID_EXIT};
    CNString csText;
    for (const WalkedField& field : m_Fields) {
      const BaseControl* pControl = GetBaseControl(field.szName);
      if (!pControl) continue;  // on the other page
      EXPECT_TRUE(m_View.bGetText(*pControl, csText));
      EXPECT_STREQ(csText.Text(), m_iStep && !field.bForgets ? field.szChanged : field.szFirst) << field.szName;
      m_View.bSetText(*pControl, field.szChanged);
    }
    m_View.PostCommand(STEPS[m_iStep++]);
    return 0;
  }
  int m_iStep = 0;

 private:
  WizardView& m_View;
  const std::vector<WalkedField>& m_Fields;
};

// The fields' values stay over Next and Back. szInit: the script's variables; szControls: the first page's lines.
inline void ExpectValuesStay(const char* szInit, const std::string& controls, const std::vector<WalkedField>& fields) {
  const std::unique_ptr<WizardView> view = pMakeWin32View(GetModuleHandleW(nullptr));
  WalkingWizard wizard(*view, fields);
  const std::string walk = "START_AFTER_DRAWING\nSTART_ACTION\nWalk ()\nFINISH_ACTION\nEND\nCONTINUE\n";
  const std::string script = std::string("INIT\n") + szInit + "END_INIT\nDIALOG1 'a' \"\" 0 0 400 400\nBEGIN\n" +
                             controls + walk + "END_DIALOG1\nDIALOG2 'b' \"\" 0 0 400 300\nBEGIN\n" + walk +
                             "END_DIALOG2\n";
  EXPECT_EQ(wizard.iExecuteWizard(script.c_str(), 0), 0);
  EXPECT_EQ(wizard.m_iStep, 5);
}
