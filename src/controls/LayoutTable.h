// A layout table of a dialog, or of a frame, group box or page in it: columns and rows, and which control stands where.
// What becomes of it in pixels is Layout.h.
//
//   TABLE_START
//   {
//     TABLE_COLUMN (width=100p, hide=0)     100 pixels, scaled as the dialog is
//     TABLE_COLUMN (width=2%)               any letter but p: a share
//     TABLE_COLUMN (width=*)                a star (also without a size): the rest
//     TABLE_ROW (height=30p)
//       'name'                              one cell a line, in the order of the columns; a line may hold several
//       -                                   an empty cell, as is ''
//       'other' SPAN(2)                     over several columns
//     TABLE_ROW (height=*)
//       FRAME 'f' 0 0 100 50                a container with its controls is a cell as well; its flag SPAN(n) counts
//       END_FRAME
//   }
#pragma once

#include "controls/BaseControl.h"

struct LayoutTrack {  // a column or a row
  bool bPixels() const { return !bStar && cUnit == 'p'; }

  int iSize = 0;  // as written
  char cUnit = '%';
  bool bStar = true;
  bool bHidden = false;
  int iMoved = 0;  // by how many pixels splitters have made it larger since the dialog was made
};

struct LayoutCell {
  CNString csName;
  BaseControl* pControl = nullptr;  // null: the table's level has no control of that name
  int iRow = 0, iColumn = 0, iSpan = 1;
};

class CNLayoutTable : public BaseControl {
 public:
  CNLayoutTable() : BaseControl(ControlKind::Table) {}
  const char* szKeyword() const override { return "TABLE_START"; }
  const char* szClassName() const override { return "CNLayoutTable"; }
  void WriteControl(CNString& csOut) const override;

  // Reads one line between the braces. False when the line holds something else, or an apostrophe without its partner.
  bool bReadLine(const char* p, const char* pEnd);
  bool bClosed() const { return m_bClosed; }
  // Puts a control into the next cell of the last row; before the first row nothing.
  void AddCell(BaseControl& control);

  CNArray<LayoutTrack> m_Columns, m_Rows;  // owned
  CNArray<LayoutCell> m_Cells;             // owned; those that name a control, row by row

 private:
  void AddCell(const char* szName, int iSpan);
  const char* pReadCell(const char* p, const char* pEnd);

  int m_iNextColumn = 0;
  bool m_bClosed = false;
};
