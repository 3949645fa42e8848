#include "TextFile.h"

#include <cstring>

#include "foundation/Text.h"

namespace {

struct FileHandle {
  HANDLE h;
  ~FileHandle() {
    if (h != INVALID_HANDLE_VALUE) CloseHandle(h);
  }
};

TextFileResult ReadBytes(const wchar_t* szPath, CNString& csBytes) {
  FileHandle file = {CreateFileW(szPath, GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr)};
  LARGE_INTEGER size = {};
  if (file.h == INVALID_HANDLE_VALUE || !GetFileSizeEx(file.h, &size)) return TextFileResult::CannotOpen;
  if (size.QuadPart > MAX_TEXT_FILE) return TextFileResult::TooLong;
  if (!csBytes.SetLength(size.LowPart)) return TextFileResult::NoMemory;
  if (size.LowPart == 0) return TextFileResult::Read;
  DWORD dwRead = 0;
  if (!ReadFile(file.h, csBytes.Ptr(), size.LowPart, &dwRead, nullptr)) return TextFileResult::CannotOpen;
  csBytes.SetLength(static_cast<long>(dwRead));
  return TextFileResult::Read;
}

bool bFromUtf16(const char* pBytes, size_t nBytes, WideText& text) {
  if (!text.bAllocate(nBytes / 2)) return false;
  memcpy(text.Ptr(), pBytes, nBytes / 2 * 2);
  return true;
}

bool bFromUtf8(const char* pBytes, int iBytes, WideText& text) {
  int iLength = MultiByteToWideChar(CP_UTF8, MB_ERR_INVALID_CHARS, pBytes, iBytes, nullptr, 0);
  if (iLength == 0 && iBytes > 0) return false;
  return text.bAllocate(iLength) &&
         (iBytes == 0 || MultiByteToWideChar(CP_UTF8, 0, pBytes, iBytes, text.Ptr(), iLength));
}

// With the program's own table, so that the text is right whatever the system's code page is.
bool bFromCp1250(CNString& csBytes, WideText& text) {
  for (long i = 0; i < csBytes.Length(); i++) {
    if (csBytes.Ptr()[i] == '\0') csBytes.Ptr()[i] = ' ';
  }
  CNWideText wide(csBytes.Text());
  return wide.Ptr() && bFromUtf16(reinterpret_cast<const char*>(wide.Ptr()), csBytes.Length() * 2, text);
}

long LengthOfUtf8Mark(const CNString& csBytes) {
  return csBytes.Length() >= 3 && memcmp(csBytes.Text(), "\xEF\xBB\xBF", 3) == 0 ? 3 : 0;
}

bool bDecode(CNString& csBytes, WideText& text) {
  if (csBytes.Length() >= 2 && memcmp(csBytes.Text(), "\xFF\xFE", 2) == 0)
    return bFromUtf16(csBytes.Text() + 2, csBytes.Length() - 2, text);
  long lMark = LengthOfUtf8Mark(csBytes);
  return bFromUtf8(csBytes.Text() + lMark, csBytes.Length() - lMark, text) || bFromCp1250(csBytes, text);
}

// Copies with CR LF for every lone CR or LF; a null target only counts.
size_t CopyLines(WideText& from, wchar_t* pTo) {
  const wchar_t* pFrom = from.Ptr();
  size_t nLength = from.Length(), nOut = 0;
  auto put = [&](wchar_t c) {
    if (pTo) pTo[nOut] = c;
    nOut++;
  };
  for (size_t i = 0; i < nLength; i++) {
    if (pFrom[i] == L'\r' || pFrom[i] == L'\n') {
      if (pFrom[i] == L'\r' && i + 1 < nLength && pFrom[i + 1] == L'\n') i++;
      put(L'\r');
      put(L'\n');
    } else {
      put(pFrom[i] ? pFrom[i] : L' ');
    }
  }
  return nOut;
}

}  // namespace

bool WideText::bAllocate(size_t nLength) {
  HeapFree(GetProcessHeap(), 0, m_pText);
  m_pText = static_cast<wchar_t*>(HeapAlloc(GetProcessHeap(), HEAP_ZERO_MEMORY, (nLength + 1) * sizeof(wchar_t)));
  m_nLength = nLength;
  return m_pText != nullptr;
}

TextFileResult ReadTextFile(const wchar_t* szPath, WideText& text) {
  CNString csBytes;
  TextFileResult result = ReadBytes(szPath, csBytes);
  if (result != TextFileResult::Read) return result;
  WideText raw;
  if (!bDecode(csBytes, raw)) return TextFileResult::NoMemory;
  if (!text.bAllocate(CopyLines(raw, nullptr))) return TextFileResult::NoMemory;
  CopyLines(raw, text.Ptr());
  return TextFileResult::Read;
}
