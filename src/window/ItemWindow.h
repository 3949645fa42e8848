// What the windows of lists, combo boxes, list views and trees share: a procedure before that of their class, values
// that are read and set on the window's thread, events that are told when the window has finished with its message (the
// script may then take the window away), and items that are moved with the mouse.
#pragma once

#include "controls/ItemKinds.h"
#include "window/ItemLooks.h"

class ItemWindow : public NativeState {
 public:
  explicit ItemWindow(NativeControl& native) : m_Native(native), m_Dragging(native.Control()) {}

  // For NativeKind::pCreated.
  template <class T>
  static void Create(NativeControl& native) {
    Attach(native, new T(native));
  }
  template <class T>
  static T& Of(const NativeControl& native) {
    return static_cast<T&>(*native.m_pState);
  }
  // For NativeKind.
  static bool bSetText(HWND hWnd, const char* szText);
  static bool bGetText(HWND hWnd, CNString& csText);
  static void SetItems(NativeControl& native, const CNCharArray& texts);
  // The event that a notification of Tell stands for; nothing for one of the system's.
  static NativeEvent Told(const NMHDR& message);

  ItemPictures m_Pictures;

 protected:
  HWND hWnd() const { return m_Native.hWnd(); }
  LRESULT Send(UINT uMessage, WPARAM wParam = 0, LPARAM lParam = 0) const {
    return SendMessageW(hWnd(), uMessage, wParam, lParam);
  }
  // Has the wizard told of it soon, unless the change is not a person's.
  void Tell(int iNotification, CNItem* pItem = nullptr);
  // What choosing the item tells: its command, or without one (null as well) a double click.
  void TellChosen(CNItem* pItem);
  // Enter belongs to the window while this says so, else to the dialog's default button.
  virtual bool bTakesEnter() { return false; }
  virtual void Created() {}
  virtual void Fill(const CNCharArray& texts) = 0;
  virtual void SetValue(const char* szText) = 0;
  virtual void GetValue(CNString& csText) = 0;
  // True when the message is done with. The window, and this, may be gone then.
  virtual bool bMessage(const MSG&, LRESULT&) { return false; }

  // ---- moving items ----
  // Begins once the mouse has moved far enough with the button down; x and y are in the window.
  void StartDrag(LPARAM lItem, POINT point);
  // Shows where an item would be dropped; a null point: nowhere.
  virtual void MarkDrop(const POINT* /*pScreen*/) {}
  // Moves lItem of this window to the place in the other, or the same, window of its kind.
  virtual void Drop(LPARAM /*lItem*/, ItemWindow& /*target*/, POINT /*screen*/) {}

  NativeControl& m_Native;
  const ItemDragging m_Dragging;
  int m_nQuiet = 0;  // above 0 while the wizard changes the window

 private:
  static void Attach(NativeControl& native, ItemWindow* pNew);
  static LRESULT CALLBACK Procedure(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam);
  bool bOwnMessage(const MSG& message, LRESULT& lResult);
  bool bDragMessage(const MSG& message, LRESULT& lResult);
  ItemWindow* pTarget(POINT screen) const;
  void DragTo(POINT screen);
  void EndDrag(const POINT* pScreen);

  bool m_bChangeIsDue = false;
  bool m_bPressed = false, m_bMoving = false;
  LPARAM m_lDragged = 0;
  POINT m_Pressed = {};  // on the screen
  ItemWindow* m_pTarget = nullptr;
};

// Changes of the window that are not to be told as a person's.
class Quiet {
 public:
  explicit Quiet(int& nQuiet) : m_nQuiet(nQuiet) { m_nQuiet++; }
  ~Quiet() { m_nQuiet--; }
  Quiet(const Quiet&) = delete;
  Quiet& operator=(const Quiet&) = delete;

 private:
  int& m_nQuiet;
};
