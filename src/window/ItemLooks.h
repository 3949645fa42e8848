// How items of lists, combo boxes, list views and trees look: their pictures, and the drawing of one that the system
// does not draw.
#pragma once

#include "window/NativeControls.h"

// The pictures that the items of one control show, each loaded once. They are as large as the first of them.
class ItemPictures {
 public:
  ItemPictures() = default;
  ~ItemPictures();
  ItemPictures(const ItemPictures&) = delete;
  ItemPictures& operator=(const ItemPictures&) = delete;

  // The picture's place in the list; 0 is one of nothing (also for "empty.bmp" and those that cannot be loaded, which
  // are logged), -1 stands for no name. Pictures leave out the colour of their upper left pixel.
  int iFind(const NativeControl& native, const CNString& csName);
  // Null before the first picture.
  HIMAGELIST hList() const { return m_hList; }
  SIZE Size() const;

 private:
  int iLoad(const NativeControl& native, const char* szName);
  bool bMakeList(const NativeControl& native, SIZE size);

  HIMAGELIST m_hList = nullptr;
  CNCharArray m_Names;  // of the pictures, each at its place
};

// The height of an item with these pictures, in pixels.
int iItemHeight(const NativeControl& native, const ItemPictures& pictures);
// The width of the text in the control's font.
int iTextWidth(const NativeControl& native, const char* szText);
// Draws an item of a list or combo box: picture, text, selection and focus.
void DrawItem(const NativeControl& native, const DRAWITEMSTRUCT& item, const char* szText, const ItemLook& look,
              ItemPictures& pictures);
