// One parsed DIALOG block: the dialog's own attributes, its controls in line order, the two action texts that run
// around its drawing, and its flow text. Made once when the script is loaded; windows come and go, the description
// stays.
#pragma once

#include <memory>

#include "controls/LayoutTable.h"

enum class DialogKind { Window, DialogSys, FlatBorder, Flat, Popup, Float, Dialog };

struct ControlRow;
struct ControlLine;
class CNContainer;

// A container, or a table, whose closing line has not been read yet.
struct OpenBlock {
  CNContainer* pContainer = nullptr;  // not owned; null for a table
  std::unique_ptr<BaseControl> pTable;
  bool bDropped = false;  // the table has a fault
  ScriptCursor begin;     // the container's own line
  int iFirst = 0;         // how many controls there were before those in it
};

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
  CNString m_csPicture;       // behind the controls: a resource IDB_... or a file in the folder pict
  CNString m_csPicturePlace;  // left_up, left_down, right_up, right_down, change_position; any other word: the centre
  int m_iPictureAt[2] = {};   // for change_position: its upper left corner, scaled
  double m_dScale = 1.0;      // the factor that the numbers above were multiplied by
  CNString m_csFlags;

  // ---- body ----
  CNArray<BaseControl> m_Controls;  // all controls in line order; owned
  CNString m_csBeforeDrawing;       // null or empty when the block has none; FINISH_ACTION is part of the text
  CNString m_csAfterDrawing;
  CNString m_csFlow;                // the lines after END, up to END_DIALOG
  CNArray<CNLayoutTable> m_Tables;  // not owned: they are among m_Controls as well
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
  OpenBlock* pInnermost() const { return m_OpenBlocks[m_OpenBlocks.Size() - 1]; }
  // The container that what is read now stands in.
  BaseControl* pAround() const;
  void AddToTable(BaseControl& control);
  void OpenContainer(CNContainer& container, const ControlLine& line);
  // Reports the open blocks from that one on and ends them.
  void CloseUnclosed(int iFirst, const ScriptContext& context);
  // Lines that open blocks decide on. False for a line that is read as everywhere else.
  bool bReadBlockLine(ControlLine& line);
  bool bCloseContainer(const ControlLine& line);
  bool bOpenPage(const OpenBlock& block, ControlLine& line);
  int iAddTable(ScriptCursor& cursor, const ScriptContext& context);
  bool bReadTableLine(OpenBlock& block, const ControlLine& line);
  void ReadTablePart(OpenBlock& block, const ScriptCursor& cursor, const ScriptContext& context);
  void FindCells();
  int iAddExecuteAction(ScriptCursor& cursor, const ScriptContext& context, const char* szKeyword, CNString& csText);
  void CloseGroup();

  std::unique_ptr<int[]> m_pByName;  // PlacesByName of the first m_nIndexed controls
  int m_nIndexed = 0;
  CNArray<CheckGroup> m_Groups;      // the groups that were closed; owned
  CNArray<BaseControl> m_OpenGroup;  // boxes of the GROUP that is open; not owned
  bool m_bGroupClosed = false;       // the next control is the first behind a GROUP
  CNArray<OpenBlock> m_OpenBlocks;   // the outer ones first; owned
  const char* m_pBrace = nullptr;  // the next closing brace that was looked for, the end of the text when none follows
};
