// A light reading of a script that keeps every place: what the engine reads, split the way the engine splits it, and
// reports what it meets on the way. It goes on behind every fault.
#pragma once

#include "CheckReport.h"
#include "CheckWords.h"

struct ScannedControl {
  const KindRow* pKind;
  Piece line;                  // from the keyword on
  Piece name;                  // empty for a control without one
  std::vector<Piece> strings;  // the quoted texts: caption or items
  Piece flags;                 // the flag list as written
  Piece navigation;            // ID_NEXT and the like, also a wrong one
  bool bBroken = false;        // a fault hides where its parts begin and end
  bool bAction = false;
  Piece action;  // from its parenthesis to the line's end; empty for a bare ACTION

  // The engine searches for flags anywhere in the list.
  bool bHasFlag(Piece flag) const { return flags.find(flag) != Piece::npos; }
};

// START_BEFORE_DRAWING or START_AFTER_DRAWING with the commands between START_ACTION and FINISH_ACTION.
struct ScannedAction {
  Piece keyword, commands;
};

struct ScannedDialog {
  Piece header;  // the line, from DIALOG on
  Piece name;
  Piece flow;
  std::vector<ScannedControl> controls;
  std::vector<ScannedControl> items;  // lines within the blocks of kinds that hold several
  std::vector<ScannedAction> actions;
  std::vector<Piece> cells;    // names of controls in tables and in other lines that speak of one
  std::vector<Piece> choices;  // variables that the boxes of bars set
};

struct ScannedScript {
  std::vector<Piece> variables;  // the names of the INIT block
  std::vector<ScannedDialog> dialogs;
};

// CheckBlocks.cpp: the whole text.
ScannedScript ScanScript(CheckReport& report);
// CheckInit.cpp: the block of variables. Returns the text behind it.
Piece ScanInit(CheckReport& report, ScannedScript& script);
// CheckBody.cpp: the lines between BEGIN and END.
void ScanBody(CheckReport& report, Piece body, ScannedDialog& dialog);
// CheckLine.cpp: the rest of a control's or an item's line behind its keyword.
void ScanControl(CheckReport& report, Piece rest, ScannedControl& control);
// CheckFlags.cpp: a flag list; pKind null for that of a header.
void ScanFlags(CheckReport& report, Piece flags, const KindRow* pKind);
