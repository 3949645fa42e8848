// The field that edits one cell of a list view in its place: a text field, a field for formatted text, or a choice.
#pragma once

#include "controls/ItemKinds.h"
#include "window/Handles.h"

// Sent or posted to the list view by the field. wParam: keep what it holds; lParam: the field.
const UINT CELL_EDITED = WM_APP + 0x310;

// Makes the field over the cell and gives it the keyboard. The texts behind the first of the column (null: none) are
// the choices. Null when there is no such field. The list view destroys it on CELL_EDITED.
HWND hOpenCellEditor(HWND hList, CellEditor editor, const RECT& cell, const char* szText, const CNItem* pColumn);
