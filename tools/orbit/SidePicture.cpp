#include "SidePicture.h"

#include "PeBytes.h"

namespace {

const uint32_t WIDTH = 160, HEIGHT = 440, COLORS = 256;
const uint32_t HEADERS = 14 + 40, PALETTE = 4 * COLORS, BYTES = HEADERS + PALETTE + WIDTH * HEIGHT;

struct Color {
  int iBlue, iGreen, iRed;
};
const Color TOP = {58, 22, 14}, BOTTOM = {150, 96, 108};

}  // namespace

std::vector<uint8_t> MakeSidePicture() {
  std::vector<uint8_t> bytes = {'B', 'M'};
  for (const uint32_t number : {BYTES, 0u, HEADERS + PALETTE, 40u, WIDTH, HEIGHT}) Append32(bytes, number);
  Append16(bytes, 1);  // planes
  Append16(bytes, 8);  // bits of a pixel
  for (const uint32_t number : {0u, WIDTH * HEIGHT, 0u, 0u, COLORS, 0u}) Append32(bytes, number);
  const auto mix = [](int iTop, int iBottom, uint32_t i) {
    return static_cast<uint8_t>(iTop + (iBottom - iTop) * static_cast<int>(i) / static_cast<int>(COLORS - 1));
  };
  for (uint32_t i = 0; i < COLORS; i++)
    bytes.insert(bytes.end(), {mix(TOP.iBlue, BOTTOM.iBlue, i), mix(TOP.iGreen, BOTTOM.iGreen, i),
                               mix(TOP.iRed, BOTTOM.iRed, i), 0});
  // Bottom row first.
  for (uint32_t row = HEIGHT; row-- > 0;)
    bytes.insert(bytes.end(), WIDTH, static_cast<uint8_t>(row * (COLORS - 1) / (HEIGHT - 1)));
  return bytes;
}
