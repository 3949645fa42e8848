// Clicks and keys at random, as a person's hand on the mouse and the keyboard would make them, from a thread of its
// own.
#pragma once

#include <atomic>
#include <random>
#include <string>

#include "window/Handles.h"

class RandomInput {
 public:
  // hWindow is the wizard's window; uShowCommand a command that it answers by showing another page.
  RandomInput(HWND hWindow, unsigned uSeed, UINT uShowCommand);

  // Makes that many steps. False when the window has not answered for half a minute: Last() is then the last step.
  bool bRun(long lSteps);
  // Lets go of everything until bDone, as a hand does: a list that waits for the end of a drag takes nothing else.
  // False when it does not come within half a minute.
  bool bLetGo(const std::atomic<bool>& bDone);
  const std::string& Last() const { return m_last; }
  long StepsDone() const { return m_lDone; }

 private:
  struct StepRow;
  static const StepRow STEPS[];

  void Step();
  bool bAnswers() const;
  void Recover();
  int Number(int iBelow) { return static_cast<int>(m_random() % static_cast<unsigned>(iBelow)); }
  POINT Place();
  void MoveTo(POINT place);
  static void Button(DWORD dwFlags);
  static void Press(WORD wKey, bool bDown);
  static void Tap(WORD wKey);

  void Click();
  void DoubleClick();
  void RightClick();
  void Drag();
  void Wheel();
  void Key();
  void Type();
  void NewPage();

  const HWND m_hWindow;
  const DWORD m_uThread;  // of the window
  const UINT m_uShowCommand;
  std::mt19937 m_random;
  std::string m_last;
  std::atomic<long> m_lDone{0};
};
