// The description of one control of a dialog: what its script line says, and the window style that follows from it. No
// windows here; the view makes a native control from a description each time the dialog is shown.
#pragma once

#include <cstdint>

#include "controls/CheckGroup.h"
#include "controls/ScriptReport.h"
#include "controls/Variables.h"
#include "controls/WindowStyles.h"
#include "foundation/CNArray.h"

enum class ControlKind {
  Button,
  Static,
  Progress,
  CheckBox,
  Edit,
  RichEdit,
  ListBox,
  SimulatedListBox,
  Combo,
  MsgBox,  // not the name of a system call, which may be a macro
  MenuBar,
  RightMenu,
  GroupBox,
  Frame,
  Trackbar,
  ListView,
  Rebar,
  UpDown,
  Accelerator,
  GlobalAccelerator,
  Cursor,
  Splitter,
  Wave,
  TreeView,
  Image,
  IpAddress,
  MonthCalendar,
  Animation,
  DatePicker,
  Hotkey,
  Header,
  Pager,
  StatusBar,
  PropSheet,  // likewise
  TabControl,
  Tab,       // a page of a tab control, a sheet of a property sheet
  Toolbar,   // a band of a rebar, or a part of a frame
  Table,     // a layout table
  BlockEnd,  // the line that closes a frame, group box, tab control ...
  Item,      // one line of a kind that holds items
};

// Red, green, blue, each 0 to 255 (a script's number is taken modulo 256).
struct ControlColor {
  bool bSet = false;
  uint8_t red = 0, green = 0, blue = 0;
};

enum class FontVariant { Normal, Italic, Underline, BigBold, Bold };
enum class ControlAlign { None = 0, Top = 1, Left = 2, Right = 3, Bottom = 4 };

struct ControlMargins {
  int iLeft = 0, iHorizontal = 0, iTop = 0, iVertical = 0;  // the two middle names are totals of both sides
};

// A word of a kind's flag list and what it does to the window style.
enum class FlagEffect { Add, Toggle };
struct FlagRow {
  const char* szWord;
  uint32_t dwStyle;
  FlagEffect effect = FlagEffect::Add;
};

struct ScriptCursor;

// What a reader needs besides its line. Everything must outlive the reading; only pReport may be used after it.
struct ScriptContext {
  ScriptReport* pReport = nullptr;
  CNVariables* pVarInfo = nullptr;
  double dScale = 1.0;  // screen dots per inch divided by 96

  // Reports a fault at the cursor's place; nothing without a report.
  void Fault(ScriptFault fault, const ScriptCursor& cursor, const char* szWord = nullptr) const;
};

// A place in the script's text: the rest of one line, and the end of the text that holds following lines. Readers move
// pPos forward. Text is never changed, so a position can always be turned into a line number.
struct ScriptCursor {
  const char* pPos = nullptr;
  const char* pLineEnd = nullptr;  // the line feed that ends the line, or the end of the text
  const char* pTextEnd = nullptr;  // the end of the dialog's control part
  // A part of the line that was read out of its order and is not there for the readers that follow.
  const char* pCut = nullptr;
  const char* pCutEnd = nullptr;
  // Where the line stands in the script, when the cursor moves over a copy of it.
  const char* pOrigin = nullptr;

  const char* pPlace() const { return pOrigin ? pOrigin : pPos; }
  bool bNextLine();  // moves to the next line; false at the end of the text
};

class BaseControl {
 public:
  explicit BaseControl(ControlKind kind) : m_Kind(kind) {}
  virtual ~BaseControl() = default;
  BaseControl(const BaseControl&) = delete;
  BaseControl& operator=(const BaseControl&) = delete;

  ControlKind Kind() const { return m_Kind; }
  // Reads the control's line (the cursor stands behind the keyword) and, for kinds that have them, the lines that
  // belong to it. Faults are reported and reading goes on. Returns 0, or 1 after logging for an empty line. The cursor
  // is left in the last line that was read.
  virtual int iReadScript(ScriptCursor& cursor, ScriptContext& context);
  // Appends the control's line in the grammar that iReadScript reads, sizes unscaled, without a line feed.
  virtual void WriteControl(CNString& csOut) const;
  // Name of the native window class, or null for a kind without a window of its own.
  virtual const char* szWindowClass() const { return nullptr; }
  // The script keyword of the kind.
  virtual const char* szKeyword() const = 0;
  // The class's name in diagnostic lines.
  virtual const char* szClassName() const = 0;

  // The texts of what the control holds, as written, in the order of the lines (a row's cells one after the other).
  // False for a kind without items.
  virtual bool bItemTexts(CNCharArray&) const { return false; }
  // The control as one that holds items; null for the others.
  virtual const class CNItemControl* pItemControl() const { return nullptr; }
  // Takes the control's window identifier from the counter, and those of what it holds.
  virtual void TakeIDs(int& iNewIDNum);

  // Takes a new size record of eight numbers. They are scaled as those of a line are: once, so not for a control that
  // has been scaled. Moving the control's window there is the view's work. Returns 0, or 1 after logging for a missing
  // record.
  int Resize(const int* size, double dScale);

  // True when the flag list holds the word anywhere (a substring search, deliberately).
  bool bHasFlag(const char* szWord) const;

  CNString m_csName;     // variable name; null when the line has none
  CNString m_csCaption;  // escapes turned into characters, variable markers still in it
  CNString m_csToolTip;
  CNString m_csAction;  // null without ACTION; else a blank and everything from the opening parenthesis, or " ()"
  CNString m_csFlags;   // the flag list as written
  int m_iSize[8] = {};  // x, y, width, height and four more, in pixels once scaled
  bool m_bScaled = false;
  double m_dScale = 1.0;  // the factor that was applied when m_bScaled
  uint32_t m_dwStyle = STYLE_CONTROL_DEFAULT;
  uint32_t m_dwExStyle = 0;
  ControlColor m_Background;
  ControlColor m_TextColor;
  FontVariant m_Font = FontVariant::Normal;
  ControlAlign m_Align = ControlAlign::None;
  ControlMargins m_Margins;
  bool m_bFocus = false;
  int m_iID = 0;                     // window identifier; 0 for kinds without one
  bool m_bDisabledNow = false;       // while its dialog is shown: what commands have made of DISABLE
  bool m_bVisited = false;           // a link that was followed
  BaseControl* m_pParent = nullptr;  // the frame, group box or tab it stands in, not owned; null: the dialog itself
  ControlPartners m_Partners;        // the other boxes of its check-box group
  bool m_bGrouped = false;

 protected:
  // Each reads one part and moves the cursor past it; 0, or 1 after logging when the cursor is missing.
  int iAddControlVariable(ScriptCursor& cursor, ScriptContext& context);
  int iAddControlCaption(ScriptCursor& cursor, ScriptContext& context);
  // A tooltip that does not stand right at the cursor is left to be cut out by the caller (cursor.pCut).
  int iAddToolTip(ScriptCursor& cursor, ScriptContext& context);
  int iAddSize(ScriptCursor& cursor, ScriptContext& context);
  int iAddStyle(ScriptCursor& cursor, ScriptContext& context);
  int iReadAction(ScriptCursor& cursor, ScriptContext& context);
  // The action of which the word ACTION was read already: the command from its parenthesis to the line's end.
  int iAddSingleLineAction(ScriptCursor& cursor, ScriptContext& context);

  // All parts of the line, in the order of the grammar.
  void ReadLine(ScriptCursor& cursor, ScriptContext& context);
  // What stands in double quotes: the caption, or a list's items.
  virtual void ReadText(ScriptCursor& cursor, ScriptContext& context) { iAddControlCaption(cursor, context); }
  virtual void WriteText(CNString& csOut) const { iWriteControlCaption(csOut); }
  virtual bool bWritesSize() const { return true; }
  // Kind-specific words between the tooltip and the size.
  virtual void ReadOwnWords(ScriptCursor&, ScriptContext&) {}
  virtual void WriteOwnWords(CNString&) const {}
  // Turns the kind's own flags into styles and members; the shared flags have been read by then.
  virtual void ReadOwnFlags(ScriptContext&) {}

  void ReadSharedFlags();
  template <size_t N>
  void ApplyFlags(const FlagRow (&rows)[N]) {
    for (const FlagRow& row : rows) ApplyFlag(row);
  }
  void ApplyFlag(const FlagRow& row);
  // The colour of the flag "WORD(r,g,b)"; not set without it.
  ControlColor FlagColor(const char* szWord) const;
  int iWriteControlCaption(CNString& csOut) const;

 private:
  void ReadMargins();
  // False when the word is not there with one number in parentheses.
  bool bReadMargin(const char* szWord, int& iMargin) const;
  // Scales the size record unless the flags forbid it or it has been done.
  void Scale(double dFactor);
  int iUnscaled(int iPixels) const;
  void WriteSize(CNString& csOut) const;

  const ControlKind m_Kind;
};

// Reads "(r,g,b)" at or after pText, up to the next comma; logs a component out of range and keeps its low eight bits.
// False without the pattern.
bool bReadColor(const char* pText, const char* pEnd, ControlColor& color);
