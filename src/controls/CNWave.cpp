#include "controls/SimpleKinds.h"

// The source is a file in the folder pict. A sound is "visible" while it plays: with PLAY from the start, else when it
// is shown by its name.
const SimpleKind g_CNWave = {
    .kind = ControlKind::Wave, .szKeyword = "WAVE", .szClassName = "CNWave", .szWindowClass = nullptr};
