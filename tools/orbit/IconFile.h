// An .ico file's images, checked, and what becomes of them in a program.
#pragma once

#include <cstdint>
#include <vector>

struct IconImage {
  uint8_t width;  // 0: 256 or more; so is the height
  uint8_t height;
  uint8_t colors;              // 0: 256 or more
  uint16_t bitCount;           // of a pixel
  std::vector<uint8_t> bytes;  // a bitmap without its file header, or a PNG
};

// At least one image. Throws OrbitError that names the image and what is wrong with it.
std::vector<IconImage> ReadIconFile(const std::vector<uint8_t>& file);
// The group resource that lists the images, whose own resources have the ids 1, 2, 3 ...
std::vector<uint8_t> EncodeIconGroup(const std::vector<IconImage>& images);
