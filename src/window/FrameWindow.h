// The windows of class "FrameWizardClass" that controls stand in: frames, pages, the inside of group boxes.
#pragma once

#include "window/ShownDialog.h"

// Registers the class while at least one of these lives that was told to use it.
class FrameClass {
 public:
  FrameClass() = default;
  ~FrameClass();
  FrameClass(const FrameClass&) = delete;
  FrameClass& operator=(const FrameClass&) = delete;
  // False after logging and a message box; frames cannot be made then.
  bool bUse(HINSTANCE hInstance);

 private:
  bool m_bUses = false;
};

// What the frames of a dialog need once all windows are there. Returns a result code, after logging for others than 0.
int iInitFrameDialog(const ShownDialog& dialog, HWND hDlg);

// Makes the window inside a group box.
HWND hMakeInside(NativeControl& native, HINSTANCE hInstance);
