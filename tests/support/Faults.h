// For tests of what happens when the system fails: the same operation over and over, each time with another of its
// calls of the Os door failing. Only on the build host, and only in a build with ORBIT_FAULTS.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "foundation/os/OsFault.h"

#ifdef ORBIT_FAULTS

enum class FaultMode {
  One,       // the chosen call only
  AllFrom,   // it and all that follow
  SameFrom,  // it and all of its kind that follow
};
const FaultMode FAULT_MODES[] = {FaultMode::One, FaultMode::AllFrom, FaultMode::SameFrom};

// Which call fails, counted from 1; 0 is a run without faults.
struct FaultPlan {
  int iCall = 0;
  FaultMode mode = FaultMode::One;
};

// Carries a plan out while it lives. One at a time, for operations of one thread.
class Faults {
 public:
  explicit Faults(const FaultPlan& plan) {
    s_plan = plan;
    s_nCalls = 0;
    OsFaultHook = bFails;
  }
  ~Faults() { OsFaultHook = nullptr; }
  Faults(const Faults&) = delete;
  Faults& operator=(const Faults&) = delete;

  // The calls made under the latest plan.
  static int nCalls() { return s_nCalls; }

 private:
  static bool bFails(OsCall call) {
    s_nCalls++;
    if (s_nCalls == s_plan.iCall) s_chosen = call;
    if (!s_plan.iCall || s_nCalls <= s_plan.iCall) return s_nCalls == s_plan.iCall;
    return s_plan.mode == FaultMode::AllFrom || (s_plan.mode == FaultMode::SameFrom && call == s_chosen);
  }

  static inline FaultPlan s_plan;
  static inline int s_nCalls = 0;
  static inline OsCall s_chosen = OsCall::Open;
};

// Runs the test, a function of a FaultPlan that puts a Faults around one operation, first without faults and then with
// every one of the operation's calls failing, in every mode. Returns the number of calls.
template <class Test>
int ForEveryFault(Test test) {
  test(FaultPlan());
  const int nCalls = Faults::nCalls();
  for (const FaultMode mode : FAULT_MODES)
    for (int i = 1; i <= nCalls; i++) {
      SCOPED_TRACE("call " + std::to_string(i) + " of " + std::to_string(nCalls) + ", mode " +
                   std::to_string(int(mode)));
      test(FaultPlan{i, mode});
      if (testing::Test::HasFailure()) return nCalls;
    }
  return nCalls;
}

#endif
