#include "SampleProduct.h"

#include <vector>

#include "archive/ArchiveWriter.h"

namespace {

const int LEVEL = 1;  // quick to make; what it costs to inflate is much the same at every level

// Runs of words and runs of noise, a few hundred bytes each.
void Fill(std::vector<unsigned char>& block, SampleNoise& noise) {
  static const char WORDS[] = "setup copies the files of the product into the folder that was chosen on page three ";
  for (size_t at = 0; at < block.size();) {
    const uint32_t kind = noise.Next();
    for (size_t n = 100 + kind % 400; n > 0 && at < block.size(); n--, at++)
      block[at] =
          static_cast<unsigned char>(kind & 0x10000 ? noise.Next() >> 11 : WORDS[(kind + n) % (sizeof WORDS - 1)]);
  }
}

bool bWriteScratch(OsFile& file, const std::string& path, uint64_t bytes, SampleNoise& noise) {
  if (!file.bOpen(path.c_str(), OsOpenMode::Create)) return false;
  std::vector<unsigned char> block(64 * 1024);
  for (; bytes > 0; bytes -= block.size()) {
    if (bytes < block.size()) block.resize(static_cast<size_t>(bytes));
    Fill(block, noise);
    if (!file.bWrite(block.data(), block.size())) return false;
  }
  return file.bClose() && file.bOpen(path.c_str(), OsOpenMode::Read);
}

bool bAddFiles(ArchiveWriter& writer, const std::string& scratchPath, const SampleSize& size) {
  for (int i = 0; i < size.files; i++) {
    SampleNoise noise(static_cast<uint32_t>(i));
    OsFile scratch;
    if (!bWriteScratch(scratch, scratchPath, SampleFileSize(size, i, noise), noise)) return false;
    ArchiveEntryHeader header;
    header.csName.Printf("bench", "name", "folder%d\\part%d\\file%d.dat", i / 100, i / 25 % 4, i);
    header.creationTimeHigh = header.lastAccessTimeHigh = header.lastWriteTimeHigh = 0x01d00000;
    header.attributes = OS_ARCHIVE;
    if (writer.iAddFile(header, scratch) != ArchiveWritten) return false;
  }
  return writer.iFinish() == ArchiveWritten;
}

}  // namespace

uint64_t SampleFileSize(const SampleSize& size, int iFile, SampleNoise& noise) {
  const uint64_t tens = static_cast<uint64_t>(size.files + 9) / 10;
  const int iPlace = iFile % 10;
  const uint64_t share = iPlace < 8    ? size.bytes / 80
                         : iPlace == 8 ? size.bytes / 4
                                       : size.bytes - size.bytes / 10 - size.bytes / 4;
  return share / tens * (512 + noise.Next() % 1024) / 1024;
}

bool bMakeSampleProduct(const std::string& path, const SampleSize& size) {
  OsFile output;
  if (!output.bOpen(path.c_str(), OsOpenMode::Create)) return false;
  const std::string scratch = path + ".scratch";
  ArchiveWriter writer(output, LEVEL);
  const bool bMade = bAddFiles(writer, scratch, size);
  bOsDeleteFile(scratch.c_str());
  return bMade && output.bClose();
}
