// A binary semaphore used as a non-recursive lock: an object must not call its own locked operations while it holds it.
#pragma once

#include "foundation/os/Os.h"

class CNSem {
 public:
  CNSem();
  ~CNSem();
  CNSem(const CNSem&) = delete;
  CNSem& operator=(const CNSem&) = delete;

  // Waits without limit; returns at once when the semaphore could not be created.
  void GetSem();
  void ReleaseSem();

 private:
  OsSemaphore m_idSem;
};

// Holds a CNSem for one scope.
class CNSemHold {
 public:
  explicit CNSemHold(CNSem& sem) : m_sem(sem) { m_sem.GetSem(); }
  ~CNSemHold() { m_sem.ReleaseSem(); }
  CNSemHold(const CNSemHold&) = delete;
  CNSemHold& operator=(const CNSemHold&) = delete;

 private:
  CNSem& m_sem;
};
