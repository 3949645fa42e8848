// Progress bars, from 0 to 100.
#include "window/NativeControls.h"

namespace {

void Created(NativeControl& native) { SendMessageW(native.hWnd(), PBM_SETRANGE32, 0, 100); }

}  // namespace

const NativeKind g_ProgressWindow = {.kind = ControlKind::Progress,
                                     .dwStyle = 0,
                                     .dwRemovedStyle = WS_TABSTOP,
                                     .dwExStyle = 0,
                                     .bField = false,
                                     .pCreated = Created};
