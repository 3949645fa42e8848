#include "installer/Slowdown.h"

static const uint64_t SMALL_ARCHIVE = 2097152;
static const uint64_t STRETCH = 1048576;

uint32_t Slowdown::PauseAfter(uint32_t storedSize, int iRemainingFiles, uint32_t uElapsed, uint32_t uMinimumTime) {
  const uint32_t uFiles = iRemainingFiles > 0 ? static_cast<uint32_t>(iRemainingFiles) : 1;
  if (m_total < SMALL_ARCHIVE) return m_uPause = uMinimumTime / uFiles;
  m_running += storedSize;
  if (m_running < STRETCH) return m_uPause;  // deliberately the pause computed last, 0 at first
  m_total -= m_running;
  m_running = 0;
  const uint64_t expected = uElapsed * m_total / STRETCH;
  m_uPause = expected >= uMinimumTime ? 0 : static_cast<uint32_t>((uMinimumTime - expected) / uFiles);
  return m_uPause;
}
