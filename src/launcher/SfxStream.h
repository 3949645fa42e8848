// Expands the payload of a stamped executable into a temporary file while the "please wait" page is shown.
#pragma once

#include "installer/SfxContext.h"
#include "launcher/SetupRun.h"

enum SfxResult : int {
  SFX_EXPANDED = 0,
  SFX_FAILED = -98,    // the payload cannot be read or is damaged, or the file cannot be written; the file may be
                       // partial
  SFX_NO_STAMP = -99,  // no temporary file was made
};

// Fills the context's temp folder (the surroundings' or the system's) and expands szExePath. Returns an SfxResult.
int ExpandSfx(const SetupSurroundings& surroundings, SfxContext& context, const char* szExePath);
// The same with the temp folder known. The context's expanded file is set as soon as the file exists.
int ReadSfxStream(const SetupSurroundings& surroundings, SfxContext& context, const char* szExePath);
// Waits uPause milliseconds, deletes both files and empties the context.
void ReleaseSfx(SfxContext& context, unsigned uPause);
