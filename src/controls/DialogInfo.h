// One parsed DIALOG block: the dialog's own attributes, its controls in line order, the two action texts that run
// around its drawing, and its flow text. Made once when the script is loaded; windows come and go, the description
// stays.
#pragma once

#include "controls/BaseControl.h"

enum class DialogKind { Window, DialogSys, FlatBorder, Flat, Popup, Float, Dialog };

struct ControlRow;
struct ControlLine;

struct DialogFont {
  CNString csFace;
  int iHeight = 0;     // cell height in pixels, negative: character height; 0 the system's default
  int iWeight = 0;     // 100 to 900; 0 the system's default
  int iCharSet = 238;  // Central European
};

class DialogInfo {
 public:
  // ---- read by the loader, before ReadControls ----
  DialogKind m_Kind = DialogKind::Dialog;
  CNString m_csKind;        // the kind word, "DIALOG" when there is none
  bool m_bKindWord = true;  // false when the header has no kind word: such a dialog looks like DIALOG_SYS
  CNString m_csName;        // null when the header has none
  CNString m_csCaption;     // variable markers still in it
  DialogFont m_Font;
  int m_iToolTipTime = -1;
  bool m_bHeightAdjusted = false;
  int m_iHeightDifference = 0;  // added to the height for a caption bar that is not the assumed 19 (16) pixels high

  // ---- header: position, size, flags ----
  int m_iSize[4] = {};  // x, y, width, height of the whole window, scaled
  uint32_t m_dwStyle = STYLE_CAPTION;
  uint32_t m_dwExStyle = 0;
  bool m_bHide = false, m_bCenter = false, m_bInheritPosition = false, m_bInheritSize = false, m_bMaximize = false;
  bool m_bModeless = false, m_bNoScaling = false, m_bFocus = false;
  ControlColor m_Background;
  CNString m_csFlags;

  // ---- body ----
  CNArray<BaseControl> m_Controls;  // all controls in line order; owned
  CNString m_csBeforeDrawing;       // null or empty when the block has none; FINISH_ACTION is part of the text
  CNString m_csAfterDrawing;
  CNString m_csFlow;    // the lines after END, up to END_DIALOG
  CNString m_csTables;  // TABLE_START blocks as text
  bool m_bHasCheckGroups = false, m_bHasGroupBoxes = false, m_bHasFrames = false;

  // Reads what follows the caption on the header line: the numbers and the flags, and the styles that follow from them
  // and from m_Kind. [pText, pEnd) is the rest of the line. The caption's height difference is not added here.
  void ReadHeader(const char* pText, const char* pEnd, const ScriptContext& context);
  // Finds the END that ends the control part of [pText, pTextEnd): a word of its own, not followed by '_'. Null
  // without.
  static const char* pFindEnd(const char* pText, const char* pTextEnd);
  // Reads all control lines of [pText, pTextEnd): the text between BEGIN's line and END.
  void ReadControls(const char* pText, const char* pTextEnd, ScriptContext& context);
  // Dispatches the cursor's line by its keyword, blanks before it skipped; the cursor is left in the last line that its
  // reader consumed. A line that no keyword matches is ignored. Returns 0, or 1 after logging when an argument is
  // missing.
  int iAddControls(ScriptCursor* pCursor, int* iNewIDNum, int* bGroupCheck, ScriptContext* pContext);

  // The first control with the variable name; null (logged) for an empty name, null for an unknown one.
  BaseControl* GetBaseControl(const char* szControlName) const;
  BaseControl* GetBaseControl(int iID) const;

 private:
  friend struct ControlRow;

  int iAddControl(const ControlRow& row, ControlLine& line);
  int iAddTable(ScriptCursor& cursor, const ScriptContext& context);
  int iAddExecuteAction(ScriptCursor& cursor, const ScriptContext& context, const char* szKeyword, CNString& csText);
  void CloseGroup();

  CNArray<CheckGroup> m_Groups;      // the groups that were closed; owned
  CNArray<BaseControl> m_OpenGroup;  // boxes of the GROUP that is open; not owned
  bool m_bGroupClosed = false;       // the next control is the first behind a GROUP
};
