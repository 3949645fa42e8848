// The window of a tree. Items and values are in TreeViewWindow.cpp; what a person does to it is in TreeViewEvents.cpp.
#pragma once

#include "window/ItemWindow.h"

class TreeWindow : public ItemWindow {
 public:
  using ItemWindow::ItemWindow;
  ~TreeWindow() override;
  static NativeEvent Notify(NativeControl& native, NMHDR& message);
  static bool bCheckItem(NativeControl& native, int iItem, bool bChecked);
  static bool bIsItemChecked(NativeControl& native, int iItem, bool& bChecked);

 protected:
  void Created() override;
  void Fill(const CNCharArray& texts) override;
  void SetValue(const char* szText) override;
  void GetValue(CNString& csText) override { Path(hGet(TVGN_CARET), csText); }
  bool bTakesEnter() override;
  bool bMessage(const MSG& message, LRESULT& lResult) override;
  void MarkDrop(const POINT* pScreen) override;
  void Drop(LPARAM lItem, ItemWindow& target, POINT screen) override;

 private:
  struct Row {
    UINT uCode;
    void (TreeWindow::*pHandler)(NMHDR& message, NativeEvent& event);
  };
  // Where an item is dropped: before hItem, else as the last one within it; null: behind all.
  struct DropPlace {
    HTREEITEM hItem;
    bool bBefore;
  };

  CNTreeView& Tree() const { return static_cast<CNTreeView&>(m_Native.Control()); }
  HTREEITEM hGet(UINT uWhich, HTREEITEM hFrom = nullptr) const { return TreeView_GetNextItem(hWnd(), hFrom, uWhich); }
  HTREEITEM hNext(HTREEITEM hItem) const;
  HTREEITEM hFind(const CNItem* pItem) const;
  CNItem* pItem(HTREEITEM hItem) const;
  void Path(HTREEITEM hItem, CNString& csPath) const;
  HTREEITEM hAt(POINT point, UINT uFlags) const;

  HTREEITEM hInsert(CNItem& item, HTREEITEM hParent, HTREEITEM hAfter);
  HTREEITEM hPlaceAfter(HTREEITEM hParent, int iPlace) const;
  bool bKeepsTick(const MSG& message);

  DropPlace Place(POINT screen) const;
  HTREEITEM hCopyBranch(HTREEITEM hItem, TreeWindow& to, HTREEITEM hParent, HTREEITEM hAfter);
  void TakeOrder(CNArray<CNItem>& items) const;
  void SetOrder(const CNArray<CNItem>& items);

  void OnCustomDraw(NMHDR& message, NativeEvent& event);
  void OnSelected(NMHDR& message, NativeEvent& event);
  void OnDoubleClick(NMHDR& message, NativeEvent& event);
  void OnInfoTip(NMHDR& message, NativeEvent& event);
  void OnBeginDrag(NMHDR& message, NativeEvent& event);

  HIMAGELIST m_hTicks = nullptr;  // the window leaves it behind
};
