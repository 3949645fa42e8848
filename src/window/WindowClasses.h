// The window class of one wizard, registered while its view lives.
#pragma once

#include "window/Handles.h"
#include "wizard/WizardView.h"

class WizardClass {
 public:
  WizardClass() = default;
  ~WizardClass();
  WizardClass(const WizardClass&) = delete;
  WizardClass& operator=(const WizardClass&) = delete;

  // Registers the class in place of an earlier registration of this object. Returns 0, PRECONDITIONS_NOT_VALID without
  // a name, or FUNCTION_ERROR after a message box; both are logged.
  int iInitWindowClass(HINSTANCE hInstance, const WizardWindowOptions& options, WNDPROC pProc);
  // The registered class as a name for the system's calls.
  const wchar_t* Atom() const { return MAKEINTATOM(m_Atom); }

 private:
  void Unregister();
  void LoadIcons(const WizardWindowOptions& options, WNDCLASSEXW& description);

  HINSTANCE m_hInstance = nullptr;
  CNString m_csName;
  ATOM m_Atom = 0;
  OwnedIcon m_Icon, m_SmallIcon;  // of an icon file; icons of resources belong to the system
};
