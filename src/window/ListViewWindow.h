// The window of a list view. Rows, columns and values are in ListViewWindow.cpp; what a person does to it is in
// ListViewEvents.cpp.
#pragma once

#include "window/ItemWindow.h"

class ListViewWindow : public ItemWindow {
 public:
  using ItemWindow::ItemWindow;
  static NativeEvent Notify(NativeControl& native, NMHDR& message);
  static bool bCheckItem(NativeControl& native, int iItem, bool bChecked);
  static bool bIsItemChecked(NativeControl& native, int iItem, bool& bChecked);

 protected:
  void Created() override;
  void Fill(const CNCharArray& texts) override;
  void SetValue(const char* szText) override;
  void GetValue(CNString& csText) override;
  bool bTakesEnter() override;
  bool bMessage(const MSG& message, LRESULT& lResult) override;

 private:
  struct Row {
    UINT uCode;
    void (ListViewWindow::*pHandler)(NMHDR& message, NativeEvent& event);
  };
  CNListView& List() const { return static_cast<CNListView&>(m_Native.Control()); }
  bool bReport() const { return (List().m_dwStyle & STYLE_LVS_LIST) != STYLE_LVS_LIST; }
  int iNext(int iAfter, UINT uFlags) const { return ListView_GetNextItem(hWnd(), iAfter, uFlags); }
  CNItem* pItem(int iRow) const;
  int iRowOf(const CNItem* pItem) const;

  int iInsertColumns();
  void InsertRow(CNItem& item, int iRow, int nColumns);
  void PutCell(CNItem& item, int iRow, int iColumn, UINT uMessage);
  void Sort();
  static int CALLBACK Compare(LPARAM lFirst, LPARAM lSecond, LPARAM lWindow);

  void Edit(int iRow, int iColumn);
  void EndEdit(bool bKeep);
  void DrawBar(const NMLVCUSTOMDRAW& draw, const char* szText);

  void OnCustomDraw(NMHDR& message, NativeEvent& event);
  void OnChanging(NMHDR& message, NativeEvent& event);
  void OnChanged(NMHDR& message, NativeEvent& event);
  void OnColumn(NMHDR& message, NativeEvent& event);
  void OnDoubleClick(NMHDR& message, NativeEvent& event);
  void OnInfoTip(NMHDR& message, NativeEvent& event);

  int m_iSorted = -1;  // the column, -1: as the script has them
  bool m_bDown = false;
  HWND m_hEditor = nullptr;  // while a cell is edited
  int m_iEditRow = 0, m_iEditColumn = 0;
};
