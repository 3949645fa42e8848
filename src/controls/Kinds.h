// The kinds of control that are a class of their own. Those of one line that the system draws stand in SimpleKinds.h,
// those that hold items in ItemKinds.h and MenuKinds.h, those that hold controls in ContainerKinds.h.
#pragma once

#include "controls/ItemKinds.h"

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
  CNMessageBox() : BaseControl(ControlKind::MsgBox) {}
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
