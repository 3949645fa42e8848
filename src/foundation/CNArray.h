// Growable arrays of pointers with an ownership flag, and the two text arrays built in the same way. Nothing throws; a
// rejected call writes one diagnostic line and changes nothing but, in Add, the ownership flag. Not synchronised.
#pragma once

#include <cstdlib>

#include "foundation/CNString.h"
#include "foundation/Log.h"

// The block of slots that all arrays share: exactly as many slots as were ever needed, deliberately without any in
// reserve.
class CNPointerBlock {
 public:
  CNPointerBlock() = default;
  CNPointerBlock(const CNPointerBlock&) = delete;
  CNPointerBlock& operator=(const CNPointerBlock&) = delete;

  // Number of elements.
  int Size() const { return m_nArrayEl; }

 protected:
  ~CNPointerBlock() = default;

  // Adds one slot holding pElement, the block being sized at nSlotSize bytes per element. A failed allocation logs, and
  // leaves the count incremented and the block null: the array is unusable from then on.
  void Append(void* pElement, size_t nSlotSize = sizeof(void*));
  void InsertAt(void* pElement, int iIndex);
  void CloseGap(int iIndex);
  void FreeBlock();

  void** m_pArrayElements = nullptr;
  int m_nArrayEl = 0;
  int m_bDeleteElements = 0;
};

// An array of T pointers. The ownership argument of the last Add deliberately decides for all elements; when it is set,
// Remove, RemoveAll and the destructor delete them. Elements are compared by identity.
template <class T>
class CNArray : public CNPointerBlock {
 public:
  ~CNArray() { RemoveAll(); }

  // Appends el. The flag is deliberately stored even when a null el is then rejected.
  void Add(T* el, int bDelete) {
    m_bDeleteElements = bDelete;
    if (!el) {
      LogPrintf("ERROR: CNArray::Add -> !el -> return");
      return;
    }
    Append(el);
  }

  // Appends all elements of another array in order; the ownership flag keeps its value.
  void Add(const CNArray* pArray) {
    if (!pArray) {
      LogPrintf("ERROR: CNArray::Add -> !pArray -> return");
      return;
    }
    const int nCount = pArray->Size();
    for (int i = 0; i < nCount; i++) Append((*pArray)[i]);
  }

  // Inserts before iIndex; iIndex equal to Size() appends (the message's ">=" is deliberate all the same).
  void Insert(T* el, int iIndex) {
    if (!el) {
      LogPrintf("ERROR: CNArray::Insert -> !el -> return");
      return;
    }
    if (iIndex < 0 || iIndex > m_nArrayEl) {
      LogPrintf("ERROR: CNArray::Insert -> iIndex<0 || iIndex>=m_nArrayEl -> return");
      return;
    }
    InsertAt(el, iIndex);
  }

  // Removes the first slot that holds el, deleting el when the array owns its elements.
  void Remove(T* el) {
    if (!el) {
      LogPrintf("ERROR: CNArray::Remove -> !el -> return");
      return;
    }
    const int i = Find(el);
    if (i == -1) {
      LogPrintf("ERROR: CNArray::Remove -> (i=Find(el))==-1 -> return");
      return;
    }
    if (m_bDeleteElements) delete el;
    CloseGap(i);
  }

  // Index of the first slot that holds el, or -1.
  int Find(const T* el) const {
    if (!el) {
      LogPrintf("ERROR: CNArray::Find -> !el -> return -1");
      return -1;
    }
    for (int i = 0; i < m_nArrayEl && m_pArrayElements; i++)
      if (m_pArrayElements[i] == el) return i;
    return -1;
  }

  // The element, or null for an index outside the array.
  T* operator[](int i) const {
    return i < 0 || i >= m_nArrayEl || !m_pArrayElements ? nullptr : static_cast<T*>(m_pArrayElements[i]);
  }

  // Empties the array; the ownership flag keeps its value.
  void RemoveAll() {
    if (m_bDeleteElements && m_pArrayElements)
      for (int i = 0; i < m_nArrayEl; i++) delete static_cast<T*>(m_pArrayElements[i]);
    FreeBlock();
  }
};

// An array of heap copies of zero-terminated texts. Add always copies; the flag decides whether the copies are freed.
class CNCharArray : public CNPointerBlock {
 public:
  ~CNCharArray() { RemoveAll(); }

  void Add(const char* szString, int bDelete);
  // The text at n, or null beyond the end. A negative n is deliberately not checked.
  const char* operator[](int n) const;
  // Splits szString in place at every occurrence of szSeparator (it writes zeros into the caller's text) and adds the
  // pieces with ownership set; with bUnique a piece that is there already is skipped. Empty pieces between separators
  // are added, a trailing empty one deliberately not. Returns 0, or -1 for a null text.
  int Set(char* szString, const char* szSeparator, bool bUnique);
  void RemoveAll();
};

// An array of heap CNString elements, compared by content.
class CNStringArray : public CNPointerBlock {
 public:
  ~CNStringArray() { RemoveAll(); }

  void Add(const char* szString, int bDelete);
  // Refuses an empty text. The element is a copy.
  void Add(CNString csString, int bDelete);
  void Add(const CNStringArray& other, int bDelete);
  int Find(const char* szString) const;
  void Remove(const char* szString);
  // Deliberately without a bounds check: i must lie within Size().
  CNString* operator[](int i) const { return static_cast<CNString*>(m_pArrayElements[i]); }
  // As CNCharArray::Set with a separator of one character.
  int Set(char* szString, char cSeparator, bool bUnique);
  void RemoveAll();

 private:
  void AppendText(CNString* pText, size_t nSlotSize);
};
