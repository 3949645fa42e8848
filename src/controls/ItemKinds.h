// Lists, combo boxes, list views, trees, headers and status bars: the kinds whose items are texts to look at and to
// choose from.
#pragma once

#include "controls/ControlItems.h"

// How the person may move items with the mouse. DRAG is found in every one of the words, and R_DRAG in two.
struct ItemDragging {
  explicit ItemDragging(const BaseControl& control)
      : bAny(control.bHasFlag("DRAG")),
        bRightButton(control.bHasFlag("R_DRAG")),
        bGlobal(control.bHasFlag("GLOBAL_")),
        bReorders(bAny && !control.bHasFlag("NO_REORDER_LIST")) {}

  bool bAny;          // some item may be moved
  bool bRightButton;  // with the right button, else with the left one
  bool bGlobal;       // to another control of the kind that has the flag as well
  bool bReorders;     // within the control
};

// A kind whose items are the quoted texts of its own line.
class CNTextList : public BaseControl {
 public:
  using BaseControl::BaseControl;
  bool bItemTexts(CNCharArray& texts) const override;

  CNCharArray m_Items;  // escapes turned into characters, variable markers still in them

 protected:
  void ReadText(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteText(CNString& csOut) const override;
};

// LIST_FIELD and SIMULATED_LIST_FIELD. Hidden lists carry data for commands. What a person has moved in a list that is
// shown is moved in m_Items as well.
class CNListBox : public CNTextList {
 public:
  explicit CNListBox(bool bSimulated) : CNTextList(bSimulated ? ControlKind::SimulatedListBox : ControlKind::ListBox) {}
  const char* szWindowClass() const override { return "LISTBOX"; }
  const char* szKeyword() const override {
    return Kind() == ControlKind::ListBox ? "LIST_FIELD" : "SIMULATED_LIST_FIELD";
  }
  const char* szClassName() const override { return "CNListBox"; }

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

// The headings of columns. The numbers five to eight of its size are the widths of the first four; columns without a
// width share what is left.
class CNHeader : public CNTextList {
 public:
  CNHeader() : CNTextList(ControlKind::Header) {}
  const char* szWindowClass() const override { return "SysHeader32"; }
  const char* szKeyword() const override { return "HEADER"; }
  const char* szClassName() const override { return "CNHeader"; }

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

// Each text is one part of the bar.
class CNStatusBar : public CNTextList {
 public:
  CNStatusBar();
  const char* szWindowClass() const override { return "msctls_statusbar32"; }
  const char* szKeyword() const override { return "STATUS_BAR"; }
  const char* szClassName() const override { return "CNStatusBar"; }
};

class CNCombo : public CNItemControl {
 public:
  CNCombo();
  const char* szWindowClass() const override { return m_bPictures ? "ComboBoxEx32" : "COMBOBOX"; }
  const char* szKeyword() const override { return "COMBO_FIELD"; }
  const char* szClassName() const override { return "CNCombo"; }
  bool bIsEditable() const { return m_bEditable; }

  bool m_bPictures = false;  // IMAGE_COMBO
  bool m_bEditable = false;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

// What editing a cell of a list view is done with. Progress shows the cell's number as a bar, which nobody edits.
enum class CellEditor { None, Edit, RichEdit, Combo, Progress };

// Its lines are columns and rows, in any order.
class CNListView : public CNItemControl {
 public:
  CNListView();
  const char* szWindowClass() const override { return "SysListView32"; }
  const char* szKeyword() const override { return "LISTVIEW"; }
  const char* szClassName() const override { return "CNListView"; }

  // The column with that number, null beyond the last.
  const CNItem* pColumn(int iColumn) const { return m_Columns[iColumn]; }
  // Of a column, or what the control's own flags say for those that say nothing.
  CellEditor Editor(int iColumn) const;
  bool bCanEdit(int iColumn) const;

  bool m_bSorts = false;          // by a click on a heading
  uint32_t m_dwExtendedList = 0;  // LVS_EX_...

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
  void ItemsRead(const ScriptCursor& cursor, ScriptContext& context) override;

 private:
  CNArray<CNItem> m_Columns;  // not owned
};

class CNTreeView : public CNItemControl {
 public:
  CNTreeView();
  const char* szWindowClass() const override { return "SysTreeView32"; }
  const char* szKeyword() const override { return "TREE_VIEW"; }
  const char* szClassName() const override { return "CNTreeView"; }

  // Where an item's name 'level,place' puts it: level from 0, place from 0 among those of its parent, -1: behind them.
  static void Position(const CNItem& item, int& iLevel, int& iPlace);

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};
