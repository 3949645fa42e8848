// The keywords that a line of a dialog may begin with.
#pragma once

#include "controls/DialogInfo.h"

// The line that is being read, with what the reading of the whole dialog carries along.
struct ControlLine {
  ScriptCursor& cursor;
  ScriptContext& context;
  int& iNewIDNum;    // the next window identifier
  int& bGroupCheck;  // 1 while a GROUP is open
};

struct ControlRow {
  const char* szKeyword;
  int iLength;                                                 // how many characters of the line are compared
  int (*pRead)(DialogInfo&, const ControlRow&, ControlLine&);  // returns a result code
  // For the rows that add a control: its maker, the name of the adding operation in diagnostic lines, whether it
  // refuses to work without variables, and what a deferred kind needs.
  BaseControl* (*pMake)(const ControlRow&) = nullptr;
  const char* szAdd = nullptr;
  bool bNeedsVariables = false;
  ControlKind kind = ControlKind::Button;
  const char* szEndWord = nullptr;

  // True for what may stand in a table as a cell, without being named.
  bool bMakesCell() const {
    return pRead == iAddGroupBox || pRead == iAddFrame || pRead == iAddContainer || kind == ControlKind::Toolbar;
  }

  // The first row that matches the line, or null. Containers are looked for by the walk over a dialog's lines only.
  static const ControlRow* pFind(const char* pLine, const char* pEnd);
  static const ControlRow* pFindContainer(const char* pLine, const char* pEnd);

  // What a row can do.
  static int iAdd(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAddCheckBox(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAddContainer(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAddGroupBox(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAddFrame(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iOpenGroup(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iEndGroup(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAddTable(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iBeforeDrawing(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
  static int iAfterDrawing(DialogInfo& dialog, const ControlRow& row, ControlLine& line);
};
