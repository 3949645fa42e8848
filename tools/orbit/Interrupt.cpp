#include "Interrupt.h"

#include <csignal>

#include "OrbitText.h"

namespace {

const int REQUESTS[] = {SIGINT, SIGTERM,
#ifdef SIGHUP
                        SIGHUP,
#endif
#ifdef SIGBREAK
                        SIGBREAK
#endif
};

volatile std::sig_atomic_t g_interrupted = 0;

extern "C" void NoteInterrupt(int iSignal) {
  g_interrupted = 1;
  std::signal(iSignal, SIG_DFL);
}

}  // namespace

InterruptWatch::InterruptWatch() {
  g_interrupted = 0;
  for (const int iSignal : REQUESTS)
    if (std::signal(iSignal, NoteInterrupt) == SIG_IGN)
      std::signal(iSignal, SIG_IGN);  // whoever started us wants it so
}

InterruptWatch::~InterruptWatch() {
  for (const int iSignal : REQUESTS)
    if (std::signal(iSignal, SIG_DFL) == SIG_IGN) std::signal(iSignal, SIG_IGN);
  g_interrupted = 0;
}

bool bInterrupted() { return g_interrupted != 0; }

void ThrowIfInterrupted() {
  if (bInterrupted()) throw OrbitError("interrupted");
}
