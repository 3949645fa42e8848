// The wizard's named text variables: a chain of tables, searched in chain order and record order; the first record with
// the name wins. Names are compared byte for byte.
#pragma once

#include <memory>

#include "foundation/CNArray.h"

struct CNVariable {
  CNString csName;
  CNString csValue;
};

class CNVariables {
 public:
  // The record, or null, also for a null name. Valid until the store is destroyed: records are never removed. Its name
  // must not be changed.
  CNVariable* pFind(const char* szName);
  // Changes the record with the name, or appends one to the last table (making a first table when there is none). A
  // null name or value changes nothing.
  void Set(const char* szName, const char* szValue);
  // Starts a new table at the end of the chain.
  void AddTable();
  // All records in chain order.
  int Size() const;
  const CNVariable* operator[](int i) const;

 private:
  // The slot that holds the name, or the free one where it belongs.
  CNVariable** ppSlot(const char* szName);
  bool bGrowIndex();

  CNArray<CNArray<CNVariable>> m_tables;
  // Names are unique in the whole chain, so one hash index finds the first record with a name. Open addressing; a power
  // of two of slots, at most half of them used.
  std::unique_ptr<CNVariable*[]> m_pIndex;
  size_t m_nSlots = 0;
  int m_nVariables = 0;
};
