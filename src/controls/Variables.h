// The wizard's named text variables: a chain of tables, searched in chain order and record order; the first record with
// the name wins. Names are compared byte for byte.
#pragma once

#include "foundation/CNArray.h"

struct CNVariable {
  CNString csName;
  CNString csValue;
};

class CNVariables {
 public:
  // The record, or null. Valid until the store is destroyed: records are never removed.
  CNVariable* pFind(const char* szName);
  // Changes the record with the name, or appends one to the last table (making a first table when there is none).
  void Set(const char* szName, const char* szValue);
  // Starts a new table at the end of the chain.
  void AddTable();
  // All records in chain order.
  int Size() const;
  const CNVariable* operator[](int i) const;

 private:
  CNArray<CNArray<CNVariable>> m_tables;
};
