// The headers of a program for 32-bit x86, read from untrusted bytes.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "PeBytes.h"

struct PeSection {
  std::string name;
  uint32_t headerPlace;  // of its row in the section table
  uint32_t virtualSize;  // as it says, or else the raw size
  uint32_t virtualAddress;
  uint32_t rawSize;
  uint32_t rawPlace;  // in the file

  uint64_t VirtualEnd() const { return uint64_t{virtualAddress} + virtualSize; }
  uint64_t RawEnd() const { return uint64_t{rawPlace} + rawSize; }
  bool bHolds(uint32_t address) const { return address >= virtualAddress && address < VirtualEnd(); }
};

struct PeDirectory {
  uint32_t address;
  uint32_t size;
};

// The rows of the data directory that matter here.
const size_t PE_RESOURCES = 2;
const size_t PE_SIGNATURE = 4;  // its address is a place in the file
const size_t PE_RELOCATIONS = 5;

struct PeHeaders {
  uint32_t countPlace;     // of the number of sections
  uint32_t optionalPlace;  // of the optional header, whose fields are at PE_...
  uint32_t tableEnd;       // of the section table
  uint32_t sectionAlignment;
  uint32_t fileAlignment;
  uint32_t headersSize;
  uint32_t entryPoint;
  std::array<PeDirectory, 16> directories;  // zeros behind those that it has
  std::vector<PeSection> sections;          // at least one, in the order of their addresses
};

// Offsets in the optional header.
const uint32_t PE_INITIALIZED_SIZE = 8;
const uint32_t PE_IMAGE_SIZE = 56;
const uint32_t PE_CHECKSUM = 64;
const uint32_t PE_DIRECTORIES = 96;

const size_t PE_MAX_SECTIONS = 96;
const uint32_t PE_SECTION_ROW = 40;

// Checked: every length and place is inside the file, sections overlap neither each other nor the headers, in the file
// as in memory, and keep the alignments. Throws OrbitError.
PeHeaders ReadPeHeaders(const std::vector<uint8_t>& image);

// The end of the raw data that is last in the file; the headers' end when no section has any.
uint32_t EndOfSections(const PeHeaders& headers);
