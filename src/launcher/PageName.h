// How logs and answers name a page.
#pragma once

#include "wizard/COrbitWizard.h"

// Its name, or "#" and its number when it has none; empty for one that is not the wizard's.
inline CNString csPageName(const COrbitWizard* pWizard, const DialogInfo& dialog) {
  CNString csName;
  csName = dialog.m_csName.Text();
  for (int i = 1; csName.bEmpty() && pWizard && i <= pWizard->DialogCount(); i++)
    if (pWizard->GetDialog(i) == &dialog) csName.Printf("csPageName", "csName", "#%d", i);
  return csName;
}
