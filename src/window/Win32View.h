// The wizard's screen made of native windows. This is the only header of the floor that others include.
#pragma once

#include <memory>

#include "wizard/WizardView.h"

// hInstance is the program's module, which holds pictures and icons. pOwner is null or a view made by this function
// that outlives the new one: the new view's window is owned by the owner's, which is disabled while it exists.
std::unique_ptr<WizardView> pMakeWin32View(void* hInstance, WizardView* pOwner = nullptr);
