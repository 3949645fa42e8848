// The resource tree of a program: types, names and languages, with the bytes at its leaves.
#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "PeHeaders.h"

// A step of the way to a resource: a name or an id. Ordered as the system looks them up, names first.
struct ResourceStep {
  bool bById = true;
  std::u16string name;
  uint32_t id = 0;

  auto operator<=>(const ResourceStep&) const = default;
};
using ResourceWay = std::array<ResourceStep, 3>;  // type, name, language

struct ResourceData {
  std::vector<uint8_t> bytes;
  uint32_t codePage = 0;
};
using ResourceTree = std::map<ResourceWay, ResourceData>;

inline ResourceStep ById(uint32_t id) { return {true, u"", id}; }
const uint32_t RESOURCE_ICON = 3;
const uint32_t RESOURCE_GROUP_ICON = 14;
const uint32_t RESOURCE_VERSION = 16;

// The section that holds the resources; null when the program has none. Throws OrbitError when they are in no section.
const PeSection* ResourceSection(const PeHeaders& headers);
// The program's resources; none is an empty tree. Throws OrbitError for a tree that is not regular: directories deeper
// than three or met twice, something outside the section, a resource twice, resources that share bytes.
ResourceTree ReadResources(const std::vector<uint8_t>& image, const PeHeaders& headers);
// The tree as the bytes of a section at an address.
std::vector<uint8_t> EncodeResources(const ResourceTree& tree, uint32_t address);
