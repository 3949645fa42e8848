// For tests of what happens when the system fails: the same operation over and over, each time with another of its
// calls of the Os door failing. Only on the build host, and only in a build with ORBIT_FAULTS.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <iterator>
#include <set>
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
    s_kinds.clear();
    OsFaultHook = bFails;
  }
  ~Faults() { OsFaultHook = nullptr; }
  Faults(const Faults&) = delete;
  Faults& operator=(const Faults&) = delete;

  // The calls made under the latest plan, and their kinds.
  static int nCalls() { return s_nCalls; }
  static const std::set<OsCall>& Kinds() { return s_kinds; }

 private:
  static bool bFails(OsCall call) {
    s_nCalls++;
    s_kinds.insert(call);
    if (s_nCalls == s_plan.iCall) s_chosen = call;
    if (!s_plan.iCall || s_nCalls <= s_plan.iCall) return s_nCalls == s_plan.iCall;
    return s_plan.mode == FaultMode::AllFrom || (s_plan.mode == FaultMode::SameFrom && call == s_chosen);
  }

  static inline FaultPlan s_plan;
  static inline int s_nCalls = 0;
  static inline std::set<OsCall> s_kinds;
  static inline OsCall s_chosen = OsCall::Open;
};

inline auto nOpenFiles() {
  return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), std::filesystem::directory_iterator());
}

// Runs the test, a function of a FaultPlan that puts a Faults around one operation, first without faults, when calls of
// all these kinds must be among the operation's, and then with every one of its calls failing, in every mode. No run
// may leave a file open.
template <class Test>
void ForEveryFault(const std::set<OsCall>& kinds, Test test) {
  const auto nBefore = nOpenFiles();
  test(FaultPlan());
  for (const OsCall call : kinds) EXPECT_TRUE(Faults::Kinds().count(call)) << "no call of kind " << int(call);
  const int nCalls = Faults::nCalls();
  for (const FaultMode mode : FAULT_MODES)
    for (int i = 1; i <= nCalls && !testing::Test::HasFailure(); i++) {
      SCOPED_TRACE("call " + std::to_string(i) + " of " + std::to_string(nCalls) + ", mode " +
                   std::to_string(int(mode)));
      test(FaultPlan{i, mode});
      EXPECT_EQ(nOpenFiles(), nBefore) << "a file stays open";
    }
}

#endif
