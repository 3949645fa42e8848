#include "PeHeaders.h"

#include <algorithm>

namespace {

const uint32_t DOS_HEADER_SIZE = 64;
const uint32_t NEW_HEADER_FIELD = 0x3c;
const uint32_t COFF_HEADER_SIZE = 24;  // with the signature before it
const uint16_t MACHINE_I386 = 0x14c;
const uint16_t MAGIC_PE32 = 0x10b;
const uint16_t MAGIC_PE32_PLUS = 0x20b;
const uint32_t LEAST_DIRECTORIES = 5;     // up to the signature's
const uint64_t MOST_MEMORY = 0x80000000;  // what such a program can address

void Require(bool bCondition, const char* szRefusal) {
  if (!bCondition) throw OrbitError(szRefusal);
}

bool bPowerOfTwo(uint32_t value) { return value && !(value & (value - 1)); }

// The place of the "PE" header.
uint32_t NewHeader(const ByteRange& file) {
  Require(file.Size() >= 2 && file.U16(0) == 0x5a4d, "the program is no Windows program: it does not begin with MZ");
  const uint32_t place = file.U32(NEW_HEADER_FIELD);
  Require(place >= DOS_HEADER_SIZE && place % 4 == 0, "the program's new header is at an impossible place");
  Require(file.U32(place) == 0x4550, "the program is no Windows program: it has no PE header");
  return place;
}

void ReadOptionalHeader(const ByteRange& file, uint32_t place, PeHeaders& headers) {
  headers.optionalPlace = place;
  headers.entryPoint = file.U32(place + 16);
  headers.sectionAlignment = file.U32(place + 32);
  headers.fileAlignment = file.U32(place + 36);
  headers.headersSize = file.U32(place + 60);
  Require(bPowerOfTwo(headers.sectionAlignment) && bPowerOfTwo(headers.fileAlignment) && headers.fileAlignment >= 512 &&
              headers.fileAlignment <= 65536 && headers.sectionAlignment >= headers.fileAlignment &&
              headers.sectionAlignment < MOST_MEMORY,
          "the program's alignments are impossible");
}

void ReadDirectories(const ByteRange& file, uint32_t place, uint16_t optionalSize, PeHeaders& headers) {
  const uint32_t nDirectories = file.U32(place + PE_DIRECTORIES - 4);
  Require(nDirectories >= LEAST_DIRECTORIES && nDirectories <= headers.directories.size() &&
              PE_DIRECTORIES + 8 * nDirectories <= optionalSize,
          "the program's data directory does not fit into its header");
  for (uint32_t i = 0; i < nDirectories; i++) {
    const uint32_t row = place + PE_DIRECTORIES + 8 * i;
    headers.directories[i] = {file.U32(row), file.U32(row + 4)};
  }
}

PeSection ReadSection(const ByteRange& file, uint32_t row) {
  const char* const pName = reinterpret_cast<const char*>(file.At(row, PE_SECTION_ROW));
  PeSection section = {std::string(pName, std::find(pName, pName + 8, '\0')),
                       row,
                       file.U32(row + 8),
                       file.U32(row + 12),
                       file.U32(row + 16),
                       file.U32(row + 20)};
  if (section.virtualSize == 0) section.virtualSize = section.rawSize;
  if (section.rawSize == 0) section.rawPlace = 0;
  return section;
}

void CheckMemory(const PeHeaders& headers) {
  uint64_t end = headers.headersSize;
  for (const PeSection& section : headers.sections) {
    Require(section.virtualAddress % headers.sectionAlignment == 0, "a section of the program is not aligned");
    Require(section.virtualAddress >= end, "sections of the program overlap in memory");
    end = section.VirtualEnd();
  }
  Require(end <= MOST_MEMORY, "the program's sections do not fit into memory");
}

void CheckFile(const ByteRange& file, const PeHeaders& headers) {
  std::vector<PeSection> sections = headers.sections;
  std::sort(sections.begin(), sections.end(),
            [](const PeSection& a, const PeSection& b) { return a.rawPlace < b.rawPlace; });
  uint64_t end = headers.headersSize;
  for (const PeSection& section : sections) {
    if (section.rawSize == 0) continue;
    Require(section.RawEnd() <= file.Size(), "the program is cut short: a section reaches past its end");
    Require(section.rawPlace % headers.fileAlignment == 0 && section.rawSize % headers.fileAlignment == 0,
            "a section of the program is not aligned");
    Require(section.rawPlace >= end, "sections of the program overlap in the file");
    end = section.RawEnd();
  }
}

}  // namespace

PeHeaders ReadPeHeaders(const std::vector<uint8_t>& image) {
  Require(image.size() <= UINT32_MAX, "the program is larger than 4 GB");
  const ByteRange file(image, "the program is cut short in its headers");
  const uint32_t newHeader = NewHeader(file);
  const uint32_t optional = newHeader + COFF_HEADER_SIZE;
  const uint16_t machine = file.U16(newHeader + 4), nSections = file.U16(newHeader + 6),
                 optionalSize = file.U16(newHeader + 20), magic = file.U16(optional);
  Require(magic != MAGIC_PE32_PLUS, "the program is for 64-bit Windows; 32-bit programs can be written to only");
  Require(magic == MAGIC_PE32 && machine == MACHINE_I386, "the program is not for 32-bit x86 Windows");
  Require(nSections >= 1 && nSections <= PE_MAX_SECTIONS, "the program has an impossible number of sections");
  PeHeaders headers = {};
  headers.countPlace = newHeader + 6;
  headers.tableEnd = optional + optionalSize + nSections * PE_SECTION_ROW;
  ReadOptionalHeader(file, optional, headers);
  Require(headers.headersSize >= headers.tableEnd && headers.headersSize <= file.Size(),
          "the size of the program's headers is wrong");
  ReadDirectories(file, optional, optionalSize, headers);
  for (uint32_t i = 0; i < nSections; i++)
    headers.sections.push_back(ReadSection(file, optional + optionalSize + i * PE_SECTION_ROW));
  CheckMemory(headers);
  CheckFile(file, headers);
  return headers;
}

uint32_t EndOfSections(const PeHeaders& headers) {
  uint64_t end = headers.headersSize;
  for (const PeSection& section : headers.sections) end = std::max(end, section.RawEnd());
  return static_cast<uint32_t>(end);
}
