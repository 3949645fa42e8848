#include "PeImage.h"

#include <algorithm>

#include "IconFile.h"
#include "PeResources.h"
#include "PeVersion.h"

namespace {

const uint32_t SECTION_KIND = 0x40000040;  // initialized data, to be read
const char RESOURCE_SECTION[] = ".rsrc";
const char RELOCATION_SECTION[] = ".reloc";

// Icons and version are put in under the neutral language: the system finds them whatever its own.
const uint32_t NEUTRAL = 0;

void Remove(ResourceTree& tree, uint32_t type) {
  std::erase_if(tree, [type](const auto& leaf) { return leaf.first[0] == ById(type); });
}

void ReplaceIcons(ResourceTree& tree, const std::vector<uint8_t>& icoFile) {
  const std::vector<IconImage> images = ReadIconFile(icoFile);
  // Explorer shows the first group. It keeps its name, so that the program's own windows find the new one.
  ResourceStep name = ById(1);
  const auto group = tree.lower_bound({ById(RESOURCE_GROUP_ICON)});
  if (group != tree.end() && group->first[0] == ById(RESOURCE_GROUP_ICON)) name = group->first[1];
  Remove(tree, RESOURCE_ICON);
  Remove(tree, RESOURCE_GROUP_ICON);
  for (size_t i = 0; i < images.size(); i++)
    tree[{ById(RESOURCE_ICON), ById(static_cast<uint32_t>(i + 1)), ById(NEUTRAL)}].bytes = images[i].bytes;
  tree[{ById(RESOURCE_GROUP_ICON), name, ById(NEUTRAL)}].bytes = EncodeIconGroup(images);
}

void ReplaceVersion(ResourceTree& tree, const PeVersionInfo& info) {
  Remove(tree, RESOURCE_VERSION);
  tree[{ById(RESOURCE_VERSION), ById(1), ById(NEUTRAL)}].bytes = EncodeVersion(info);
}

// A section of one purpose: nothing else is in it, as far as the headers tell.
bool bOnly(const PeHeaders& headers, const PeSection& section, const char* szName, size_t nDirectory) {
  if (section.name != szName || section.rawSize == 0 || section.bHolds(headers.entryPoint)) return false;
  for (size_t i = 0; i < headers.directories.size(); i++)
    if (i != PE_SIGNATURE && section.bHolds(headers.directories[i].address) != (i == nDirectory)) return false;
  return headers.directories[nDirectory].address == section.virtualAddress;
}

// Writes the last sections of an image anew.
class TailWriter {
 public:
  TailWriter(std::vector<uint8_t>& image, const PeHeaders& headers) : m_image(image), m_headers(headers) {}

  void Put(const ResourceTree& tree) {
    PeSection section = {};
    const PeSection* const pRelocations = pFindOld(section);
    if (section.headerPlace == 0) section = AddSection();
    std::vector<uint8_t> relocations;
    if (pRelocations) relocations = ByteRange(m_image, "").Copy(pRelocations->rawPlace, pRelocations->rawSize);
    m_image.resize(section.rawPlace);
    const uint32_t oldSize = section.rawSize;
    PutSection(section, PE_RESOURCES, EncodeResources(tree, section.virtualAddress), 0);
    if (pRelocations) {
      PeSection moved = *pRelocations;
      moved.virtualAddress = static_cast<uint32_t>(m_memoryEnd);
      PutSection(moved, PE_RELOCATIONS, relocations, moved.virtualSize);
    }
    const uint32_t place = m_headers.optionalPlace;
    Store32(m_image, place + PE_IMAGE_SIZE, static_cast<uint32_t>(m_memoryEnd));
    const uint32_t dataSize = ByteRange(m_image, "").U32(place + PE_INITIALIZED_SIZE);
    Store32(m_image, place + PE_INITIALIZED_SIZE, dataSize - oldSize + section.rawSize);
  }

 private:
  // The present resource section when it can be written anew in its place: it is the last, or only the relocations
  // are behind it, which nothing but the directory knows the place of. Returns these, if any.
  const PeSection* pFindOld(PeSection& section) const {
    const std::vector<PeSection>& all = m_headers.sections;
    const PeSection* pRelocations = nullptr;
    size_t nLast = all.size() - 1;
    if (nLast > 0 && bOnly(m_headers, all[nLast], RELOCATION_SECTION, PE_RELOCATIONS)) pRelocations = &all[nLast--];
    const bool bInPlace = bOnly(m_headers, all[nLast], RESOURCE_SECTION, PE_RESOURCES) &&
                          all[nLast].RawEnd() == (pRelocations ? pRelocations->rawPlace : m_image.size()) &&
                          all.back().RawEnd() == m_image.size();
    if (!bInPlace) return nullptr;
    section = all[nLast];
    return pRelocations;
  }

  // A new row of the section table, for what comes behind all that is there. Older resources stay where they are.
  PeSection AddSection() {
    const uint32_t row = m_headers.tableEnd;
    if (m_headers.sections.size() >= PE_MAX_SECTIONS || m_headers.headersSize - row < PE_SECTION_ROW ||
        std::any_of(m_image.begin() + row, m_image.begin() + row + PE_SECTION_ROW, [](uint8_t b) { return b != 0; }))
      throw OrbitError("the program's headers have no room for one more section");
    Store16(m_image, m_headers.countPlace, static_cast<uint32_t>(m_headers.sections.size() + 1));
    std::copy_n(RESOURCE_SECTION, sizeof RESOURCE_SECTION, m_image.begin() + row);
    Store32(m_image, row + 36, SECTION_KIND);
    PadTo(m_image, m_headers.fileAlignment);
    const uint64_t address = AlignedUp(m_headers.sections.back().VirtualEnd(), m_headers.sectionAlignment);
    return {RESOURCE_SECTION, row, 0, static_cast<uint32_t>(address), 0, static_cast<uint32_t>(m_image.size())};
  }

  // At the end of the image and at the section's address. A virtual size of 0: that of the bytes.
  void PutSection(PeSection& section, size_t nDirectory, const std::vector<uint8_t>& bytes, uint32_t virtualSize) {
    const uint32_t directory = m_headers.optionalPlace + PE_DIRECTORIES + static_cast<uint32_t>(8 * nDirectory);
    section.rawPlace = static_cast<uint32_t>(m_image.size());
    Append(m_image, bytes);
    PadTo(m_image, m_headers.fileAlignment);
    section.virtualSize = virtualSize ? virtualSize : static_cast<uint32_t>(bytes.size());
    m_memoryEnd = AlignedUp(section.VirtualEnd(), m_headers.sectionAlignment);
    if (std::max<uint64_t>(m_memoryEnd, m_image.size()) > INT32_MAX)
      throw OrbitError("the program would become too large");
    section.rawSize = static_cast<uint32_t>(m_image.size() - section.rawPlace);
    const uint32_t fields[] = {section.virtualSize, section.virtualAddress, section.rawSize, section.rawPlace};
    for (uint32_t i = 0; i < 4; i++) Store32(m_image, section.headerPlace + 8 + 4 * i, fields[i]);
    Store32(m_image, directory, section.virtualAddress);
    if (virtualSize == 0) Store32(m_image, directory + 4, section.virtualSize);
  }

  std::vector<uint8_t>& m_image;
  const PeHeaders& m_headers;
  uint64_t m_memoryEnd = 0;
};

}  // namespace

void SetPeResources(std::vector<uint8_t>& image, const std::vector<uint8_t>& icoFile, const PeVersionInfo& info) {
  const PeHeaders headers = ReadPeHeaders(image);
  const PeDirectory signature = headers.directories[PE_SIGNATURE];
  if (signature.address || signature.size) throw OrbitError("the program is signed; give it unsigned");
  if (image.size() > EndOfSections(headers))
    throw OrbitError("the program has something behind its last section: data, or symbols that were not stripped");
  ResourceTree tree = ReadResources(image, headers);
  if (!icoFile.empty()) ReplaceIcons(tree, icoFile);
  ReplaceVersion(tree, info);
  std::vector<uint8_t> output = image;
  TailWriter(output, headers).Put(tree);
  const uint32_t checksumPlace = headers.optionalPlace + PE_CHECKSUM;
  Store32(output, checksumPlace, 0);
  PeChecksum checksum;
  checksum.Add(output.data(), output.size());
  Store32(output, checksumPlace, checksum.Value());
  image.swap(output);
}

uint32_t FindOverlay(const std::vector<uint8_t>& image) { return EndOfSections(ReadPeHeaders(image)); }

uint32_t PeChecksumPlace(const std::vector<uint8_t>& image) { return ReadPeHeaders(image).optionalPlace + PE_CHECKSUM; }

void PeChecksum::Add(const uint8_t* pBytes, size_t nBytes) {
  Patch(m_size, pBytes, nBytes);
  m_size += nBytes;
}

// The sum of the file's 16-bit words, which does not depend on their order.
void PeChecksum::Patch(uint64_t place, const uint8_t* pBytes, size_t nBytes) {
  for (size_t i = 0; i < nBytes; i++) m_sum += uint64_t{pBytes[i]} << ((place + i) % 2 * 8);
}

uint32_t PeChecksum::Value() const {
  uint64_t sum = m_sum;
  while (sum > 0xffff) sum = (sum & 0xffff) + (sum >> 16);
  return static_cast<uint32_t>(sum + m_size);
}
