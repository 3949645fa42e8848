// How long extraction pauses after each file, so that the slide show beside it is seen once. Numbers only.
#pragma once

#include <cstdint>

class Slowdown {
 public:
  // totalStored: the sum of all entries' stored sizes.
  explicit Slowdown(uint64_t totalStored) : m_total(totalStored) {}

  // True when a new stretch of data begins with the next entry: the caller notes the time.
  bool bStartsStretch() const { return m_running == 0; }

  // To be called after each entry; returns the pause in milliseconds. iRemainingFiles counts down from the number of
  // entries to 1, uElapsed is the time since the noted one, uMinimumTime the least duration of the whole extraction.
  uint32_t PauseAfter(uint32_t storedSize, int iRemainingFiles, uint32_t uElapsed, uint32_t uMinimumTime);

 private:
  uint64_t m_total;        // bytes still to come
  uint64_t m_running = 0;  // bytes of this stretch
  uint32_t m_uPause = 0;
};
