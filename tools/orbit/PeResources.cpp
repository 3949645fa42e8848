#include "PeResources.h"

#include <algorithm>
#include <set>

namespace {

const uint32_t HIGH_BIT = 0x80000000;  // of a name: it is a text; of a place: it is a directory
const uint32_t DIRECTORY_SIZE = 16;    // and 8 for each of its rows
const uint32_t ROW_SIZE = 8;
const uint32_t LEAF_SIZE = 16;
const uint32_t DATA_ALIGNMENT = 8;
const size_t LANGUAGE = 2;  // the last step of the way

class TreeReader {
 public:
  // `section` from the root directory on, which is at an address.
  TreeReader(const ByteRange& section, uint32_t address) : m_section(section), m_address(address) {}

  ResourceTree Read() {
    ResourceWay way;
    ReadDirectory(0, 0, way);
    return std::move(m_tree);
  }

 private:
  void ReadDirectory(uint32_t place, size_t level, ResourceWay& way) {
    if (!m_directories.insert(place).second) throw OrbitError("the program's resources lead in a circle");
    const uint32_t nNamed = m_section.U16(place + uint64_t{12}), nRows = nNamed + m_section.U16(place + uint64_t{14});
    for (uint32_t i = 0; i < nRows; i++) {
      const uint64_t row = place + uint64_t{DIRECTORY_SIZE} + i * ROW_SIZE;
      way[level] = Step(m_section.U32(row), i < nNamed);
      const uint32_t next = m_section.U32(row + 4);
      if (((next & HIGH_BIT) != 0) != (level < LANGUAGE))
        throw OrbitError("the program's resources are not in three levels: type, name, language");
      if (next & HIGH_BIT)
        ReadDirectory(next & ~HIGH_BIT, level + 1, way);
      else
        ReadLeaf(next, way);
    }
  }

  ResourceStep Step(uint32_t field, bool bNamed) {
    if (((field & HIGH_BIT) != 0) != bNamed) throw OrbitError("the program's resources are out of order");
    if (!bNamed) return ById(field);
    const uint64_t place = field & ~HIGH_BIT;
    const uint16_t nLetters = m_section.U16(place);
    Count(2 * nLetters);
    ResourceStep step = {false, u"", 0};
    for (uint64_t i = 1; i <= nLetters; i++) step.name += static_cast<char16_t>(m_section.U16(place + 2 * i));
    return step;
  }

  // What is there only once cannot be more than the section; more would be a small file that asks for much memory.
  void Count(uint64_t nBytes) {
    m_total += nBytes;
    if (m_total > m_section.Size()) throw OrbitError("resources of the program overlap");
  }

  void ReadLeaf(uint32_t place, const ResourceWay& way) {
    const uint32_t address = m_section.U32(place), size = m_section.U32(place + uint64_t{4}),
                   codePage = m_section.U32(place + uint64_t{8});
    Count(size);
    // An address before the section becomes a place far behind it.
    ResourceData data = {m_section.Copy(uint64_t{address} - m_address, size), codePage};
    if (!m_tree.emplace(way, std::move(data)).second) throw OrbitError("the program has a resource twice");
  }

  ByteRange m_section;
  uint32_t m_address;
  ResourceTree m_tree;
  std::set<uint32_t> m_directories;
  uint64_t m_total = 0;
};

using Leaf = ResourceTree::const_iterator;

// Where the next level's resources begin: a directory's rows, and the end of the last.
std::vector<Leaf> RowsOf(Leaf begin, Leaf end, size_t level) {
  std::vector<Leaf> rows;
  for (Leaf leaf = begin; leaf != end; ++leaf)
    if (rows.empty() || !(rows.back()->first[level] == leaf->first[level])) rows.push_back(leaf);
  rows.push_back(end);
  return rows;
}

uint32_t DirectoriesSize(Leaf begin, Leaf end, size_t level) {
  const std::vector<Leaf> rows = RowsOf(begin, end, level);
  uint32_t size = DIRECTORY_SIZE;
  for (size_t i = 0; i + 1 < rows.size(); i++)
    size += ROW_SIZE + (level < LANGUAGE ? DirectoriesSize(rows[i], rows[i + 1], level + 1) : 0);
  return size;
}

// Directories come first, then the leaves, then names and data as they are met.
class TreeWriter {
 public:
  TreeWriter(const ResourceTree& tree, uint32_t address)
      : m_address(address), m_leafPlace(DirectoriesSize(tree.begin(), tree.end(), 0)) {
    m_bytes.resize(m_leafPlace + tree.size() * LEAF_SIZE);
    PutDirectory(tree.begin(), tree.end(), 0);
    for (const auto& [way, data] : tree) PutData(data);
  }
  std::vector<uint8_t> Take() { return std::move(m_bytes); }

 private:
  uint32_t PutDirectory(Leaf begin, Leaf end, size_t level) {
    const std::vector<Leaf> rows = RowsOf(begin, end, level);
    const size_t nRows = rows.size() - 1;
    const size_t nNamed =
        std::count_if(rows.begin(), rows.end() - 1, [level](const Leaf& leaf) { return !leaf->first[level].bById; });
    const uint32_t place = m_directoryPlace;
    m_directoryPlace += static_cast<uint32_t>(DIRECTORY_SIZE + nRows * ROW_SIZE);
    Store16(m_bytes, place + 12, static_cast<uint32_t>(nNamed));
    Store16(m_bytes, place + 14, static_cast<uint32_t>(nRows - nNamed));
    for (size_t i = 0; i < nRows; i++) {
      const uint32_t row = static_cast<uint32_t>(place + DIRECTORY_SIZE + i * ROW_SIZE);
      Store32(m_bytes, row, PutStep(rows[i]->first[level]));
      Store32(m_bytes, row + 4,
              level == LANGUAGE ? NextLeaf() : HIGH_BIT | PutDirectory(rows[i], rows[i + 1], level + 1));
    }
    return place;
  }

  uint32_t PutStep(const ResourceStep& step) {
    if (step.bById) return step.id;
    const uint32_t place = static_cast<uint32_t>(m_bytes.size());
    Append16(m_bytes, static_cast<uint32_t>(step.name.size()));
    for (const char16_t c : step.name) Append16(m_bytes, c);
    return HIGH_BIT | place;
  }

  uint32_t NextLeaf() {
    m_leafPlace += LEAF_SIZE;
    return m_leafPlace - LEAF_SIZE;
  }

  void PutData(const ResourceData& data) {
    PadTo(m_bytes, DATA_ALIGNMENT);
    const size_t leaf = m_dataLeaf;
    m_dataLeaf += LEAF_SIZE;
    Store32(m_bytes, leaf, m_address + static_cast<uint32_t>(m_bytes.size()));
    Store32(m_bytes, leaf + 4, static_cast<uint32_t>(data.bytes.size()));
    Store32(m_bytes, leaf + 8, data.codePage);
    Append(m_bytes, data.bytes);
  }

  std::vector<uint8_t> m_bytes;
  uint32_t m_address;
  uint32_t m_directoryPlace = 0;  // of the next directory
  uint32_t m_leafPlace;           // of the next leaf, as the directories and as the data count them
  uint32_t m_dataLeaf = m_leafPlace;
};

}  // namespace

const PeSection* ResourceSection(const PeHeaders& headers) {
  const PeDirectory directory = headers.directories[PE_RESOURCES];
  if (directory.address == 0 && directory.size == 0) return nullptr;
  for (const PeSection& section : headers.sections)
    if (section.bHolds(directory.address)) return &section;
  throw OrbitError("the program's resources are outside its sections");
}

ResourceTree ReadResources(const std::vector<uint8_t>& image, const PeHeaders& headers) {
  const PeSection* const pSection = ResourceSection(headers);
  if (!pSection) return {};
  const uint32_t address = headers.directories[PE_RESOURCES].address, before = address - pSection->virtualAddress;
  const uint32_t size = std::min(pSection->rawSize, pSection->virtualSize);
  static const char OUTSIDE[] = "the program's resources reach out of their section";
  const ByteRange section = ByteRange(image, OUTSIDE).Part(pSection->rawPlace, size, OUTSIDE);
  if (before > size) throw OrbitError(OUTSIDE);
  return TreeReader(section.Part(before, size - before, OUTSIDE), address).Read();
}

std::vector<uint8_t> EncodeResources(const ResourceTree& tree, uint32_t address) {
  return TreeWriter(tree, address).Take();
}
