// What is written into a program is found there, all else stays, and nothing malformed is taken.
#include <gtest/gtest.h>

#include "IconFile.h"
#include "PeVersion.h"
#include "TinyProgram.h"

namespace {

const PeVersionInfo INFO = {"Plumo", "2.1 beta", "Tavola", "", "", "Plumo-2.1-install.exe"};

// "" when it is accepted. What is refused must be as it was.
std::string Refusal(Bytes image, const Bytes& icon = {}, const PeVersionInfo& info = INFO) {
  const Bytes before = image;
  try {
    SetPeResources(image, icon, info);
  } catch (const OrbitError& error) {
    EXPECT_TRUE(image == before);
    return error.what();
  }
  return "";
}

uint32_t At32(const Bytes& bytes, size_t place) { return ByteRange(bytes, "outside").U32(place); }

uint32_t SimpleChecksum(Bytes image, size_t place) {
  Store32(image, place, 0);
  uint32_t sum = 0;
  for (size_t i = 0; i < image.size(); i += 2) {
    sum += image[i] | (i + 1 < image.size() ? image[i + 1] << 8 : 0);
    sum = (sum & 0xffff) + (sum >> 16);
  }
  return sum + static_cast<uint32_t>(image.size());
}

// The kinds of a tail: only code, resources last, relocations behind them, something unknown behind them.
TEST(PeImage, ReplacesIconsAndVersionAndKeepsTheRest) {
  for (const size_t nKind : {1, 2, 3, 4}) {
    SCOPED_TRACE(nKind);
    const size_t nSections = std::min<size_t>(nKind, 3), nAfter = nKind == 1 || nKind == 4 ? nSections + 1 : nSections,
                 nResources = nKind == 3 ? 1 : nAfter - 1;
    Bytes image = TinyProgram(nSections);
    if (nKind == 4) image[TINY_SECTIONS + 80] = '_';
    const Bytes before = image;
    for (size_t i = 0x1c; i < 0x38; i++) image[i] = static_cast<uint8_t>(i);
    SetPeResources(image, TinyIcon(), INFO);
    for (size_t i = 0x1c; i < 0x38; i++) EXPECT_EQ(image[i], i);
    const PeHeaders headers = ReadPeHeaders(image);
    ASSERT_EQ(headers.sections.size(), nAfter);
    EXPECT_EQ(headers.sections[nResources].name, ".rsrc");
    EXPECT_EQ(headers.directories[PE_RESOURCES].address, headers.sections[nResources].virtualAddress);
    EXPECT_EQ(headers.directories[PE_RESOURCES].size, headers.sections[nResources].virtualSize);
    uint32_t address = 0x1000, place = TINY_CODE;  // without gaps, as the system wants them
    for (const PeSection& section : headers.sections) {
      EXPECT_EQ(section.virtualAddress, address);
      EXPECT_EQ(section.rawPlace, place);
      address += section.virtualSize > 0x1000 ? 0x2000 : 0x1000;
      place += section.rawSize;
    }
    EXPECT_EQ(place, image.size());
    EXPECT_EQ(FindOverlay(image), image.size());
    EXPECT_EQ(At32(image, TINY_OPTIONAL + PE_IMAGE_SIZE), address);
    EXPECT_EQ(At32(image, TINY_OPTIONAL + PE_INITIALIZED_SIZE), 0x400 + image.size() - before.size());
    EXPECT_EQ(At32(image, TINY_OPTIONAL + PE_CHECKSUM), SimpleChecksum(image, PeChecksumPlace(image)));
    EXPECT_TRUE(std::equal(before.begin() + TINY_CODE, before.begin() + TINY_RESOURCES, image.begin() + TINY_CODE));
    if (nKind == 3) {
      EXPECT_EQ(headers.directories[PE_RELOCATIONS].address, headers.sections[2].virtualAddress);
      EXPECT_TRUE(std::equal(before.begin() + TINY_RELOCATIONS, before.end(), image.end() - 0x200));
    }

    ResourceTree tree = ReadResources(image, headers), old = TinyTree();
    const ResourceStep group = ById(nKind == 1 ? 1 : 7);  // the first group keeps its id
    const std::vector<IconImage> icons = ReadIconFile(TinyIcon());
    EXPECT_EQ(tree.size(), nKind == 1 ? 4u : 6u);
    EXPECT_TRUE((tree[{ById(RESOURCE_GROUP_ICON), group, ById(0)}].bytes == EncodeIconGroup(icons)));
    for (uint32_t i = 0; i < 2; i++)
      EXPECT_TRUE((tree[{ById(RESOURCE_ICON), ById(i + 1), ById(0)}].bytes == icons[i].bytes));
    EXPECT_TRUE((tree[{ById(RESOURCE_VERSION), ById(1), ById(0)}].bytes == EncodeVersion(INFO)));
    for (const ResourceWay& way : {TinyManifest(), TinyNamed()}) {
      if (nKind == 1) break;
      EXPECT_TRUE(tree[way].bytes == old[way].bytes);
      EXPECT_EQ(tree[way].codePage, old[way].codePage);
    }
    // Once more changes nothing; without an icon the icons stay.
    const Bytes once = image;
    SetPeResources(image, {}, INFO);
    EXPECT_TRUE(image == once);
  }
}

TEST(PeImage, AChecksumInPiecesIsTheSame) {
  Bytes file = TinyProgram();
  const Bytes stamp = {'r', 'S', 'F', 'X', 9, 8, 7};
  PeChecksum checksum;
  checksum.Add(file.data(), 33);
  checksum.Add(file.data() + 33, file.size() - 33);
  checksum.Add(stamp.data(), 3);
  file.insert(file.end(), stamp.begin(), stamp.begin() + 3);
  std::copy(stamp.begin(), stamp.end(), file.begin() + 0x1d);
  checksum.Patch(0x1d, stamp.data(), stamp.size());
  EXPECT_EQ(checksum.Value(), SimpleChecksum(file, TINY_OPTIONAL + PE_CHECKSUM));
}

TEST(PeImage, TheNumbersOfTheVersionAreThoseItBeginsWith) {
  const std::pair<const char*, std::array<uint32_t, 2>> rows[] = {{"2.1 beta", {0x20001, 0}},
                                                                  {"1.2.3.4.5", {0x10002, 0x30004}},
                                                                  {"65535.65536.1", {0xffff0000, 0}},
                                                                  {"20261121", {0, 0}},
                                                                  {"beta 2", {0, 0}},
                                                                  {"7..1", {0x70000, 0}},
                                                                  {"", {0, 0}},
                                                                  {"007.010.", {0x7000a, 0}}};
  for (const auto& [szVersion, numbers] : rows) {
    PeVersionInfo info = INFO;
    info.version = szVersion;
    const Bytes bytes = EncodeVersion(info);
    const ByteRange fixed = ByteRange(bytes, "").Part(40, 52, "");
    EXPECT_EQ(fixed.U32(0), 0xfeef04bd);
    for (const uint32_t place : {8, 16}) {
      EXPECT_EQ(fixed.U32(place), numbers[0]) << szVersion;
      EXPECT_EQ(fixed.U32(place + 4), numbers[1]) << szVersion;
    }
  }
}

TEST(PeImage, TextsThatCannotBeCarriedAreRefused) {
  PeVersionInfo info = INFO;
  info.publisher = "Tavola \xe8";
  EXPECT_EQ(Refusal(TinyProgram(), {}, info), "a text of the version is no UTF-8");
  info.publisher = std::string("Ta\0vola", 7);
  EXPECT_EQ(Refusal(TinyProgram(), {}, info), "a text of the version has a zero character");
  info.publisher = std::string(32000, 'a');
  EXPECT_EQ(Refusal(TinyProgram(), {}, info), "");
  for (const size_t size : {32700, 40000, 70000}) {
    info.publisher = std::string(size, 'a');
    EXPECT_EQ(Refusal(TinyProgram(), {}, info), "the texts of the version are too long");
  }
}

struct Mutation {
  size_t place;
  int nBytes;
  uint32_t value;
  const char* szRefusal;
};

std::string WithMutation(const Mutation& mutation, Bytes image, bool bIcon) {
  Store(image, mutation.place, mutation.value, mutation.nBytes);
  return bIcon ? Refusal(TinyProgram(), image) : Refusal(image);
}

TEST(PeImage, MalformedProgramsAreRefused) {
  const size_t opt = TINY_OPTIONAL, text = TINY_SECTIONS, rsrc = text + 40, reloc = text + 80, root = TINY_RESOURCES;
  const char* const szUnaligned = "a section of the program is not aligned";
  const char* const szOutside = "the program's resources reach out of their section";
  const char* const szLevels = "the program's resources are not in three levels: type, name, language";
  const Mutation mutations[] = {
      {0, 1, 'X', "the program is no Windows program: it does not begin with MZ"},
      {0x3c, 4, 0x20, "the program's new header is at an impossible place"},
      {0x3c, 4, 0x82, "the program's new header is at an impossible place"},
      {0x3c, 4, 0x7ffffffc, "the program is cut short in its headers"},
      {0x3c, 4, 0xfffffffc, "the program is cut short in its headers"},
      {TINY_HEADER, 1, 'N', "the program is no Windows program: it has no PE header"},
      {TINY_HEADER + 4, 2, 0x8664, "the program is not for 32-bit x86 Windows"},
      {opt, 2, 0x20b, "the program is for 64-bit Windows; 32-bit programs can be written to only"},
      {TINY_COUNT, 2, 0, "the program has an impossible number of sections"},
      {TINY_COUNT, 2, 97, "the program has an impossible number of sections"},
      {TINY_COUNT, 2, 90, "the size of the program's headers is wrong"},
      {opt + 60, 4, 0x100, "the size of the program's headers is wrong"},
      {opt + 60, 4, 0xffffffff, "the size of the program's headers is wrong"},
      {opt + 60, 4, 0x440, "sections of the program overlap in the file"},
      {opt + 32, 4, 0, "the program's alignments are impossible"},
      {opt + 32, 4, 0x1800, "the program's alignments are impossible"},
      {opt + 36, 4, 0x10, "the program's alignments are impossible"},
      {opt + 36, 4, 0x2000, "the program's alignments are impossible"},
      {opt + 36, 4, 0x400, szUnaligned},
      {opt + 92, 4, 4, "the program's data directory does not fit into its header"},
      {opt + 92, 4, 17, "the program's data directory does not fit into its header"},
      {TINY_HEADER + 20, 2, 216, "the program's data directory does not fit into its header"},
      {TINY_HEADER + 20, 2, 0xffff, "the size of the program's headers is wrong"},
      {text + 8, 4, 0x1001, "sections of the program overlap in memory"},
      {text + 8, 4, 0xffffffff, "sections of the program overlap in memory"},
      {text + 12, 4, 0, "sections of the program overlap in memory"},
      {text + 12, 4, 0x4000, "sections of the program overlap in memory"},
      {text + 12, 4, 0x1200, szUnaligned},
      {reloc + 12, 4, 0xfffff000, "the program's sections do not fit into memory"},
      {rsrc + 16, 4, 0x400, "sections of the program overlap in the file"},
      {rsrc + 20, 4, 0x400, "sections of the program overlap in the file"},
      {rsrc + 20, 4, 0x200, "sections of the program overlap in the file"},
      {rsrc + 20, 4, 0xfffffe00, "the program is cut short: a section reaches past its end"},
      {reloc + 16, 4, 0, "the program has something behind its last section: data, or symbols that were not stripped"},
      {TINY_DIRECTORIES + 32, 4, 0x900, "the program is signed; give it unsigned"},
      {TINY_DIRECTORIES + 16, 4, 0x5000, "the program's resources are outside its sections"},
      {TINY_DIRECTORIES + 16, 4, 0x80000000, "the program's resources are outside its sections"},
      {TINY_DIRECTORIES + 16, 4, 0x21f8, szOutside},
      {rsrc + 8, 4, 0x20, szOutside},
      {root + 14, 2, 0xffff, szLevels},
      {root + 12, 2, 0, "the program's resources are out of order"},
      {root + 12, 2, 2, "the program's resources are out of order"},
      {root + 16, 4, 0x80000ffc, szOutside},
      {root + 16, 4, 0xffffffff, szOutside},
      {root + 20, 4, 0x80000000, "the program's resources lead in a circle"},
      {root + 20, 4, 0x80000ff8, szOutside},
      {root + 20, 4, 0x38, szLevels},
      {root + 24, 4, 14, "the program has a resource twice"},
  };
  ASSERT_EQ(Refusal(TinyProgram()), "");
  for (const Mutation& mutation : mutations)
    EXPECT_EQ(WithMutation(mutation, TinyProgram(), false), mutation.szRefusal)
        << std::hex << mutation.place << " = " << mutation.value;
}

// The leaves are found by what they hold.
TEST(PeImage, LeavesThatLieAreRefused) {
  const Bytes image = TinyProgram();
  size_t leaf = TINY_RESOURCES;
  while (At32(image, leaf + 4) != 5 || At32(image, leaf + 8) != 0 || At32(image, leaf) < 0x2000) leaf += 4;
  const char* const szOutside = "the program's resources reach out of their section";
  const Mutation mutations[] = {{leaf, 4, 0x1000, szOutside},
                                {leaf, 4, 0xffffffff, szOutside},
                                {leaf, 4, 0x21fc, szOutside},
                                {leaf + 4, 4, 0x100, szOutside},
                                {leaf + 4, 4, 0xffffffff, "resources of the program overlap"}};
  for (const Mutation& mutation : mutations)
    EXPECT_EQ(WithMutation(mutation, image, false), mutation.szRefusal) << std::hex << mutation.value;
}

TEST(PeImage, MalformedIconsAreRefused) {
  const size_t row = 6, bitmap = 38, png = bitmap + 120;
  const char* const szSize = "image 1 of the icon has not the size that the icon's list says";
  const char* const szOverlap = "the icon's images overlap, or reach past its end";
  const Mutation mutations[] = {
      {0, 2, 0x4d42, "the icon is no .ico file"},
      {2, 2, 2, "the icon is no .ico file"},
      {4, 2, 0, "the icon has no image"},
      {4, 2, 0xffff, szOverlap},
      {row, 1, 3, szSize},
      {row + 1, 1, 0, szSize},
      {row + 8, 4, 119, "image 1 of the icon is cut short"},
      {row + 8, 4, 39, "image 1 of the icon is no bitmap and no PNG"},
      {row + 8, 4, 0, "image 1 of the icon is no bitmap and no PNG"},
      {row + 8, 4, 0xffffffff, szOverlap},
      {row + 12, 4, 0xffffffff, "the icon is cut short"},
      {row + 24, 4, 20, "image 2 of the icon is a PNG that is cut short"},
      {bitmap, 4, 12, "image 1 of the icon is no bitmap and no PNG"},
      {bitmap + 8, 4, 0xfffffffc, szSize},
      {bitmap + 14, 2, 5, "image 1 of the icon has an impossible number of bits for a pixel"},
      {bitmap + 14, 2, 8, "image 1 of the icon is cut short"},
      {bitmap + 16, 4, 1, "image 1 of the icon is compressed, which a bitmap in an icon cannot be"},
      {bitmap + 32, 4, 17, "image 1 of the icon has an impossible header"},
      {png + 1, 1, 'Q', "image 2 of the icon is no bitmap and no PNG"},
      {png + 8, 4, 0xffffffff, "image 2 of the icon is a PNG that is cut short"},
      {png + 12, 1, 'J', "image 2 of the icon is a PNG without its header"},
      {png + 19, 1, 2, "image 2 of the icon is a PNG that is damaged"},
  };
  ASSERT_EQ(Refusal(TinyProgram(), TinyIcon()), "");
  for (const Mutation& mutation : mutations)
    EXPECT_EQ(WithMutation(mutation, TinyIcon(), true), mutation.szRefusal)
        << mutation.place << " = " << std::hex << mutation.value;
}

// The relocations behind the resources are then not known to be any.
TEST(PeImage, AShortDataDirectoryWillDo) {
  Bytes image = TinyProgram();
  Store32(image, TINY_OPTIONAL + 92, 5);
  SetPeResources(image, {}, INFO);
  EXPECT_EQ(ReadPeHeaders(image).sections.size(), 4u);
}

TEST(PeImage, ANewSectionNeedsRoomInTheHeaders) {
  const char* const szNoRoom = "the program's headers have no room for one more section";
  const size_t table = TINY_SECTIONS + 40;
  const Mutation mutations[] = {{TINY_OPTIONAL + 60, 4, table + 39, szNoRoom},
                                {TINY_OPTIONAL + 60, 4, table + 40, ""},
                                {table + 39, 1, 1, szNoRoom}};
  for (const Mutation& mutation : mutations)
    EXPECT_EQ(WithMutation(mutation, TinyProgram(1), false), mutation.szRefusal);
}

TEST(PeImage, EveryPrefixIsRefused) {
  const Bytes image = TinyProgram(), icon = TinyIcon();
  for (size_t size = 0; size < image.size(); size++)
    EXPECT_NE(Refusal(Bytes(image.begin(), image.begin() + size)), "") << size;
  for (size_t size = 1; size < icon.size(); size++)
    EXPECT_NE(Refusal(image, Bytes(icon.begin(), icon.begin() + size)), "") << size;
}

}  // namespace
