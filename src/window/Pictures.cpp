#include "window/Pictures.h"

#include <cstdint>
#include <cstring>
#include <memory>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

// A copy with 32 bits for each pixel, whose pixels can be read and written. Empty on failure.
OwnedBitmap CopyAs32Bit(HBITMAP hSource, const SIZE& size, uint32_t** ppPixels) {
  BITMAPINFO info = {};
  info.bmiHeader.biSize = sizeof(info.bmiHeader);
  info.bmiHeader.biWidth = size.cx;
  info.bmiHeader.biHeight = -size.cy;
  info.bmiHeader.biPlanes = 1;
  info.bmiHeader.biBitCount = 32;
  void* pBits = nullptr;
  OwnedBitmap copy(CreateDIBSection(nullptr, &info, DIB_RGB_COLORS, &pBits, nullptr, 0));
  OwnedMemoryDC from(CreateCompatibleDC(nullptr)), to(CreateCompatibleDC(nullptr));
  if (!copy || !from || !to) return OwnedBitmap();
  {
    Selected source(from.Get(), hSource), target(to.Get(), copy.Get());
    if (!BitBlt(to.Get(), 0, 0, size.cx, size.cy, from.Get(), 0, 0, SRCCOPY)) return OwnedBitmap();
  }
  GdiFlush();
  *ppPixels = static_cast<uint32_t*>(pBits);
  return copy;
}

}  // namespace

static const char* s_szPictureFolder = nullptr;
static bool s_bNoOtherFolder = false;

void SetPictureFolder(const char* szFolder, bool bNoOther) {
  s_szPictureFolder = szFolder;
  s_bNoOtherFolder = bNoOther;
}

bool bOnlyPictureFolder() { return s_bNoOtherFolder; }

bool bFindPictureFile(const char* szName, CNString& csPath) {
  static const char* const FOLDERS[] = {"\\pict\\", "\\..\\pict\\"};
  CNString csFolder;
  if (!szName || !*szName || !bOsGetProgramPath(csFolder)) return false;
  if (s_szPictureFolder) {
    csPath = s_szPictureFolder;
    csPath.AddSlash();
    csPath.Concat(szName);
    if (bOsExists(csPath.Text())) return true;
    if (s_bNoOtherFolder) return false;
  }
  csFolder.Trim('\\');
  for (const char* szFolder : FOLDERS) {
    csPath = csFolder;
    csPath.Concat(szFolder);
    csPath.Concat(szName);
    if (bOsExists(csPath.Text())) return true;
  }
  return false;
}

bool Picture::bLoadBitmap(HINSTANCE hInstance, const char* szName) {
  CNString csPath;
  if (strncmp(szName, "IDB_", 4) == 0)
    m_Bitmap.Reset(static_cast<HBITMAP>(LoadImageW(hInstance, Wide(szName), IMAGE_BITMAP, 0, 0, LR_CREATEDIBSECTION)));
  else if (bFindPictureFile(szName, csPath))
    m_Bitmap.Reset(static_cast<HBITMAP>(
        LoadImageW(nullptr, Wide(csPath.Text()), IMAGE_BITMAP, 0, 0, LR_LOADFROMFILE | LR_CREATEDIBSECTION)));
  BITMAP bitmap;
  if (!m_Bitmap || !GetObjectW(m_Bitmap.Get(), sizeof(bitmap), &bitmap)) return false;
  m_Size = {bitmap.bmWidth, bitmap.bmHeight < 0 ? -bitmap.bmHeight : bitmap.bmHeight};
  return true;
}

bool Picture::bLoad(HINSTANCE hInstance, const char* szName, const ControlColor& transparent) {
  if (!szName || !bLoadBitmap(hInstance, szName)) {
    LogPrintf("ERROR: CNImage::Create -> !bLoad(%s) -> return FALSE", szName ? szName : "");
    return false;
  }
  if (transparent.bSet && !bMakeMask(transparent)) {
    LogPrintf("ERROR: CNImage::Create -> !bMakeMask(%s) -> return FALSE", szName);
    return false;
  }
  return true;
}

// The mask is white and the picture black where nothing is to be painted: AND with the mask, then OR with the picture.
bool Picture::bMakeMask(const ControlColor& transparent) {
  uint32_t* pPixels = nullptr;
  m_Bitmap = CopyAs32Bit(m_Bitmap.Get(), m_Size, &pPixels);
  const size_t nStride = (static_cast<size_t>(m_Size.cx) + 15) / 16 * 2;
  std::unique_ptr<uint8_t[]> pMask(new uint8_t[nStride * m_Size.cy]());
  if (!m_Bitmap || !pMask) return false;
  const uint32_t uColor = transparent.red << 16 | transparent.green << 8 | transparent.blue;
  for (LONG y = 0; y < m_Size.cy; y++)
    for (LONG x = 0; x < m_Size.cx; x++) {
      uint32_t& uPixel = pPixels[static_cast<size_t>(y) * m_Size.cx + x];
      if ((uPixel & 0xFFFFFF) != uColor) continue;
      uPixel = 0;
      pMask[nStride * y + x / 8] |= static_cast<uint8_t>(0x80 >> x % 8);
    }
  m_Mask.Reset(CreateBitmap(m_Size.cx, m_Size.cy, 1, 1, pMask.get()));
  return static_cast<bool>(m_Mask);
}

void Picture::Draw(HDC hDC, const RECT& area) const {
  OwnedMemoryDC memory(CreateCompatibleDC(hDC));
  SetStretchBltMode(hDC, COLORONCOLOR);
  const auto put = [&](HBITMAP hBitmap, DWORD dwOperation) {
    Selected bitmap(memory.Get(), hBitmap);
    StretchBlt(hDC, area.left, area.top, area.right - area.left, area.bottom - area.top, memory.Get(), 0, 0, m_Size.cx,
               m_Size.cy, dwOperation);
  };
  if (m_Mask) {
    // A monochrome source takes the target's text colour for black and its background colour for white.
    SetTextColor(hDC, RGB(0, 0, 0));
    SetBkColor(hDC, RGB(255, 255, 255));
    put(m_Mask.Get(), SRCAND);
  }
  put(m_Bitmap.Get(), m_Mask ? SRCPAINT : SRCCOPY);
}
