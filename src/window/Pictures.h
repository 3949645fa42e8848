// Pictures of images and buttons: bitmap resources of the program, or files in the folder pict.
#pragma once

#include "controls/BaseControl.h"
#include "window/Handles.h"

// Looks for a file in the folder pict beside the program, then in the one a level up. False when it is in neither.
bool bFindPictureFile(const char* szName, CNString& csPath);
// For programs that show the scripts of others: a folder that is searched before those two, or (bNoOther) in place of
// them. szFolder must live as long as pictures are looked for; null: none.
void SetPictureFolder(const char* szFolder, bool bNoOther = false);
// True after bNoOther: nothing is then looked for in the working folder either.
bool bOnlyPictureFolder();

class Picture {
 public:
  // A name beginning IDB_ is a bitmap resource of hInstance, any other a file. Pixels of the transparent colour (when
  // set) are left out by Draw; their mask is made here, once. Logs and returns false when it cannot be loaded.
  bool bLoad(HINSTANCE hInstance, const char* szName, const ControlColor& transparent);
  SIZE Size() const { return m_Size; }
  HBITMAP hBitmap() const { return m_Bitmap.Get(); }
  // Draws the whole picture into the rectangle, stretched when the sizes differ.
  void Draw(HDC hDC, const RECT& area) const;

 private:
  bool bLoadBitmap(HINSTANCE hInstance, const char* szName);
  bool bMakeMask(const ControlColor& transparent);

  OwnedBitmap m_Bitmap;
  OwnedBitmap m_Mask;  // white where the picture is left out
  SIZE m_Size = {};
};
