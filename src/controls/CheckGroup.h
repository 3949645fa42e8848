// The check boxes between GROUP and END_GROUP. The list is kept once for them all; each box answers from it who its
// partners are.
#pragma once

#include <memory>

#include "foundation/CNArray.h"

class BaseControl;

// The places of the controls in their array by name, those of one name in their order.
std::unique_ptr<int[]> PlacesByName(const CNArray<BaseControl>& controls);

class CheckGroup {
 public:
  // Takes the boxes, which it does not own, and tells each of them its partners. The group must outlive their use.
  explicit CheckGroup(const CNArray<BaseControl>& boxes);
  int Size() const { return m_Boxes.Size(); }

 private:
  friend class ControlPartners;

  CNArray<BaseControl> m_Boxes;
  std::unique_ptr<int[]> m_pByName;  // PlacesByName of m_Boxes
};

// The boxes of a group whose names differ from that of the box that has these partners, in the order of the lines. Both
// calls are quick in groups of any size.
class ControlPartners {
 public:
  int Size() const { return m_pGroup ? m_pGroup->Size() - m_nSame : 0; }
  // Null outside 0 to Size() - 1.
  BaseControl* operator[](int i) const;
  // Null for a box outside all groups.
  const CheckGroup* pGroup() const { return m_pGroup; }

 private:
  friend class CheckGroup;

  const CheckGroup* m_pGroup = nullptr;
  int m_iFirst = 0, m_nSame = 0;  // the boxes of the same name in m_pByName, the box itself among them
};
