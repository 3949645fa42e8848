// Ctrl-C and other requests to end: the first is only noted, so that the work stops between two blocks and takes its
// temporary files away; a second one ends the program at once.
#pragma once

// Notes requests while it lives. One at a time.
class InterruptWatch {
 public:
  InterruptWatch();
  ~InterruptWatch();
  InterruptWatch(const InterruptWatch&) = delete;
  InterruptWatch& operator=(const InterruptWatch&) = delete;
};

bool bInterrupted();
// Throws OrbitError once a request has been noted.
void ThrowIfInterrupted();
