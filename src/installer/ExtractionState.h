// What the window thread, the extraction worker and the slide show share: plain numbers that one side writes and the
// others poll.
#pragma once

#include <atomic>
#include <cstdint>

#include "foundation/os/Os.h"

struct ExtractionState {
  std::atomic<int> bCancelled{0};         // the rest is not to be copied
  std::atomic<int> iBusy{0};              // not 0: extraction runs, or a script holds quitting back
  std::atomic<int> bAllSlidesShown{0};    // each slide has been shown once, or there are none
  std::atomic<uint32_t> uMinimumTime{0};  // milliseconds that extraction should take at least: interval * slides
  std::atomic<int> iSlideCount{0};
  std::atomic<int> iWorkers{0};  // threads that still use the wizard
  uint32_t uSlideInterval = 8000;
  CNString csJournalStart;   // made before the worker starts
  uint64_t copiedBytes = 0;  // known when the worker has ended
};

// Sleeps in short steps until the time is over or bStop() says so.
template <class Stop>
void SleepUnless(uint32_t uMilliseconds, Stop bStop) {
  const uint32_t uStep = 50;
  while (uMilliseconds && !bStop()) {
    const uint32_t uNow = uMilliseconds < uStep ? uMilliseconds : uStep;
    OsSleep(uNow);
    uMilliseconds -= uNow;
  }
}
