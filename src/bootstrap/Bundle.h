// What a packed file carries between the starter's image and the payload: a product archive with the setup program, its
// script and its pictures (docs/formats.md).
#pragma once

#include <windows.h>

#include <cstdint>

enum class BundleResult { Unpacked, None, Damaged, NotWritten };

// Where the bundle lies in the file.
struct BundleRange {
  uint64_t start = 0;
  uint64_t end = 0;
};

// pImage: the running program's own header, as the system has loaded it from the file of that size. None when there is
// no stamp or nothing lies between image and payload, Damaged when the stamp points outside the file, else Unpacked.
BundleResult FindBundle(const void* pImage, uint64_t fileSize, BundleRange& range);
// Checks the bundle and unpacks it into szFolder (full path, no trailing backslash). Anything short of the whole of it
// is a failure.
BundleResult UnpackBundle(HANDLE hFile, const BundleRange& range, const wchar_t* szFolder);
