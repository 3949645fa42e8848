#include "controls/Variables.h"

#include <cstdint>
#include <cstring>
#include <new>
#include <utility>

namespace {

// FNV-1a.
uint32_t uHash(const char* szName) {
  uint32_t uHash = 2166136261u;
  for (; *szName; szName++) uHash = (uHash ^ static_cast<unsigned char>(*szName)) * 16777619u;
  return uHash;
}

const size_t FIRST_SLOTS = 64;

}  // namespace

CNVariable** CNVariables::ppSlot(const char* szName) {
  size_t n = uHash(szName) & (m_nSlots - 1);
  while (m_pIndex[n] && std::strcmp(m_pIndex[n]->csName.Text(), szName) != 0) n = (n + 1) & (m_nSlots - 1);
  return &m_pIndex[n];
}

bool CNVariables::bGrowIndex() {
  if (2 * size_t(m_nVariables + 1) <= m_nSlots) return true;
  const size_t nSlots = m_nSlots ? 2 * m_nSlots : FIRST_SLOTS;
  std::unique_ptr<CNVariable*[]> pIndex(new (std::nothrow) CNVariable*[nSlots]());
  if (!pIndex) return false;
  m_pIndex = std::move(pIndex);
  m_nSlots = nSlots;
  for (int iTable = 0; iTable < m_tables.Size(); iTable++)
    for (int i = 0; i < m_tables[iTable]->Size(); i++) {
      CNVariable* pVariable = (*m_tables[iTable])[i];
      *ppSlot(pVariable->csName.Text()) = pVariable;
    }
  return true;
}

CNVariable* CNVariables::pFind(const char* szName) { return szName && m_nSlots ? *ppSlot(szName) : nullptr; }

void CNVariables::Set(const char* szName, const char* szValue) {
  if (!szName || !szValue) return;
  CNVariable* pVariable = pFind(szName);
  if (!pVariable) {
    if (!bGrowIndex()) {
      LogPrintf("ERROR: CNVariables::Set -> !bGrowIndex() -> return");
      return;
    }
    if (m_tables.Size() == 0) AddTable();
    pVariable = new CNVariable;
    pVariable->csName = szName;
    *ppSlot(szName) = pVariable;
    m_nVariables++;
    m_tables[m_tables.Size() - 1]->Add(pVariable, 1);
  }
  pVariable->csValue = szValue;
  pVariable->bPlain = false;
}

void CNVariables::MarkPlain(const char* szName) {
  if (CNVariable* pVariable = pFind(szName)) pVariable->bPlain = true;
}

bool CNVariables::bTakesTail(const char* szName, const CNString& csTail, long lMaxLength) {
  const CNVariable* pVariable = pFind(szName);
  if (!pVariable || !pVariable->bPlain) return false;
  const CNString& csValue = pVariable->csValue;
  const bool bJoinsMarker = !csValue.bEmpty() && csValue.Text()[csValue.Length() - 1] == '<' && *csTail.Text() == '%';
  return !bJoinsMarker && csValue.Length() + csTail.Length() <= lMaxLength;
}

bool CNVariables::bAppendPlain(const char* szName, const CNString& csTail, long lMaxLength) {
  if (!bTakesTail(szName, csTail, lMaxLength) || std::strstr(csTail.Text(), "<%")) return false;
  return csTail.bEmpty() || pFind(szName)->csValue.Concat(csTail.Ptr(), csTail.Length());
}

void CNVariables::AddTable() { m_tables.Add(new CNArray<CNVariable>, 1); }

int CNVariables::Size() const { return m_nVariables; }

const CNVariable* CNVariables::operator[](int i) const {
  for (int iTable = 0; iTable < m_tables.Size(); iTable++) {
    const CNArray<CNVariable>& table = *m_tables[iTable];
    if (i < table.Size()) return table[i];
    i -= table.Size();
  }
  return nullptr;
}
