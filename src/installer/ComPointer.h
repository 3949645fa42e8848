// Windows only: one owned interface, and the thread's use of COM, for one scope each.
#pragma once

#include <objbase.h>

class ComApartment {
 public:
  ComApartment() : m_bEntered(SUCCEEDED(CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED))) {}
  ~ComApartment() {
    if (m_bEntered) CoUninitialize();
  }
  ComApartment(const ComApartment&) = delete;
  ComApartment& operator=(const ComApartment&) = delete;

 private:
  bool m_bEntered;
};

template <class Interface>
class ComPointer {
 public:
  ComPointer() = default;
  ~ComPointer() {
    if (m_p) m_p->Release();
  }
  ComPointer(const ComPointer&) = delete;
  ComPointer& operator=(const ComPointer&) = delete;

  Interface* operator->() const { return m_p; }
  // For a call that puts an interface here; only while it is empty.
  void** Receive() { return reinterpret_cast<void**>(&m_p); }

 private:
  Interface* m_p = nullptr;
};
