// The wizard's named text variables: a chain of tables, searched in chain order and record order; the first record with
// the name wins. Names are compared byte for byte.
#pragma once

#include <memory>

#include "foundation/CNArray.h"

struct CNVariable {
  CNString csName;
  CNString csValue;     // changed by CNVariables only
  bool bPlain = false;  // the value is known to hold no "<%"
};

class CNVariables {
 public:
  // The record, or null, also for a null name. Valid until the store is destroyed: records are never removed. It must
  // not be changed.
  CNVariable* pFind(const char* szName);
  // Changes the record with the name, or appends one to the last table (making a first table when there is none). A
  // null name or value changes nothing.
  void Set(const char* szName, const char* szValue);
  // Says that the variable's value holds no "<%", until it is set again.
  void MarkPlain(const char* szName);
  // Whether the record exists and is marked as plain, and the tail neither makes a "<%" where it joins the value nor
  // makes it longer than lMaxLength.
  bool bTakesTail(const char* szName, const CNString& csTail, long lMaxLength);
  // Appends a tail that is taken and holds no "<%" to the value in its place, so that a text that grows piece by piece
  // is not copied for each of them. False, and nothing done, for any other.
  bool bAppendPlain(const char* szName, const CNString& csTail, long lMaxLength);
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
