#include "controls/CheckGroup.h"

#include <algorithm>
#include <cstring>

#include "controls/BaseControl.h"

CheckGroup::CheckGroup(const CNArray<BaseControl>& boxes) : m_pByName(new int[size_t(boxes.Size())]) {
  for (int i = 0; i < boxes.Size(); i++) {
    m_Boxes.Add(boxes[i], 0);
    m_pByName[i] = i;
  }
  int* const pOrder = m_pByName.get();
  const auto Compare = [this](int a, int b) {
    return std::strcmp(m_Boxes[a]->m_csName.Text(), m_Boxes[b]->m_csName.Text());
  };
  std::sort(pOrder, pOrder + Size(), [&](int a, int b) {
    const int iOrder = Compare(a, b);
    return iOrder ? iOrder < 0 : a < b;
  });
  for (int iFirst = 0, iEnd; iFirst < Size(); iFirst = iEnd) {
    for (iEnd = iFirst; iEnd < Size() && Compare(pOrder[iFirst], pOrder[iEnd]) == 0;) iEnd++;
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
