#include "SfxFile.h"

#include <zlib.h>

#include <algorithm>

#include "Interrupt.h"
#include "OrbitText.h"
#include "Progress.h"
#include "archive/BlockReader.h"
#include "archive/Payload.h"

namespace {

const size_t BLOCK = 256 * 1024;

// A zlib stream over a file. It stores only: the archive's contents are compressed already, and setup expands what is
// only stored in half the time.
class PayloadStream {
 public:
  explicit PayloadStream(SfxFile& output) : m_output(output), m_block(BLOCK) {
    if (deflateInit(&m_stream, Z_NO_COMPRESSION) != Z_OK) throw OrbitError("there is not enough memory");
  }
  ~PayloadStream() { deflateEnd(&m_stream); }
  PayloadStream(const PayloadStream&) = delete;
  PayloadStream& operator=(const PayloadStream&) = delete;

  void Put(const unsigned char* pBytes, size_t nBytes, int iFlush) {
    m_stream.next_in = const_cast<unsigned char*>(pBytes);
    m_stream.avail_in = static_cast<uInt>(nBytes);
    do {
      m_stream.next_out = m_block.data();
      m_stream.avail_out = static_cast<uInt>(m_block.size());
      deflate(&m_stream, iFlush);
      m_output.Put(m_block.data(), m_block.size() - m_stream.avail_out);
    } while (m_stream.avail_out == 0);
  }

 private:
  SfxFile& m_output;
  std::vector<unsigned char> m_block;
  z_stream m_stream = {};
};

}  // namespace

void ForEachBlock(OsFile& file, const std::string& shownPath,
                  const std::function<void(const unsigned char*, size_t)>& take) {
  std::vector<unsigned char> block(BLOCK);
  if (!file.bSeek(0)) throw OrbitError("cannot read " + shownPath);
  long lRead;
  while ((lRead = file.lRead(block.data(), block.size())) > 0) {
    ThrowIfInterrupted();
    take(block.data(), static_cast<size_t>(lRead));
  }
  if (lRead < 0) throw OrbitError("cannot read " + shownPath);
}

void SfxFile::Put(const unsigned char* pBytes, size_t nBytes) {
  m_output.Write(pBytes, nBytes);
  if (m_checksumPlace) m_checksum.Add(pBytes, nBytes);
  m_size += nBytes;
}

void SfxFile::PutImage(std::vector<uint8_t> image) {
  m_checksumPlace = PeChecksumPlace(image);
  std::fill_n(image.begin() + *m_checksumPlace, 4, uint8_t{0});  // as the sum wants it
  Put(image.data(), image.size());
}

void SfxFile::PutFile(const std::string& path, const std::string& shownPath) {
  OsFile file;
  if (!file.bOpen(path.c_str(), OsOpenMode::Read)) throw OrbitError("cannot read " + shownPath);
  ForEachBlock(file, shownPath, [this](const unsigned char* pBytes, size_t nBytes) { Put(pBytes, nBytes); });
}

void SfxFile::PutPayload(const std::string& archivePath, uint64_t archiveBytes, FILE* pProgress) {
  OsFile file;
  if (!file.bOpen(archivePath.c_str(), OsOpenMode::Read)) throw OrbitError("cannot read the product archive back");
  m_payload = m_size;
  Progress progress(pProgress, "compressing", archiveBytes);
  PayloadStream payload(*this);
  ForEachBlock(file, "the product archive", [&](const unsigned char* pBytes, size_t nBytes) {
    payload.Put(pBytes, nBytes, Z_NO_FLUSH);
    progress.Advance(nBytes);
  });
  payload.Put(nullptr, 0, Z_FINISH);
}

void SfxFile::WriteAt(uint64_t place, const unsigned char* pBytes, size_t nBytes) {
  if (!m_output.File().bSeek(place)) throw OrbitError("cannot write " + m_name);
  m_output.Write(pBytes, nBytes);
}

void SfxFile::Finish() {
  if (m_size > UINT32_MAX) throw OrbitError(m_name + " would be larger than 4 GB");
  unsigned char stamp[SFX_STAMP_SIZE], checksum[4];
  EncodeSfxStamp({static_cast<uint32_t>(m_payload), static_cast<uint32_t>(PayloadSize())}, stamp);
  WriteAt(SFX_STAMP_OFFSET, stamp, sizeof stamp);
  if (!m_checksumPlace) return;
  m_checksum.Patch(SFX_STAMP_OFFSET, stamp, sizeof stamp);
  StoreLittleEndian32(checksum, m_checksum.Value());
  WriteAt(*m_checksumPlace, checksum, sizeof checksum);
}
