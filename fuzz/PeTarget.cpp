// The input as a program with an icon behind its last section, and as a bare icon.
#include <algorithm>

#include "Fuzz.h"
#include "IconFile.h"
#include "PeImage.h"
#include "PeResources.h"

namespace {

using Bytes = std::vector<uint8_t>;
const PeVersionInfo INFO = {"Plumo", "2.1 beta", "Tavola", "", "", "Plumo.exe"};

// What must be there afterwards.
void Check(const Bytes& before, const Bytes& after) {
  FUZZ_REQUIRE(FindOverlay(after) == after.size());
  FUZZ_REQUIRE(std::equal(before.begin(), before.begin() + 0x3c, after.begin()));
  const ResourceTree old = ReadResources(before, ReadPeHeaders(before));
  const ResourceTree now = ReadResources(after, ReadPeHeaders(after));
  for (const auto& [way, data] : old) {
    const ResourceStep& type = way[0];
    if (type == ById(RESOURCE_ICON) || type == ById(RESOURCE_GROUP_ICON) || type == ById(RESOURCE_VERSION)) continue;
    const auto found = now.find(way);
    FUZZ_REQUIRE(found != now.end() && found->second.bytes == data.bytes && found->second.codePage == data.codePage);
  }
  Bytes again = after;
  SetPeResources(again, {}, INFO);
  FUZZ_REQUIRE(ReadResources(again, ReadPeHeaders(again)).size() == now.size());
}

void AsProgram(const Bytes& input) {
  const uint32_t overlay = FindOverlay(input);
  const Bytes image(input.begin(), input.begin() + overlay), icon(input.begin() + overlay, input.end());
  Bytes result = image;
  SetPeResources(result, icon, INFO);
  Check(image, result);
}

void AsIcon(const Bytes& input) {
  const std::vector<IconImage> images = ReadIconFile(input);
  FUZZ_REQUIRE(EncodeIconGroup(images).size() == 6 + 14 * images.size());
}

}  // namespace

FUZZ_TARGET(pe, input) {
  const Bytes bytes(input.begin(), input.end());
  for (const auto pRead : {AsProgram, AsIcon}) try {
      pRead(bytes);
    } catch (const OrbitError&) {
    }
}
