// The part of the C++ runtime that this program needs, without the library's exception machinery behind it: nothing
// here throws, so what would throw ends the process instead.
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <new>

extern "C" [[noreturn]] void __cxa_pure_virtual() { abort(); }

// Out of memory is not survivable in the middle of a constructor; callers that can go on without allocate with malloc.
void* operator new(size_t nSize) {
  if (void* pMemory = malloc(nSize ? nSize : 1)) return pMemory;
  abort();
}
void* operator new[](size_t nSize) { return operator new(nSize); }
void* operator new(size_t nSize, const std::nothrow_t&) noexcept { return malloc(nSize ? nSize : 1); }
void* operator new[](size_t nSize, const std::nothrow_t&) noexcept { return malloc(nSize ? nSize : 1); }
void operator delete(void* pMemory) noexcept { free(pMemory); }
void operator delete[](void* pMemory) noexcept { free(pMemory); }
void operator delete(void* pMemory, size_t) noexcept { free(pMemory); }
void operator delete[](void* pMemory, size_t) noexcept { free(pMemory); }

namespace std {
[[noreturn]] void __throw_bad_alloc() { abort(); }
[[noreturn]] void __throw_bad_array_new_length() { abort(); }
[[noreturn]] void __throw_bad_function_call() { abort(); }
[[noreturn]] void __throw_length_error(const char*) { abort(); }
[[noreturn]] void __throw_logic_error(const char*) { abort(); }
[[noreturn]] void __throw_out_of_range(const char*) { abort(); }
[[noreturn]] void __throw_out_of_range_fmt(const char*, ...) { abort(); }
[[noreturn]] void __throw_system_error(int) { abort(); }
}  // namespace std

// Called for `new T[n]` with a count that cannot be held.
extern "C" [[noreturn]] void __cxa_throw_bad_array_new_length() { abort(); }

// The compiler's headers lead printf calls to these two, whose own implementation (25 KB) writes floating-point numbers
// in every form. Nothing here prints any, so the system's C runtime does.
extern "C" int __mingw_vfprintf(FILE* pFile, const char* szFormat, va_list args) {
  return __ms_vfprintf(pFile, szFormat, args);
}
extern "C" int __mingw_vsnprintf(char* szBuffer, size_t nSize, const char* szFormat, va_list args) {
  const int iLength = _vsnprintf(szBuffer, nSize, szFormat, args);
  if (nSize) szBuffer[nSize - 1] = '\0';  // the system's leaves a full buffer open
  return iLength;
}
