// Layout tables in pixels, apart from all windows.
//
// Every table takes the whole inside of what it stands in; several lie over each other. Its columns, and its rows in
// the same way, get their sizes so: hidden ones none; those in pixels theirs; a share of n gets n of the sum of all
// shares out of what the pixels leave. Beside stars shares are hundredths of it instead (of their sum, when that is
// more than 100), and the stars share the rest equally. Sums are rounded, not sizes, so that no pixel is lost.
//
// A control stands in its cell within its margins. It keeps its size, but with RIGHTRESIZABLE it is as wide as its cell
// and with BOTTOMRESIZABLE as high; FIXED takes both back. ALIGN_LEFT and ALIGN_RIGHT put it at that side, half way
// down; ALIGN_TOP and ALIGN_BOTTOM there, half way across; without a word it stands in the upper left corner. The
// controls in hidden columns and rows are hidden. Controls in no cell keep their own coordinates.
#pragma once

#include "controls/DialogInfo.h"

struct LayoutPlace {
  BaseControl* pControl;
  int iX, iY, iWidth, iHeight;
  bool bHidden;
};

// What windows know better than descriptions.
class LayoutSizes {
 public:
  virtual ~LayoutSizes() = default;
  // A control's own size: as described.
  virtual void Own(const BaseControl& control, int& iWidth, int& iHeight) const;
  // What a container needs around its inside (a border, a title, tabs): nothing.
  virtual void Around(const BaseControl& container, int& iWidth, int& iHeight) const;
};

// Appends the places, within the inside of pContainer (null: the dialog), of the controls in its tables. places owns
// them. The inside of a container among them is laid out by another call, when it has its size.
void LayOut(const DialogInfo& dialog, const BaseControl* pContainer, int iWidth, int iHeight, const LayoutSizes& sizes,
            CNArray<LayoutPlace>& places);
// The least size of the inside at which no control of fixed size leaves its cell; 0 without tables.
void LeastSize(const DialogInfo& dialog, const BaseControl* pContainer, const LayoutSizes& sizes, int& iWidth,
               int& iHeight);
// Moves the border at a splitter that stands in a cell by iPixels: the column before it (with HORIZONTAL the row)
// becomes wider, the one behind it narrower, neither less than its controls need. iRoom: the width (height) of the
// inside. False when it stands in no cell between two others.
bool bMoveSplitter(const DialogInfo& dialog, const BaseControl& splitter, const LayoutSizes& sizes, int iPixels,
                   int iRoom);
// Takes back what splitters have moved.
void ForgetMoves(const DialogInfo& dialog);
