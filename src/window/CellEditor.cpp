#include "window/CellEditor.h"

#include <iterator>

#include "foundation/os/OsWide.h"
#include "window/SimpleWindows.h"

namespace {

const struct {
  CellEditor editor;
  const wchar_t* szClass;
  DWORD dwStyle;
} FIELDS[] = {
    {CellEditor::Edit, L"EDIT", WS_BORDER | ES_AUTOHSCROLL},
    {CellEditor::RichEdit, L"RichEdit20W", WS_BORDER | ES_AUTOHSCROLL},
    {CellEditor::Combo, L"COMBOBOX", WS_VSCROLL | CBS_DROPDOWNLIST},
};

const int CHOICES_HEIGHT = 150;

bool bEnds(WPARAM wKey) { return wKey == VK_RETURN || wKey == VK_TAB || wKey == VK_ESCAPE; }

// Escape drops what was typed; Enter and Tab keep it, and so does what takes the keyboard away.
LRESULT CALLBACK FieldProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == WM_GETDLGCODE) return DLGC_WANTALLKEYS;
  if (uMessage == WM_CHAR && bEnds(wParam)) return 0;
  if (uMessage == WM_KEYDOWN && bEnds(wParam))
    return SendMessageW(GetParent(hWnd), CELL_EDITED, wParam != VK_ESCAPE, reinterpret_cast<LPARAM>(hWnd));
  // A window must not go while it loses the keyboard.
  if (uMessage == WM_KILLFOCUS) PostMessageW(GetParent(hWnd), CELL_EDITED, TRUE, reinterpret_cast<LPARAM>(hWnd));
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

void AddChoices(HWND hField, const CNItem& column, const char* szText) {
  for (int i = 1; i < column.m_Shown.Size(); i++)
    SendMessageW(hField, CB_ADDSTRING, 0,
                 reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(column.m_Shown[i]))));
  SendMessageW(hField, CB_SELECTSTRING, static_cast<WPARAM>(-1),
               reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(szText))));
}

}  // namespace

HWND hOpenCellEditor(HWND hList, CellEditor editor, const RECT& cell, const char* szText, const CNItem* pColumn) {
  for (const auto& row : FIELDS) {
    if (row.editor != editor) continue;
    if (editor == CellEditor::RichEdit) hSystemLibrary(L"riched20.dll");
    const bool bChoice = editor == CellEditor::Combo;
    const HWND hField =
        CreateWindowExW(0, row.szClass, Wide(szText), WS_CHILD | WS_VISIBLE | row.dwStyle, cell.left, cell.top,
                        cell.right - cell.left, cell.bottom - cell.top + (bChoice ? CHOICES_HEIGHT : 0), hList, nullptr,
                        reinterpret_cast<HINSTANCE>(GetWindowLongPtrW(hList, GWLP_HINSTANCE)), nullptr);
    if (!hField) return nullptr;
    SendMessageW(hField, WM_SETFONT, static_cast<WPARAM>(SendMessageW(hList, WM_GETFONT, 0, 0)), FALSE);
    if (bChoice && pColumn) AddChoices(hField, *pColumn, szText);
    if (!bChoice) SendMessageW(hField, EM_SETSEL, 0, -1);
    PutBefore(hField, FieldProc);
    SetFocus(hField);
    return hField;
  }
  return nullptr;
}
