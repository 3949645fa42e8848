// What Explorer shows of a program: an icon and a version resource, written into a PE32 executable without a system's
// help. The image is untrusted; whatever is wrong with it throws OrbitError with a text that says what, and the image
// is then as it was. No file is touched, and the same input always gives the same bytes. Any thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

// All UTF-8. What is empty is left out of the resource, but the texts below stand for each other as noted.
struct PeVersionInfo {
  std::string product;
  // Begins with up to four numbers of 0 to 65535 with points between them, which become the four binary ones (missing
  // ones 0); the whole text is shown, so "2.1 beta" is fine.
  std::string version;
  std::string publisher;
  std::string description;   // empty: the product
  std::string copyright;     // such as "© 2026 Tavola"
  std::string originalName;  // the file's name, such as "Plumo-2.1-install.exe"
};

// Replaces the icon and version resources of a program for 32-bit x86 and keeps its other resources. `icoFile` is the
// content of an .ico file (bitmaps and PNGs); an empty one keeps the icons that are there. The image must end with its
// last section (cut an overlay off at FindOverlay first) and must not be signed. Afterwards image.size() ==
// FindOverlay(image): the place of what is appended. The payload stamp's place in the DOS header is left alone; the
// checksum covers the image as it is returned.
void SetPeResources(std::vector<uint8_t>& image, const std::vector<uint8_t>& icoFile, const PeVersionInfo& info);

// Where the last section's raw data ends: the start of what is appended. `image` may be a whole file, signed or not,
// or a file's beginning as long as it reaches over all sections.
uint32_t FindOverlay(const std::vector<uint8_t>& image);

// The header's checksum of a file that is written in pieces. Add the file's bytes in their order, with zeros for the
// four bytes at PeChecksumPlace and for those that are not known yet; these are patched in afterwards.
// (What signs a program computes it anew.)
class PeChecksum {
 public:
  void Add(const uint8_t* pBytes, size_t nBytes);
  // Bytes that have been added as zeros before.
  void Patch(uint64_t place, const uint8_t* pBytes, size_t nBytes);
  uint32_t Value() const;

 private:
  uint64_t m_sum = 0;
  uint64_t m_size = 0;
};
uint32_t PeChecksumPlace(const std::vector<uint8_t>& image);
