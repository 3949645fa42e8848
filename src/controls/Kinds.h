// The control kinds that the view draws. Kinds whose drawing comes later are CNDeferredControl: read whole and kept.
#pragma once

#include "controls/BaseControl.h"

// A push button. One with a background colour, a gradient or a picture is owner-drawn. The picture stands in the flag
// list or where a navigation word would.
class CNButton : public BaseControl {
 public:
  CNButton() : BaseControl(ControlKind::Button) {}
  const char* szWindowClass() const override { return "BUTTON"; }
  const char* szKeyword() const override { return "BUTTON"; }
  const char* szClassName() const override { return "CNButton"; }

  int m_iNavigationID = 0;  // ID_NEXT to ID_EXIT, or 0
  bool m_bDefault = false;
  bool m_bOwnerDrawn = false;
  bool m_bGradient = false;
  ControlColor m_Top, m_Bottom;
  CNString m_csPicture;  // IDB_... or null

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteOwnWords(CNString& csOut) const override;
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNStatic : public BaseControl {
 public:
  CNStatic() : BaseControl(ControlKind::Static) {}
  const char* szWindowClass() const override { return "STATIC"; }
  const char* szKeyword() const override { return "TEXT_FIELD"; }
  const char* szClassName() const override { return "CNStatic"; }

  bool m_bLink = false;
  bool m_bFrame = false;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNProgressBar : public BaseControl {
 public:
  CNProgressBar() : BaseControl(ControlKind::Progress) {}
  const char* szWindowClass() const override { return "msctls_progress32"; }
  const char* szKeyword() const override { return "PROGRESS_BAR"; }
  const char* szClassName() const override { return "CNProgressBar"; }

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNCheckBox : public BaseControl {
 public:
  CNCheckBox() : BaseControl(ControlKind::CheckBox) {}
  const char* szWindowClass() const override { return "BUTTON"; }
  const char* szKeyword() const override { return "CHECK_BOX"; }
  const char* szClassName() const override { return "CNCheckBox"; }

  bool m_bRadio = false;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNEdit : public BaseControl {
 public:
  CNEdit() : BaseControl(ControlKind::Edit) {}
  const char* szWindowClass() const override { return "EDIT"; }
  const char* szKeyword() const override { return "EDIT_FIELD"; }
  const char* szClassName() const override { return "CNEdit"; }

  bool m_bGray = false;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

// LIST_FIELD and SIMULATED_LIST_FIELD. Hidden lists carry data for commands.
class CNListBox : public BaseControl {
 public:
  explicit CNListBox(bool bSimulated)
      : BaseControl(bSimulated ? ControlKind::SimulatedListBox : ControlKind::ListBox) {}
  const char* szWindowClass() const override { return "LISTBOX"; }
  const char* szKeyword() const override {
    return Kind() == ControlKind::ListBox ? "LIST_FIELD" : "SIMULATED_LIST_FIELD";
  }
  const char* szClassName() const override { return "CNListBox"; }
  bool bItemTexts(CNCharArray& texts) const override;

  CNCharArray m_Items;  // escapes turned into characters, variable markers still in them

 protected:
  void ReadText(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteText(CNString& csOut) const override;
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNImage : public BaseControl {
 public:
  CNImage() : BaseControl(ControlKind::Image) {}
  const char* szWindowClass() const override { return m_bCustom ? "BitmapClass" : "STATIC"; }
  const char* szKeyword() const override { return "IMAGE"; }
  const char* szClassName() const override { return "CNImage"; }

  CNString m_csPicture;  // IDB_... names a bitmap resource of the program, anything else a file in the folder pict
  bool m_bCustom = false;
  bool m_bStretch = false;
  ControlColor m_Transparent;

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteOwnWords(CNString& csOut) const override;
  void ReadOwnFlags(ScriptContext& context) override;
};

// Not shown with its dialog: a command shows it by its name. Its text stands in the following lines:
//   MESSAGE_BOX 'name' "caption", MB_YESNO, MB_ICONQUESTION
//   > "first line"
//   > second line, quotes are optional
//   END_MESSAGE_BOX
class CNMessageBox : public BaseControl {
 public:
  CNMessageBox() : BaseControl(ControlKind::MessageBox) {}
  const char* szKeyword() const override { return "MESSAGE_BOX"; }
  const char* szClassName() const override { return "CNMessageBox"; }
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;

  CNString m_csText;  // the '>' lines joined with line feeds, variable markers still in it; null without lines
  // What the flag list asks for; a command that shows the box may bring an icon of its own.
  MessageIcon m_Icon = MessageIcon::None;
  MessageButtons m_Buttons = MessageButtons::Ok;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;

 private:
  int iReadLines(ScriptCursor& cursor, ScriptContext& context);
};

// A kind that is read and kept but not drawn yet, with the lines that belong to it as text.
class CNDeferredControl : public BaseControl {
 public:
  // szEndWord is the word that ends the kind's following lines, or null for a kind of one line. bNests: a block of the
  // kind may hold others.
  CNDeferredControl(ControlKind kind, const char* szKeyword, const char* szEndWord, bool bNests = false)
      : BaseControl(kind), m_szKeyword(szKeyword), m_szEndWord(szEndWord), m_bNests(bNests) {}
  const char* szKeyword() const override { return m_szKeyword; }
  const char* szClassName() const override { return "CNDeferredControl"; }
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;

  CNString m_csOwnWords;  // what stands before the size: a file, a key, a range
  CNString m_csLines;     // the following lines, their end word's included; null when there are none

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteOwnWords(CNString& csOut) const override;

 private:
  const char* m_szKeyword;
  const char* m_szEndWord;
  const bool m_bNests;
};
