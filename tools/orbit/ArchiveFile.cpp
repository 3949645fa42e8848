#include "ArchiveFile.h"

#include "BestGzip.h"
#include "Interrupt.h"
#include "OrbitText.h"
#include "Progress.h"
#include "archive/ArchiveWriter.h"

namespace {

const char* ReasonOf(int iResult) {
  static const char* const REASONS[] = {"",
                                        "it cannot be read",
                                        "the archive cannot be written: is the drive full?",
                                        "the archive would be larger than 4 GB",
                                        "its name cannot be carried",
                                        "there is not enough memory",
                                        "it was stopped"};
  return REASONS[iResult];
}

// Called from code that no exception may pass.
bool bShowBytes(uint32_t nBytes, void* pContext) {
  static_cast<Progress*>(pContext)->Advance(nBytes);
  return !bInterrupted();
}

}  // namespace

ArchiveTotals WriteArchive(std::vector<ProductFile>& files, const std::string& what, OutputFile& output,
                           FILE* pProgress, int iLevel) {
  uint64_t expected = 0;
  for (const ProductFile& file : files) expected += file.size;
  Progress progress(pProgress, "packing", expected);
  const std::unique_ptr<GzipMaker> pMaker = iLevel == 9 ? pMakeBestGzip() : nullptr;
  ArchiveWriter writer(output.File(), iLevel, pMaker.get());
  writer.SetProgress(bShowBytes, &progress);
  ArchiveTotals totals;
  for (ProductFile& file : files) {
    OsFile input;
    const bool bOpened = input.bOpen(file.path.c_str(), OsOpenMode::Read);
    const int iResult = bOpened ? writer.iAddFile(file.header, input) : ErrArchiveRead;
    ThrowIfInterrupted();
    if (iResult != ArchiveWritten) throw OrbitError("cannot pack " + file.shownPath + ": " + ReasonOf(iResult));
    totals.bytesIn += file.header.unpackedSize;
  }
  const int iResult = writer.iFinish();
  if (iResult != ArchiveWritten || !output.File().bClose())
    throw OrbitError("cannot pack " + what + ": " + ReasonOf(iResult ? iResult : ErrArchiveWrite));
  totals.files = files.size();
  totals.archiveBytes = writer.Size();
  return totals;
}
