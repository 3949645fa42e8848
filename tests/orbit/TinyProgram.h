// The least programs that Windows' headers allow, and icons, for tests of what is written into them.
#pragma once

#include <algorithm>
#include <cstring>

#include "PeResources.h"

using Bytes = std::vector<uint8_t>;

// Places in a tiny program.
enum TinyPlace : size_t {
  TINY_HEADER = 0x80,
  TINY_COUNT = TINY_HEADER + 6,
  TINY_OPTIONAL = TINY_HEADER + 24,
  TINY_DIRECTORIES = TINY_OPTIONAL + 96,
  TINY_SECTIONS = TINY_OPTIONAL + 224,
  TINY_CODE = 0x400,  // the sections' raw data, 0x200 each; in memory at 0x1000, 0x2000 ...
  TINY_RESOURCES = 0x600,
  TINY_RELOCATIONS = 0x800,
};

inline ResourceWay TinyManifest() { return {ById(24), ById(1), ById(0x409)}; }
inline ResourceWay TinyNamed() {
  return {ResourceStep{false, u"DATA", 0}, ResourceStep{false, u"\x010cITA\x010c", 0}, ById(0)};
}

inline ResourceTree TinyTree() {
  ResourceTree tree;
  tree[TinyManifest()] = {{'<', 'x', '>'}, 1252};
  tree[TinyNamed()] = {{1, 2, 3, 4, 5}, 0};
  for (const uint32_t type : {RESOURCE_ICON, RESOURCE_GROUP_ICON, RESOURCE_VERSION})
    tree[{ById(type), ById(7), ById(0x409)}] = {{'o', 'l', 'd'}, 0};
  return tree;
}

// One section of code, one of resources, one of relocations: as many of them as are asked for.
inline Bytes TinyProgram(size_t nSections = 3) {
  Bytes image(TINY_CODE + nSections * 0x200);
  image[0] = 'M', image[1] = 'Z';
  Store32(image, 0x3c, TINY_HEADER);
  Store32(image, TINY_HEADER, 0x4550);
  Store16(image, TINY_HEADER + 4, 0x14c);
  Store16(image, TINY_COUNT, static_cast<uint32_t>(nSections));
  Store16(image, TINY_HEADER + 20, 224);
  Store16(image, TINY_HEADER + 22, 0x103);
  const std::pair<uint32_t, uint32_t> fields[] = {
      {0, 0x10b},  {8, 0x400}, {16, 0x1000},  {28, 0x400000}, {32, 0x1000},  {36, 0x200},  {48, 4}, {56, 0x4000},
      {60, 0x400}, {68, 2},    {72, 0x10000}, {76, 0x1000},   {80, 0x10000}, {84, 0x1000}, {92, 16}};
  for (const auto& [place, value] : fields) Store32(image, TINY_OPTIONAL + place, value);
  static const char* const NAMES[] = {".text", ".rsrc", ".reloc"};
  static const uint32_t KINDS[] = {0x60000020, 0x40000040, 0x42000040};
  for (uint32_t i = 0; i < nSections; i++) {
    const size_t row = TINY_SECTIONS + i * 40;
    std::copy_n(NAMES[i], strlen(NAMES[i]), image.begin() + row);
    const uint32_t values[] = {0x200, 0x1000 * (i + 1), 0x200, static_cast<uint32_t>(TINY_CODE + i * 0x200)};
    for (size_t k = 0; k < 4; k++) Store32(image, row + 8 + 4 * k, values[k]);
    Store32(image, row + 36, KINDS[i]);
  }
  if (nSections < 2) return image;
  const Bytes resources = EncodeResources(TinyTree(), 0x2000);
  std::copy(resources.begin(), resources.end(), image.begin() + TINY_RESOURCES);
  Store32(image, TINY_DIRECTORIES + 16, 0x2000);
  Store32(image, TINY_DIRECTORIES + 20, static_cast<uint32_t>(resources.size()));
  if (nSections > 2) {
    Store32(image, TINY_DIRECTORIES + 40, 0x3000);
    Store32(image, TINY_DIRECTORIES + 44, 12);
    Store32(image, TINY_RELOCATIONS, 0x1000);
    Store32(image, TINY_RELOCATIONS + 4, 12);
  }
  return image;
}

// A PNG of one pixel: the chunks IHDR, IDAT and IEND.
inline Bytes TinyPng() {
  return {0x89, 0x50, 0x4e, 0x47, 0x0d, 0x0a, 0x1a, 0x0a, 0,    0,    0,    0x0d, 0x49, 0x48, 0x44, 0x52, 0, 0,
          0,    1,    0,    0,    0,    1,    8,    6,    0,    0,    0,    0x1f, 0x15, 0xc4, 0x89, 0,    0, 0,
          0x0d, 0x49, 0x44, 0x41, 0x54, 0x78, 0x9c, 0x63, 0x68, 0x60, 0x70, 0xf8, 0x0f, 0,    3,    0x84, 1, 0xc0,
          0xe0, 0xd1, 0xa3, 0x2f, 0,    0,    0,    0,    0x49, 0x45, 0x4e, 0x44, 0xae, 0x42, 0x60, 0x82};
}

// A bitmap of 2 by 2 with 16 colours, and the PNG.
inline Bytes TinyIcon() {
  Bytes bitmap;
  for (const uint32_t field : {40u, 2u, 4u, 4u << 16 | 1u, 0u, 0u, 0u, 0u, 0u, 0u}) Append32(bitmap, field);
  bitmap.resize(40 + 16 * 4 + 2 * 4 + 2 * 4);
  const Bytes png = TinyPng();
  Bytes icon = {0, 0, 1, 0, 2, 0};
  uint32_t place = 6 + 2 * 16;
  for (const auto& [size, pImage] : {std::pair<uint8_t, const Bytes*>{2, &bitmap}, {1, &png}}) {
    Append(icon, {size, size, 0, 0, 0, 0, 0, 0});
    Append32(icon, static_cast<uint32_t>(pImage->size()));
    Append32(icon, place);
    place += static_cast<uint32_t>(pImage->size());
  }
  Append(icon, bitmap);
  Append(icon, png);
  return icon;
}
