#include "window/Accelerators.h"

#include "foundation/ResultCodes.h"
#include "window/WindowView.h"

bool bPressedKey(const MSG& message, KeyChord& chord) {
  static const struct {
    int iKey;
    unsigned uModifier;
  } HELD[] = {{VK_SHIFT, KEY_SHIFT}, {VK_CONTROL, KEY_CTRL}, {VK_MENU, KEY_ALT}};
  if (message.message != WM_KEYDOWN && message.message != WM_SYSKEYDOWN) return false;
  chord.iKey = static_cast<int>(message.wParam);
  // Plus and minus have a second key each.
  if (chord.iKey == VK_ADD) chord.iKey = VK_OEM_PLUS;
  if (chord.iKey == VK_SUBTRACT) chord.iKey = VK_OEM_MINUS;
  for (const auto& row : HELD) {
    if (row.iKey == chord.iKey) return false;
    if (GetKeyState(row.iKey) < 0) chord.uModifiers |= row.uModifier;
  }
  return true;
}

bool CNWindowView::bTakeAccelerator(const MSG& message) {
  KeyChord chord;
  // A page that is not shown yet, or on its way out, has no commands.
  if (m_bPending || m_bClosing || !m_pDialog || !bPressedKey(message, chord)) return false;
  return m_pEvents->iTranslateKeyAccelerators(chord.iKey, chord.uModifiers) == EVERYTHING_IS_OK;
}
