#include "Progress.h"

#include <unistd.h>

#include <algorithm>

Progress::Progress(FILE* pOut, std::string label, uint64_t total)
    : m_pOut(pOut),
      m_label(std::move(label)),
      m_total(std::max<uint64_t>(total, 1)),
      m_bTerminal(pOut && isatty(fileno(pOut))) {
  Advance(0);
}

Progress::~Progress() {
  if (m_bTerminal) std::fputs("\n", m_pOut);
}

void Progress::Advance(uint64_t nBytes) {
  m_done += nBytes;
  const int iStep = m_bTerminal ? 1 : 10;
  const int iPercent = static_cast<int>(std::min(m_done, m_total) * 100 / m_total) / iStep * iStep;
  if (!m_pOut || iPercent == m_iShown) return;
  m_iShown = iPercent;
  std::fprintf(m_pOut, m_bTerminal ? "\r%s %d%%" : "%s %d%%\n", m_label.c_str(), iPercent);
  std::fflush(m_pOut);
}
