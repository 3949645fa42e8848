// Fine screens. A wizard whose script counts in pixels (NO_LOGPIXELS) is enlarged by the system, one whose numbers grow
// with the screen is left alone by it. The program's manifest says "not aware", which older systems obey for the whole
// process; newer ones let each window have its own way, which is that of the thread that makes it.
#pragma once

#include "window/Handles.h"

enum class ScreenScaling {
  AsProgram,  // nothing was asked for
  BySystem,   // the system enlarges the pixels, texts and lines sharply where it can
  ByScript,   // the script's numbers and fonts are enlarged; the system sees a program that knows the screen
};

// The thread works in the way of one wizard while this object lives. Does nothing on systems without such ways.
class ScaleScope {
 public:
  explicit ScaleScope(ScreenScaling scaling);
  ~ScaleScope();
  ScaleScope(const ScaleScope&) = delete;
  ScaleScope& operator=(const ScaleScope&) = delete;

 private:
  HANDLE m_hFormer = nullptr;
};

// Dots per inch of the screen, as the thread sees it at present, by 96.
double dScreenScale();
