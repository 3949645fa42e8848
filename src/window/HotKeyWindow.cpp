// Fields that take a key. Their text is the key's, "Ctrl+Shift+A".
#include <cstring>

#include "controls/MenuKinds.h"
#include "window/SimpleWindows.h"
#include "wizard/WizardView.h"

namespace {

static_assert(static_cast<int>(KEY_SHIFT) == HOTKEYF_SHIFT && static_cast<int>(KEY_CTRL) == HOTKEYF_CONTROL &&
              static_cast<int>(KEY_ALT) == HOTKEYF_ALT);

void SetKey(HWND hWnd, const KeyChord& chord) {
  // The keys between the letters and the number pad, which exist there as well.
  const bool bDoubled = chord.iKey >= VK_PRIOR && chord.iKey <= VK_DELETE;
  const unsigned uModifiers = chord.uModifiers | (bDoubled ? HOTKEYF_EXT : 0);
  SendMessageW(hWnd, HKM_SETHOTKEY, chord.iKey ? MAKEWORD(chord.iKey, uModifiers) : 0, 0);
}

bool bSetText(HWND hWnd, const char* szText) {
  KeyChord chord;
  bReadKey(szText, szText + strlen(szText), chord);
  SetKey(hWnd, chord);
  return true;
}

void Created(NativeControl& native) {
  static const struct {
    const char* szWord;
    KeyModifier modifier;
  } WORDS[] = {{"CTRL", KEY_CTRL}, {"SHIFT", KEY_SHIFT}, {"ALT", KEY_ALT}};
  const CNString& csCaption = native.Control().m_csCaption;
  KeyChord chord;
  for (const auto& row : WORDS)
    if (Simple(native).bHasWord(row.szWord)) chord.uModifiers |= row.modifier;
  bReadKey(csCaption.Text(), csCaption.Text() + csCaption.Length(), chord);
  SetKey(native.hWnd(), chord);
}

bool bGetText(HWND hWnd, CNString& csText) {
  const LRESULT lKey = SendMessageW(hWnd, HKM_GETHOTKEY, 0, 0);
  WriteKey({LOBYTE(lKey), HIBYTE(lKey)}, csText);
  return true;
}

int Notification(NativeControl&, int iCode) {
  return iCode == EN_CHANGE ? NOTIFY_SELECTION_CHANGED : NativeKind::IGNORED;
}

}  // namespace

const NativeKind g_HotKeyWindow = {.kind = ControlKind::Hotkey,
                                   .bField = true,
                                   .pPrepare = PrepareWithoutCaption,
                                   .pCreated = Created,
                                   .pSetText = bSetText,
                                   .pGetText = bGetText,
                                   .pNotification = Notification};
