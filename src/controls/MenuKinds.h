// Menus, bars of buttons and keys: kinds whose items are commands. Menus and accelerators have no window of their own;
// choosing an item, or pressing a key, runs what ItemCommand says.
#pragma once

#include "controls/ControlItems.h"

// MENU_BAR and RIGHT_CLICK_MENU. MENU and SUBMENU lines open a menu, END_MENU and END_SUBMENU close it. The text behind
// a tab ("\t" in the script) names the key of the item; an ACCELERATOR makes it work.
class CNBaseMenu : public CNItemControl {
 public:
  // The wizard draws the entries itself: the line says OWNER_DRAWN, or an item has a picture, colour or font of its
  // own.
  bool m_bOwnerDrawn = false;

 protected:
  CNBaseMenu(ControlKind kind, const char* szEndWord);
  void ItemsRead(const ScriptCursor& cursor, ScriptContext& context) override;
  bool bWritesSize() const override { return false; }
};

class CNMenu : public CNBaseMenu {
 public:
  CNMenu() : CNBaseMenu(ControlKind::MenuBar, "END_MENUBAR") {}
  const char* szKeyword() const override { return "MENU_BAR"; }
  const char* szClassName() const override { return "CNMenu"; }
};

// Stands for the control whose name is on its line; without one for the dialog. It has no name of its own, so that the
// control is still found by its name.
class CNRightMenu : public CNBaseMenu {
 public:
  CNRightMenu() : CNBaseMenu(ControlKind::RightMenu, "END_RIGHT_CLICK_MENU") {}
  const char* szKeyword() const override { return "RIGHT_CLICK_MENU"; }
  const char* szClassName() const override { return "CNRightMenu"; }

  CNString m_csControl;  // null without one

 protected:
  void ReadText(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteText(CNString& csOut) const override;
};

// Items: ITEM, SEPARATOR, and COMBO 'name' "a" "b" width, whose chosen text is the variable of its name.
class CNToolbar : public CNItemControl {
 public:
  CNToolbar();
  const char* szWindowClass() const override { return "ToolbarWindow32"; }
  const char* szKeyword() const override { return "TOOLBAR"; }
  const char* szClassName() const override { return "CNToolbar"; }
};

// Bands: TOOLBAR 'name' "label" w h ... END_TOOLBAR with the lines of a toolbar, and BAND 'name of a control' "label"
// width.
class CNRebar : public CNItemControl {
 public:
  CNRebar();
  const char* szWindowClass() const override { return "ReBarWindow32"; }
  const char* szKeyword() const override { return "REBAR"; }
  const char* szClassName() const override { return "CNRebar"; }

 protected:
  void ItemsRead(const ScriptCursor& cursor, ScriptContext& context) override;
};

// A key with the keys that are held down with it. The number of the key is the system's virtual-key code.
enum KeyModifier : unsigned { KEY_SHIFT = 1, KEY_CTRL = 2, KEY_ALT = 4 };
struct KeyChord {
  int iKey = 0;
  unsigned uModifiers = 0;
};
// Reads "Ctrl+Shift+F5" in any letter case, or a key's number "#186"; what the text does not say stays. False for a key
// that is not known.
bool bReadKey(const char* p, const char* pEnd, KeyChord& chord);
// csText becomes that text; empty for key 0. A key without a name is "#186".
void WriteKey(const KeyChord& chord, CNString& csText);

// ACCELERATOR (of its dialog) and GLOBAL_ACCELERATOR (of the whole wizard).
class CNKeyAccelerators : public BaseControl {
 public:
  explicit CNKeyAccelerators(ControlKind kind) : BaseControl(kind) {}
  const char* szKeyword() const override {
    return Kind() == ControlKind::Accelerator ? "ACCELERATOR" : "GLOBAL_ACCELERATOR";
  }
  const char* szClassName() const override { return "CNKeyAccelerators"; }
  bool bIs(const KeyChord& chord) const {
    return m_Key.iKey && m_Key.iKey == chord.iKey && m_Key.uModifiers == chord.uModifiers;
  }

  KeyChord m_Key;  // key 0: not known, and reported

 protected:
  // The key may stand without quotes.
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void ReadOwnFlags(ScriptContext& context) override;
  // Even without a key there is something behind the keyword, so that the line is not taken for an empty one.
  void WriteText(CNString& csOut) const override {
    m_csCaption.bEmpty() ? (void)csOut.Concat(" \" \"") : (void)iWriteControlCaption(csOut);
  }
  bool bWritesSize() const override { return false; }
};

// Reports the end word of the block that the items leave open; nothing when they close all.
void ReportOpenBlock(const CNItemControl& control, const ScriptCursor& cursor, const ScriptContext& context);
