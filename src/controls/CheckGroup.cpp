#include "controls/CheckGroup.h"

#include <algorithm>
#include <cstring>

#include "controls/BaseControl.h"

namespace {

int iCompareNames(const BaseControl& a, const BaseControl& b) {
  return std::strcmp(a.m_csName.Text(), b.m_csName.Text());
}

}  // namespace

std::unique_ptr<int[]> PlacesByName(const CNArray<BaseControl>& controls) {
  std::unique_ptr<int[]> pPlaces(new int[size_t(controls.Size())]);
  for (int i = 0; i < controls.Size(); i++) pPlaces[i] = i;
  const auto bLess = [&](int a, int b) {
    const int iOrder = iCompareNames(*controls[a], *controls[b]);
    return iOrder ? iOrder < 0 : a < b;
  };
  // As fast as std::sort for this purpose, in less than half its code.
  std::make_heap(pPlaces.get(), pPlaces.get() + controls.Size(), bLess);
  std::sort_heap(pPlaces.get(), pPlaces.get() + controls.Size(), bLess);
  return pPlaces;
}

CheckGroup::CheckGroup(const CNArray<BaseControl>& boxes) : m_pByName(PlacesByName(boxes)) {
  m_Boxes.Add(&boxes);
  const int* const pOrder = m_pByName.get();
  const auto bSameName = [this](int a, int b) { return iCompareNames(*m_Boxes[a], *m_Boxes[b]) == 0; };
  for (int iFirst = 0, iEnd; iFirst < Size(); iFirst = iEnd) {
    for (iEnd = iFirst; iEnd < Size() && bSameName(pOrder[iFirst], pOrder[iEnd]);) iEnd++;
    for (int i = iFirst; i < iEnd; i++) {
      ControlPartners& partners = m_Boxes[pOrder[i]]->m_Partners;
      partners.m_pGroup = this;
      partners.m_iFirst = iFirst;
      partners.m_nSame = iEnd - iFirst;
    }
  }
}

BaseControl* ControlPartners::operator[](int i) const {
  if (i < 0 || i >= Size()) return nullptr;
  // The boxes of the same name that stand before the partner: the k-th of them, counted from 0, is before it when no
  // more than i boxes of other names are.
  const int* const pSame = m_pGroup->m_pByName.get() + m_iFirst;
  int iLow = 0, iHigh = m_nSame;
  while (iLow < iHigh) {
    const int iMiddle = (iLow + iHigh) / 2;
    if (pSame[iMiddle] - iMiddle <= i)
      iLow = iMiddle + 1;
    else
      iHigh = iMiddle;
  }
  return m_pGroup->m_Boxes[i + iLow];
}
