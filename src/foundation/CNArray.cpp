#include "foundation/CNArray.h"

#include <cstring>
#include <new>
#include <utility>

// ---- The shared block

void CNPointerBlock::Append(void* pElement, size_t nSlotSize) {
  const bool bUsable = m_pArrayElements || m_nArrayEl == 0;  // a new block would lack the elements that were lost
  m_nArrayEl++;
  void* const pBlock = bUsable ? std::realloc(m_pArrayElements, size_t(m_nArrayEl) * nSlotSize) : nullptr;
  if (!pBlock) {
    std::free(m_pArrayElements);  // the elements are lost: the array is unusable from here on
    m_pArrayElements = nullptr;
    LogPrintf("ERROR: CNArray::Add -> !m_pArrayElements -> return");
    return;
  }
  m_pArrayElements = static_cast<void**>(pBlock);
  m_pArrayElements[m_nArrayEl - 1] = pElement;
}

void CNPointerBlock::InsertAt(void* pElement, int iIndex) {
  Append(pElement);
  if (!m_pArrayElements) return;
  void** const pSlot = m_pArrayElements + iIndex;
  std::memmove(pSlot + 1, pSlot, size_t(m_nArrayEl - 1 - iIndex) * sizeof(void*));
  *pSlot = pElement;
}

void CNPointerBlock::CloseGap(int iIndex) {
  void** const pSlot = m_pArrayElements + iIndex;
  m_nArrayEl--;
  std::memmove(pSlot, pSlot + 1, size_t(m_nArrayEl - iIndex) * sizeof(void*));
}

void CNPointerBlock::FreeBlock() {
  std::free(m_pArrayElements);
  m_pArrayElements = nullptr;
  m_nArrayEl = 0;
}

namespace {

// Cuts szString in place at every occurrence of szSeparator and hands each piece to add. Empty pieces count, but not
// behind the last separator.
template <class Add>
void Split(char* szString, const char* szSeparator, Add add) {
  const size_t nSeparator = std::strlen(szSeparator);
  char* szPiece = szString;
  while (char* const pEnd = nSeparator ? std::strstr(szPiece, szSeparator) : nullptr) {
    *pEnd = 0;
    add(szPiece);
    szPiece = pEnd + nSeparator;
  }
  if (*szPiece) add(szPiece);
}

}  // namespace

// ---- CNCharArray

void CNCharArray::Add(const char* szString, int bDelete) {
  if (!szString) {
    LogPrintf("ERROR: CNCharArray::Add -> !string -> return");
    return;
  }
  const size_t nSize = std::strlen(szString) + 1;
  void* const pCopy = std::malloc(nSize);
  if (!pCopy) {
    LogPrintf("ERROR: CNCharArray::Add -> !m_pArrayElements -> return");
    return;
  }
  std::memcpy(pCopy, szString, nSize);
  m_bDeleteElements = bDelete;
  Append(pCopy);
}

const char* CNCharArray::operator[](int n) const {
  if (n >= m_nArrayEl)
    return static_cast<const char*>(LogPrintf("ERROR: CNCharArray::operator[] -> n>=m_nArrayEl -> return NULL"));
  return m_pArrayElements ? static_cast<const char*>(m_pArrayElements[n]) : nullptr;
}

int CNCharArray::Set(char* szString, const char* szSeparator, bool bUnique) {
  if (!szString) return iLogReturn(-1, "ERROR: CNCharArray::Set -> !string -> return -1");
  const auto bKnown = [this](const char* szPiece) {
    for (int i = 0; i < m_nArrayEl && m_pArrayElements; i++)
      if (std::strcmp(static_cast<const char*>(m_pArrayElements[i]), szPiece) == 0) return true;
    return false;
  };
  Split(szString, szSeparator ? szSeparator : "", [&](const char* szPiece) {
    if (!bUnique || !bKnown(szPiece)) Add(szPiece, 1);
  });
  return 0;
}

void CNCharArray::RemoveAll() {
  if (m_bDeleteElements && m_pArrayElements)
    for (int i = 0; i < m_nArrayEl; i++) std::free(m_pArrayElements[i]);
  FreeBlock();
}

// ---- CNStringArray

void CNStringArray::AppendText(CNString* pText, size_t nSlotSize) {
  if (pText)
    Append(pText, nSlotSize);
  else
    LogPrintf("ERROR: CNArray::Add -> !el -> return");
}

void CNStringArray::Add(const char* szString, int bDelete) {
  if (!szString) {
    LogPrintf("ERROR: CNStringArray::Add -> !string -> return");
    return;
  }
  m_bDeleteElements = bDelete;
  AppendText(new (std::nothrow) CNString(szString, -1), 16);  // more than a slot needs: deliberate
}

void CNStringArray::Add(CNString csString, int bDelete) {
  if (!csString.Length()) {
    LogPrintf("ERROR: CNStringArray::Add -> !string.Length() -> return");
    return;
  }
  m_bDeleteElements = bDelete;
  AppendText(new (std::nothrow) CNString(std::move(csString)), sizeof(void*));
}

void CNStringArray::Add(const CNStringArray& other, int bDelete) {
  const int nCount = other.m_pArrayElements ? other.Size() : 0;  // other may be this array, which grows meanwhile
  for (int i = 0; i < nCount; i++) Add(CNString(*other[i]), bDelete);
}

int CNStringArray::Find(const char* szString) const {
  if (!szString) return iLogReturn(-1, "ERROR: CNStringArray::Find -> !string -> return -1");
  for (int i = 0; i < m_nArrayEl && m_pArrayElements; i++)
    if ((*this)[i]->IsEqual(szString)) return i;
  return -1;
}

void CNStringArray::Remove(const char* szString) {
  if (!szString) {
    LogPrintf("ERROR: CNStringArray::Remove -> !string -> return");
    return;
  }
  const int i = Find(szString);
  if (i == -1) {
    LogPrintf("ERROR: CNStringArray::Remove -> (i=Find(string))==-1 -> return");
    return;
  }
  if (m_bDeleteElements) delete (*this)[i];
  CloseGap(i);
}

int CNStringArray::Set(char* szString, char cSeparator, bool bUnique) {
  if (!szString) return iLogReturn(-1, "ERROR: CNStringArray::Set -> !string -> return -1");
  const char szSeparator[] = {cSeparator, 0};
  Split(szString, szSeparator, [&](const char* szPiece) {
    if (!bUnique || Find(szPiece) == -1) Add(szPiece, 1);
  });
  return 0;
}

void CNStringArray::RemoveAll() {
  if (m_bDeleteElements && m_pArrayElements)
    for (int i = 0; i < m_nArrayEl; i++) delete (*this)[i];
  FreeBlock();
}
