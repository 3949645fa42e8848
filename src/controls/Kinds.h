// The control kinds that the view draws. Kinds whose drawing comes later are CNDeferredControl: read whole and kept.
#pragma once

#include "controls/BaseControl.h"

// A push button. One with a background colour, a gradient or a picture is owner-drawn.
class CNButton : public BaseControl {
 public:
  CNButton() : BaseControl(ControlKind::Button) {}
  const char* szWindowClass() const override { return "BUTTON"; }
  const char* szKeyword() const override { return "BUTTON"; }
  void WriteControl(CNString& csOut) const override;

  int m_iNavigationID = 0;  // ID_NEXT to ID_EXIT, or 0
  bool m_bDefault = false;
  bool m_bOwnerDrawn = false;
  bool m_bGradient = false;
  ControlColor m_Top, m_Bottom;
  CNString m_csPicture;  // IDB_... or null

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNStatic : public BaseControl {
 public:
  CNStatic() : BaseControl(ControlKind::Static) {}
  const char* szWindowClass() const override { return "STATIC"; }
  const char* szKeyword() const override { return "TEXT_FIELD"; }

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

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNCheckBox : public BaseControl {
 public:
  CNCheckBox() : BaseControl(ControlKind::CheckBox) {}
  const char* szWindowClass() const override { return "BUTTON"; }
  const char* szKeyword() const override { return "CHECK_BOX"; }

  bool m_bRadio = false;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNEdit : public BaseControl {
 public:
  CNEdit() : BaseControl(ControlKind::Edit) {}
  const char* szWindowClass() const override { return "EDIT"; }
  const char* szKeyword() const override { return "EDIT_FIELD"; }

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
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;

  CNCharArray m_Items;  // escapes turned into characters, variable markers still in them

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

class CNImage : public BaseControl {
 public:
  CNImage() : BaseControl(ControlKind::Image) {}
  const char* szWindowClass() const override { return m_bCustom ? "BitmapClass" : "STATIC"; }
  const char* szKeyword() const override { return "IMAGE"; }
  void WriteControl(CNString& csOut) const override;

  CNString m_csPicture;  // IDB_... names a bitmap resource of the program, anything else a file in the folder pict
  bool m_bCustom = false;
  bool m_bStretch = false;
  ControlColor m_Transparent;

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void ReadOwnFlags(ScriptContext& context) override;
};

// Not shown with its dialog: a command shows it by its name.
class CNMessageBox : public BaseControl {
 public:
  CNMessageBox() : BaseControl(ControlKind::MessageBox) {}
  const char* szKeyword() const override { return "MESSAGE_BOX"; }
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;

  CNString m_csText;  // the '>' lines joined with line feeds, variable markers still in it
};

// A kind that is read and kept but not drawn yet, with the lines that belong to it as text.
class CNDeferredControl : public BaseControl {
 public:
  // szEndWord is the word that ends the kind's following lines, or null for a kind of one line.
  CNDeferredControl(ControlKind kind, const char* szKeyword, const char* szEndWord)
      : BaseControl(kind), m_szKeyword(szKeyword), m_szEndWord(szEndWord) {}
  const char* szKeyword() const override { return m_szKeyword; }
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;

  CNString m_csLines;  // the following lines, their end word included

 private:
  const char* m_szKeyword;
  const char* m_szEndWord;
};
