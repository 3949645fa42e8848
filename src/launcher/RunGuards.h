// What may keep a product's setup from beginning: another one at work, or what is installed already.
#pragma once

#include <memory>

#include "wizard/COrbitWizard.h"

// Held from one setup of a product to its end, in all sessions of the computer.
class ProductLock {
 public:
  ProductLock() = default;
  ~ProductLock();
  ProductLock(const ProductLock&) = delete;
  ProductLock& operator=(const ProductLock&) = delete;

  // False when another setup of the product runs. szProduct is its name; letter case does not matter.
  bool bTake(const char* szProduct);

 private:
  void* m_hMutex = nullptr;
};

// Below 0, 0 or above 0. Versions are numbers with dots between them; a missing number is 0, what is no number is
// passed over ("1.10-beta" is 1.10).
int iCompareVersions(const char* szA, const char* szB);

// True when the script has refuse_installed = "1" and the list of installed programs has the product in its
// program_version or a newer one.
bool bRefusesInstalled(COrbitWizard& wizard);
