#include "controls/Layout.h"

#include <algorithm>
#include <memory>

#include "controls/ContainerKinds.h"
#include "controls/ScriptText.h"

namespace {

const int MOST = 32767;  // pixels of a window

using Edges = std::unique_ptr<int[]>;

int iScaled(int iNumber, double dScale) { return dScale > 1.0 ? ScriptText::iScaleSize(iNumber, dScale) : iNumber; }

// The columns or the rows of one table, and the cells seen in their direction.
struct Direction {
  const CNLayoutTable& table;
  double dScale;
  bool bAcross;

  const CNArray<LayoutTrack>& Tracks() const { return bAcross ? table.m_Columns : table.m_Rows; }
  int iFirst(const LayoutCell& cell) const { return bAcross ? cell.iColumn : cell.iRow; }
  int iEnd(const LayoutCell& cell) const { return iFirst(cell) + (bAcross ? cell.iSpan : 1); }
  bool bHidden(const LayoutCell& cell) const {
    for (int i = iFirst(cell); i < iEnd(cell); i++)
      if (!Tracks()[i]->bHidden) return false;
    return true;
  }
};

struct Sums {
  int64_t lPixels = 0, lShares = 0, lStars = 0;
};

Sums SumsOf(const Direction& direction) {
  Sums sums;
  for (int i = 0; i < direction.Tracks().Size(); i++) {
    const LayoutTrack& track = *direction.Tracks()[i];
    if (track.bHidden) continue;
    if (track.bPixels())
      sums.lPixels += iScaled(track.iSize, direction.dScale);
    else
      (track.bStar ? sums.lStars : sums.lShares) += track.bStar ? 1 : track.iSize;
  }
  return sums;
}

// What splitters have moved. A track that would be less than nothing gives back to those that were made larger.
void ApplyMoves(const Direction& direction, int64_t* pSizes) {
  int64_t lTooMuch = 0;
  const int nTracks = direction.Tracks().Size();
  for (int i = 0; i < nTracks; i++) {
    pSizes[i] += direction.Tracks()[i]->iMoved;
    if (pSizes[i] >= 0) continue;
    lTooMuch -= pSizes[i];
    pSizes[i] = 0;
  }
  for (int i = 0; i < nTracks && lTooMuch > 0; i++) {
    const int64_t lBack = std::clamp<int64_t>(direction.Tracks()[i]->iMoved, 0, std::min(lTooMuch, pSizes[i]));
    pSizes[i] -= lBack;
    lTooMuch -= lBack;
  }
}

// Where each track begins; one more for the end of the last.
Edges TrackEdges(const Direction& direction, int iRoom) {
  const CNArray<LayoutTrack>& tracks = direction.Tracks();
  const Sums sums = SumsOf(direction);
  const int64_t lRest = std::clamp<int64_t>(iRoom - sums.lPixels, 0, MOST);
  const int64_t lWhole = sums.lStars ? std::max<int64_t>(100, sums.lShares) : std::max<int64_t>(1, sums.lShares);
  const int64_t lForStars = lRest - lRest * sums.lShares / lWhole;
  const std::unique_ptr<int64_t[]> pSizes(new int64_t[size_t(tracks.Size())]);
  int64_t lShares = 0, lStars = 0;
  for (int i = 0; i < tracks.Size(); i++) {
    const LayoutTrack& track = *tracks[i];
    int64_t& lBefore = track.bStar ? lStars : lShares;
    const int64_t lOf = track.bStar ? sums.lStars : lWhole, lAll = track.bStar ? lForStars : lRest;
    pSizes[i] = track.bPixels() ? iScaled(track.iSize, direction.dScale) : 0;
    if (track.bHidden) pSizes[i] = 0;
    if (track.bHidden || track.bPixels()) continue;
    const int64_t lAfter = lBefore + (track.bStar ? 1 : track.iSize);
    pSizes[i] = lAll * lAfter / lOf - lAll * lBefore / lOf;
    lBefore = lAfter;
  }
  ApplyMoves(direction, pSizes.get());
  Edges pEdges(new int[size_t(tracks.Size()) + 1]);
  pEdges[0] = 0;
  int64_t lEdge = 0;
  for (int i = 0; i < tracks.Size(); i++) {
    lEdge = std::min<int64_t>(lEdge + pSizes[i], ScriptText::NUMBER_LIMIT);
    pEdges[i + 1] = int(lEdge);
  }
  return pEdges;
}

// ---- one control in its cell ----

struct Span {
  int iStart, iSize;
};

// A control in one direction.
struct Fitting {
  int iBefore, iMargins;  // the first margin, both together
  bool bGrows;
  int iPlace;  // 0 at the beginning, 1 in the middle, 2 at the end

  Fitting(const BaseControl& control, bool bAcross) {
    const ControlMargins& margins = control.m_Margins;
    iBefore = iScaled(bAcross ? margins.iLeft : margins.iTop, control.m_dScale);
    iMargins = iScaled(bAcross ? margins.iHorizontal : margins.iVertical, control.m_dScale);
    bGrows = control.bHasFlag(bAcross ? "RIGHTRESIZABLE" : "BOTTOMRESIZABLE") && !control.bHasFlag("FIXED");
    const bool bOther = bAcross == (control.m_Align == ControlAlign::Top || control.m_Align == ControlAlign::Bottom);
    const bool bEnd = control.m_Align == ControlAlign::Right || control.m_Align == ControlAlign::Bottom;
    iPlace = control.m_Align == ControlAlign::None ? 0 : bOther ? 1 : bEnd ? 2 : 0;
  }
  Span Place(Span cell, int iOwn) const {
    const int iRoom = std::max(0, cell.iSize - iMargins), iSize = bGrows ? iRoom : iOwn;
    return {cell.iStart + iBefore + std::max(0, iRoom - iSize) * iPlace / 2, iSize};
  }
};

Span CellSpan(const Direction& direction, const Edges& pEdges, const LayoutCell& cell) {
  const int iStart = pEdges[direction.iFirst(cell)];
  return {iStart, pEdges[direction.iEnd(cell)] - iStart};
}

// ---- least sizes ----

int iLeastInside(const DialogInfo& dialog, const BaseControl* pContainer, const LayoutSizes& sizes, bool bAcross);

// What a container that grows with its cell cannot be smaller than; 0 for any other control.
int iLeastOf(const DialogInfo& dialog, const BaseControl& control, const LayoutSizes& sizes, bool bAcross) {
  const bool bTabs = bIsTabControl(&control);
  if (!bTabs && control.Kind() != ControlKind::Frame && control.Kind() != ControlKind::GroupBox) return 0;
  int iLeast = bTabs ? 0 : iLeastInside(dialog, &control, sizes, bAcross);
  for (int i = 0; bTabs && i < static_cast<const CNTabControl&>(control).m_Pages.Size(); i++)
    iLeast =
        std::max(iLeast, iLeastInside(dialog, static_cast<const CNTabControl&>(control).m_Pages[i], sizes, bAcross));
  int around[2];
  sizes.Around(control, around[0], around[1]);
  return iLeast + around[bAcross ? 0 : 1];
}

// What a control needs of its cell.
int iNeeds(const DialogInfo& dialog, const LayoutCell& cell, const LayoutSizes& sizes, bool bAcross) {
  if (!cell.pControl) return 0;
  const Fitting fitting(*cell.pControl, bAcross);
  if (fitting.bGrows) return fitting.iMargins + iLeastOf(dialog, *cell.pControl, sizes, bAcross);
  int own[2];
  sizes.Own(*cell.pControl, own[0], own[1]);
  return fitting.iMargins + own[bAcross ? 0 : 1];
}

bool bFits(const Direction& direction, int iRoom, const int* pNeeds) {
  const Edges pEdges = TrackEdges(direction, iRoom);
  if (pEdges[direction.Tracks().Size()] > iRoom) return false;
  for (int i = 0; i < direction.table.m_Cells.Size(); i++)
    if (CellSpan(direction, pEdges, *direction.table.m_Cells[i]).iSize < pNeeds[i]) return false;
  return true;
}

int iLeastOfTable(const DialogInfo& dialog, const Direction& direction, const LayoutSizes& sizes) {
  const CNArray<LayoutCell>& cells = direction.table.m_Cells;
  const std::unique_ptr<int[]> pNeeds(new int[size_t(cells.Size())]);
  for (int i = 0; i < cells.Size(); i++)
    pNeeds[i] = direction.bHidden(*cells[i]) ? 0 : iNeeds(dialog, *cells[i], sizes, direction.bAcross);
  int iTooSmall = -1, iEnough = MOST;
  if (!bFits(direction, iEnough, pNeeds.get())) return 0;  // a control that is larger than its cell can ever be
  while (iEnough - iTooSmall > 1) {
    const int iMiddle = (iTooSmall + iEnough) / 2;
    (bFits(direction, iMiddle, pNeeds.get()) ? iEnough : iTooSmall) = iMiddle;
  }
  return iEnough;
}

int iLeastInside(const DialogInfo& dialog, const BaseControl* pContainer, const LayoutSizes& sizes, bool bAcross) {
  int iLeast = 0;
  for (int i = 0; i < dialog.m_Tables.Size(); i++) {
    const CNLayoutTable& table = *dialog.m_Tables[i];
    if (table.m_pParent == pContainer)
      iLeast = std::max(iLeast, iLeastOfTable(dialog, {table, dialog.m_dScale, bAcross}, sizes));
  }
  return iLeast;
}

// ---- splitters ----

// The nearest track that is shown, from iTrack on in the direction of iStep; -1 without.
int iShownTrack(const Direction& direction, int iTrack, int iStep) {
  const int nTracks = direction.Tracks().Size();
  while (iTrack >= 0 && iTrack < nTracks && direction.Tracks()[iTrack]->bHidden) iTrack += iStep;
  return iTrack < nTracks ? iTrack : -1;
}

// By how much the track can become smaller.
int iSpare(const DialogInfo& dialog, const Direction& direction, const LayoutSizes& sizes, const Edges& pEdges,
           int iTrack) {
  int iLeast = 0;
  for (int i = 0; i < direction.table.m_Cells.Size(); i++) {
    const LayoutCell& cell = *direction.table.m_Cells[i];
    if (direction.iFirst(cell) == iTrack && direction.iEnd(cell) == iTrack + 1)
      iLeast = std::max(iLeast, iNeeds(dialog, cell, sizes, direction.bAcross));
  }
  return std::max(0, pEdges[iTrack + 1] - pEdges[iTrack] - iLeast);
}

bool bMoveBorder(const DialogInfo& dialog, const Direction& direction, const LayoutCell& cell, const LayoutSizes& sizes,
                 int iPixels, int iRoom) {
  const int iBefore = iShownTrack(direction, direction.iFirst(cell) - 1, -1);
  const int iBehind = iShownTrack(direction, direction.iEnd(cell), 1);
  if (iBefore < 0 || iBehind < 0) return false;
  const Edges pEdges = TrackEdges(direction, iRoom);
  iPixels = std::max(iPixels, -iSpare(dialog, direction, sizes, pEdges, iBefore));
  iPixels = std::min(iPixels, iSpare(dialog, direction, sizes, pEdges, iBehind));
  direction.Tracks()[iBefore]->iMoved += iPixels;
  direction.Tracks()[iBehind]->iMoved -= iPixels;
  return true;
}

}  // namespace

void LayoutSizes::Own(const BaseControl& control, int& iWidth, int& iHeight) const {
  iWidth = control.m_iSize[2];
  iHeight = control.m_iSize[3];
}

void LayoutSizes::Around(const BaseControl&, int& iWidth, int& iHeight) const { iWidth = iHeight = 0; }

void LayOut(const DialogInfo& dialog, const BaseControl* pContainer, int iWidth, int iHeight, const LayoutSizes& sizes,
            CNArray<LayoutPlace>& places) {
  for (int iTable = 0; iTable < dialog.m_Tables.Size(); iTable++) {
    const CNLayoutTable& table = *dialog.m_Tables[iTable];
    if (table.m_pParent != pContainer) continue;
    const Direction across = {table, dialog.m_dScale, true}, down = {table, dialog.m_dScale, false};
    const Edges pColumns = TrackEdges(across, iWidth), pRows = TrackEdges(down, iHeight);
    for (int i = 0; i < table.m_Cells.Size(); i++) {
      const LayoutCell& cell = *table.m_Cells[i];
      if (!cell.pControl) continue;
      int iOwnWidth, iOwnHeight;
      sizes.Own(*cell.pControl, iOwnWidth, iOwnHeight);
      const Span x = Fitting(*cell.pControl, true).Place(CellSpan(across, pColumns, cell), iOwnWidth);
      const Span y = Fitting(*cell.pControl, false).Place(CellSpan(down, pRows, cell), iOwnHeight);
      places.Add(new LayoutPlace{cell.pControl, x.iStart, y.iStart, x.iSize, y.iSize,
                                 across.bHidden(cell) || down.bHidden(cell)},
                 1);
    }
  }
}

void LeastSize(const DialogInfo& dialog, const BaseControl* pContainer, const LayoutSizes& sizes, int& iWidth,
               int& iHeight) {
  iWidth = iLeastInside(dialog, pContainer, sizes, true);
  iHeight = iLeastInside(dialog, pContainer, sizes, false);
}

bool bMoveSplitter(const DialogInfo& dialog, const BaseControl& splitter, const LayoutSizes& sizes, int iPixels,
                   int iRoom) {
  const bool bAcross = !splitter.bHasFlag("HORIZONTAL");
  for (int iTable = 0; iTable < dialog.m_Tables.Size(); iTable++) {
    const CNLayoutTable& table = *dialog.m_Tables[iTable];
    for (int i = 0; i < table.m_Cells.Size(); i++)
      if (table.m_Cells[i]->pControl == &splitter)
        return bMoveBorder(dialog, {table, dialog.m_dScale, bAcross}, *table.m_Cells[i], sizes, iPixels, iRoom);
  }
  return false;
}

void ForgetMoves(const DialogInfo& dialog) {
  for (int iTable = 0; iTable < dialog.m_Tables.Size(); iTable++)
    for (const auto* pTracks : {&dialog.m_Tables[iTable]->m_Columns, &dialog.m_Tables[iTable]->m_Rows})
      for (int i = 0; i < pTracks->Size(); i++) (*pTracks)[i]->iMoved = 0;
}
