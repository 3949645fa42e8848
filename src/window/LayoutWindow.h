// The windows of a dialog's controls, put where its layout tables say.
#pragma once

#include "controls/Layout.h"
#include "window/ShownDialog.h"

// The sizes that windows have, which the system and pictures may have changed.
class NativeSizes : public LayoutSizes {
 public:
  explicit NativeSizes(const ShownDialog& dialog) : m_Dialog(dialog) {}
  void Own(const BaseControl& control, int& iWidth, int& iHeight) const override;
  void Around(const BaseControl& container, int& iWidth, int& iHeight) const override;

 private:
  const ShownDialog& m_Dialog;
};

// Lays out what stands in pContainer (null: in the dialog), whose controls are children of hInside. Containers among
// them that get another size lay out their own inside.
void LayOutInside(ShownDialog& dialog, const BaseControl* pContainer, HWND hInside);
// Lays out all levels of a dialog that is about to be shown, as its description says.
void LayOutDialog(ShownDialog& dialog, HWND hDialog);
// Keeps the window so large that no control leaves its cell; never larger than its description makes it.
void LimitSize(const ShownDialog& dialog, HWND hDialog, MINMAXINFO& limits);
// The part of the dialog's window, or of a container, that tables share out: what bars at its edges leave.
RECT LayoutRoom(const ShownDialog& dialog, const BaseControl* pContainer, HWND hInside);
