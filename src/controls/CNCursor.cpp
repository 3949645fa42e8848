#include "controls/SimpleKinds.h"

// The name is that of the control that the cursor is shown over; without one it is the dialog's. The source is a file
// in the folder pict or one of the system's cursors.
const SimpleKind g_CNCursor = {
    .kind = ControlKind::Cursor, .szKeyword = "CURSOR", .szClassName = "CNCursor", .szWindowClass = nullptr};
