#include "IconFile.h"

#include <zlib.h>

#include <algorithm>

#include "PeBytes.h"

namespace {

const uint32_t ROW_SIZE = 16;
const uint32_t BITMAP_HEADER_SIZE = 40;
const uint32_t BITFIELDS = 3;  // a compression that only names the colours' places
const uint8_t PNG_SIGNATURE[] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1a, '\n'};
const uint32_t PNG_HEADER = 0x52444849, PNG_END = 0x444e4549;  // "IHDR", "IEND"

// PNG's numbers are big-endian.
uint32_t Swapped(uint32_t value) { return value >> 24 | (value >> 8 & 0xff00) | (value << 8 & 0xff0000) | value << 24; }

class ImageCheck {
 public:
  ImageCheck(const ByteRange& bytes, const IconImage& image, size_t nImage)
      : m_bytes(bytes), m_image(image), m_nImage(nImage) {}

  // The bits of a pixel.
  uint16_t Check() const {
    const bool bPng = m_bytes.Size() >= sizeof PNG_SIGNATURE &&
                      std::equal(PNG_SIGNATURE, PNG_SIGNATURE + sizeof PNG_SIGNATURE, m_bytes.At(0, 1));
    return bPng ? CheckPng() : CheckBitmap();
  }

 private:
  void Require(bool bCondition, const char* szWrong) const {
    if (!bCondition) throw OrbitError("image " + std::to_string(m_nImage) + " of the icon " + szWrong);
  }
  void RequireSize(uint32_t width, uint32_t height) const {
    static const char WRONG[] = "has not the size that the icon's list says";
    Require(m_image.width ? width == m_image.width : width >= 256, WRONG);
    Require(m_image.height ? height == m_image.height : height >= 256, WRONG);
  }

  uint16_t CheckBitmap() const {
    Require(m_bytes.Size() >= BITMAP_HEADER_SIZE && m_bytes.U32(0) == BITMAP_HEADER_SIZE, "is no bitmap and no PNG");
    const uint32_t width = m_bytes.U32(4), height = m_bytes.U32(8) / 2, compression = m_bytes.U32(16),
                   nUsed = m_bytes.U32(32);
    const uint16_t bits = m_bytes.U16(14);
    static const uint16_t DEPTHS[] = {1, 4, 8, 16, 24, 32};
    Require(std::count(std::begin(DEPTHS), std::end(DEPTHS), bits), "has an impossible number of bits for a pixel");
    const bool bFields = compression == BITFIELDS && bits >= 16 && bits != 24;
    Require(compression == 0 || bFields, "is compressed, which a bitmap in an icon cannot be");
    RequireSize(width, height);
    Require(width <= 0xffff && height <= 0xffff && nUsed <= (bits <= 8 ? 1u << bits : 256u),
            "has an impossible header");
    const uint64_t nColors = bits <= 8 && nUsed == 0 ? 1u << bits : nUsed;
    // The colours, then the mask; their lines have whole 32-bit words.
    const uint64_t line = AlignedUp(uint64_t{width} * bits, 32) / 8, maskLine = AlignedUp(width, 32) / 8;
    const uint64_t needed = BITMAP_HEADER_SIZE + (bFields ? 12 : 0) + 4 * nColors + height * (line + maskLine);
    Require(m_bytes.Size() >= needed, "is cut short");
    return bits;
  }

  uint16_t CheckPng() const {
    uint64_t place = sizeof PNG_SIGNATURE;
    for (uint32_t kind = 0; kind != PNG_END;) {
      Require(m_bytes.Size() - place >= 12, "is a PNG that is cut short");
      const uint32_t length = Swapped(m_bytes.U32(place));
      Require(m_bytes.Size() - place - 12 >= length, "is a PNG that is cut short");
      kind = m_bytes.U32(place + 4);
      Require((place == sizeof PNG_SIGNATURE) == (kind == PNG_HEADER && length == 13), "is a PNG without its header");
      const uint32_t sum = static_cast<uint32_t>(crc32(0, m_bytes.At(place + 4, length + uint64_t{4}), length + 4));
      Require(sum == Swapped(m_bytes.U32(place + 8 + length)), "is a PNG that is damaged");
      place += uint64_t{12} + length;
    }
    RequireSize(Swapped(m_bytes.U32(16)), Swapped(m_bytes.U32(20)));
    static const uint8_t CHANNELS[] = {1, 0, 3, 1, 2, 0, 4};  // by the kind of colours
    const uint8_t depth = m_bytes.U8(24), colors = m_bytes.U8(25);
    const uint8_t nChannels = colors < sizeof CHANNELS ? CHANNELS[colors] : 0;
    Require(nChannels && depth >= 1 && depth <= 16, "is a PNG with an impossible header");
    return static_cast<uint16_t>(depth * nChannels);
  }

  ByteRange m_bytes;
  const IconImage& m_image;
  size_t m_nImage;
};

IconImage ReadImage(const ByteRange& icon, uint32_t row, size_t nImage, uint64_t& total) {
  IconImage image = {icon.U8(row), icon.U8(row + 1), icon.U8(row + 2), 0, {}};
  const uint32_t size = icon.U32(row + 8), place = icon.U32(row + 12);
  total += size;
  if (total > icon.Size()) throw OrbitError("the icon's images overlap, or reach past its end");
  const ByteRange bytes = icon.Part(place, size, "the icon is cut short");
  image.bitCount = ImageCheck(bytes, image, nImage).Check();
  image.bytes = bytes.Copy(0, size);
  return image;
}

}  // namespace

std::vector<IconImage> ReadIconFile(const std::vector<uint8_t>& file) {
  const ByteRange icon(file, "the icon is cut short");
  if (icon.U16(0) != 0 || icon.U16(2) != 1) throw OrbitError("the icon is no .ico file");
  const uint32_t nImages = icon.U16(4);
  if (nImages == 0) throw OrbitError("the icon has no image");
  std::vector<IconImage> images;
  uint64_t total = 6 + nImages * ROW_SIZE;
  for (uint32_t i = 0; i < nImages; i++) images.push_back(ReadImage(icon, 6 + i * ROW_SIZE, i + 1, total));
  return images;
}

std::vector<uint8_t> EncodeIconGroup(const std::vector<IconImage>& images) {
  std::vector<uint8_t> group = {0, 0, 1, 0};
  Append16(group, static_cast<uint32_t>(images.size()));
  for (size_t i = 0; i < images.size(); i++) {
    Append(group, {images[i].width, images[i].height, images[i].colors, 0});
    Append16(group, 1);  // planes
    Append16(group, images[i].bitCount);
    Append32(group, static_cast<uint32_t>(images[i].bytes.size()));
    Append16(group, static_cast<uint32_t>(i + 1));
  }
  return group;
}
