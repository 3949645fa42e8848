#include "Pack.h"

#include <zlib.h>

#include <vector>

#include "FolderScan.h"
#include "Interrupt.h"
#include "OrbitText.h"
#include "OutputFile.h"
#include "Progress.h"
#include "SetupImage.h"
#include "archive/ArchiveWriter.h"
#include "archive/Payload.h"

namespace fs = std::filesystem;

namespace {

const size_t BLOCK = 256 * 1024;

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

// The output must replace nothing that goes into it, and must not become part of the next pack.
void CheckOutput(const PackJob& job) {
  const fs::path output = fs::weakly_canonical(fs::absolute(ToPath(job.output)));
  std::error_code ignored;
  if (!job.setup.empty() && fs::equivalent(output, ToPath(job.setup), ignored))
    throw OrbitError("the output would overwrite the setup program " + job.setup);
  for (fs::path folder = output.parent_path(); !folder.empty(); folder = folder.parent_path()) {
    if (fs::equivalent(folder, ToPath(job.folder), ignored))
      throw OrbitError("the output lies in the folder that is packed: choose another place");
    if (folder == folder.parent_path()) break;
  }
}

// Called from code that no exception may pass.
bool bShowBytes(uint32_t nBytes, void* pContext) {
  static_cast<Progress*>(pContext)->Advance(nBytes);
  return !bInterrupted();
}

uint64_t WriteArchive(std::vector<ProductFile>& files, OutputFile& output, const PackJob& job, PackSummary& summary) {
  for (const ProductFile& file : files) summary.bytesIn += file.size;
  Progress progress(job.pProgress, "packing", summary.bytesIn);
  ArchiveWriter writer(output.File(), job.iLevel);
  writer.SetProgress(bShowBytes, &progress);
  summary.bytesIn = 0;
  for (ProductFile& file : files) {
    OsFile input;
    const bool bOpened = input.bOpen(file.path.c_str(), OsOpenMode::Read);
    const int iResult = bOpened ? writer.iAddFile(file.header, input) : ErrArchiveRead;
    ThrowIfInterrupted();
    if (iResult != ArchiveWritten) throw OrbitError("cannot pack " + file.shownPath + ": " + ReasonOf(iResult));
    summary.bytesIn += file.header.unpackedSize;
  }
  const int iResult = writer.iFinish();
  if (iResult != ArchiveWritten) throw OrbitError("cannot pack " + job.folder + ": " + ReasonOf(iResult));
  summary.files = files.size();
  summary.archiveBytes = writer.Size();
  return writer.Size();
}

// Calls take(bytes, count) for every block of a file from its start.
template <class Take>
void ForEachBlock(OsFile& file, const std::string& shownPath, std::vector<unsigned char>& block, Take take) {
  if (!file.bSeek(0)) throw OrbitError("cannot read " + shownPath);
  long lRead;
  while ((lRead = file.lRead(block.data(), block.size())) > 0) {
    ThrowIfInterrupted();
    take(block.data(), static_cast<size_t>(lRead));
  }
  if (lRead < 0) throw OrbitError("cannot read " + shownPath);
}

// A zlib stream over an output file.
class PayloadStream {
 public:
  explicit PayloadStream(OutputFile& output) : m_output(output), m_block(BLOCK) {
    if (deflateInit(&m_stream, Z_DEFAULT_COMPRESSION) != Z_OK) throw OrbitError("there is not enough memory");
  }
  ~PayloadStream() { deflateEnd(&m_stream); }
  PayloadStream(const PayloadStream&) = delete;
  PayloadStream& operator=(const PayloadStream&) = delete;

  void Put(unsigned char* pBytes, size_t nBytes, int iFlush) {
    m_stream.next_in = pBytes;
    m_stream.avail_in = static_cast<uInt>(nBytes);
    do {
      m_stream.next_out = m_block.data();
      m_stream.avail_out = static_cast<uInt>(m_block.size());
      deflate(&m_stream, iFlush);
      const size_t nOut = m_block.size() - m_stream.avail_out;
      m_output.Write(m_block.data(), nOut);
      m_size += nOut;
    } while (m_stream.avail_out == 0);
  }
  uint64_t Size() const { return m_size; }

 private:
  OutputFile& m_output;
  std::vector<unsigned char> m_block;
  z_stream m_stream = {};
  uint64_t m_size = 0;
};

// Setup program, payload, and last the stamp that makes the payload known.
void WriteSetup(OsFile& setup, OutputFile& archive, OutputFile& output, const PackJob& job, PackSummary& summary) {
  std::vector<unsigned char> block(BLOCK);
  uint64_t offset = 0;
  ForEachBlock(setup, job.setup, block, [&](unsigned char* pBytes, size_t nBytes) {
    output.Write(pBytes, nBytes);
    offset += nBytes;
  });
  OsFile input;
  if (!archive.File().bClose() || !input.bOpen(archive.TemporaryPath().c_str(), OsOpenMode::Read))
    throw OrbitError("cannot read the product archive back");
  Progress progress(job.pProgress, "compressing", summary.archiveBytes);
  PayloadStream payload(output);
  ForEachBlock(input, "the product archive", block, [&](unsigned char* pBytes, size_t nBytes) {
    payload.Put(pBytes, nBytes, Z_NO_FLUSH);
    progress.Advance(nBytes);
  });
  payload.Put(nullptr, 0, Z_FINISH);
  summary.bytesOut = offset + payload.Size();
  if (summary.bytesOut > UINT32_MAX) throw OrbitError(job.output + " would be larger than 4 GB");
  unsigned char stamp[SFX_STAMP_SIZE];
  EncodeSfxStamp({static_cast<uint32_t>(offset), static_cast<uint32_t>(payload.Size())}, stamp);
  if (!output.File().bSeek(SFX_STAMP_OFFSET)) throw OrbitError("cannot write " + job.output);
  output.Write(stamp, sizeof stamp);
}

}  // namespace

PackSummary Pack(const PackJob& job) {
  PackSummary summary;
  OsFile setup;
  if (!job.setup.empty()) OpenSetup(job.setup, setup);
  std::vector<ProductFile> files = ScanFolder(job.folder);
  CheckOutput(job);
  OutputFile archive(job.output);
  summary.bytesOut = WriteArchive(files, archive, job, summary);
  if (job.setup.empty()) {
    archive.Commit("");
    return summary;
  }
  OutputFile output(job.output);
  WriteSetup(setup, archive, output, job, summary);
  output.Commit(job.setup);
  return summary;
}
