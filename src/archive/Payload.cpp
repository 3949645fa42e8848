#include "archive/Payload.h"

#include <zlib.h>

#include <cstring>
#include <memory>
#include <new>

#include "archive/BlockReader.h"
#include "foundation/Log.h"

namespace {

const size_t OFFSET_FIELD = 16;  // within the stamp
const size_t LENGTH_FIELD = 20;

// One run of the expander. Files are read and written in blocks of many chunks: the stream is cheap to feed, the system
// is not.
class Expansion {
 public:
  explicit Expansion(SfxStreamParams& params)
      : m_params(params),
        m_nBlock(params.chunkSize < IO_BLOCK ? IO_BLOCK / params.chunkSize * params.chunkSize : params.chunkSize),
        m_pIn(new (std::nothrow) unsigned char[m_nBlock]),
        m_pOut(new (std::nothrow) unsigned char[m_nBlock]),
        m_left(params.payloadLength ? params.payloadLength : UINT32_MAX) {
    m_bReady = m_pIn && m_pOut && inflateInit(&m_stream) == Z_OK;
  }
  ~Expansion() {
    if (m_bReady) inflateEnd(&m_stream);
  }
  Expansion(const Expansion&) = delete;
  Expansion& operator=(const Expansion&) = delete;

  int iRun() {
    if (!m_bReady) return iLogReturn(1, "ERROR: ExpandStream -> !bReady -> return 1");
    int iZlib = Z_OK;
    while (iZlib == Z_OK) {
      const bool bRead = m_stream.avail_in > 0 || bReadBlock();
      if (bRead) iZlib = iInflateChunk();
      const bool bFull = m_nBlock - m_nHeld < m_params.chunkSize;
      if ((bFull || !bRead || iZlib != Z_OK) && !bWriteBlock())
        return iLogReturn(1, "ERROR: ExpandStream -> !bWrite -> return 1");
      if (!bRead) return iLogReturn(1, "ERROR: ExpandStream -> !lRead -> return 1");
    }
    if (iZlib == Z_STREAM_END) return 0;
    return iLogReturn(1, "ERROR: ExpandStream -> inflate = %d after %u bytes (adler32 %x) -> return 1", iZlib,
                      m_params.total, static_cast<unsigned>(m_stream.adler));
  }

 private:
  static const uint32_t IO_BLOCK = 256 * 1024;

  // At the end of the file there is nothing to show; inflate then says that it cannot go on.
  bool bReadBlock() {
    const uint32_t nWanted = m_left < m_nBlock ? m_left : m_nBlock;
    const long lRead = nWanted ? m_params.pInput->lRead(m_pIn.get(), nWanted) : 0;
    if (lRead < 0) return false;
    m_left -= static_cast<uint32_t>(lRead);
    m_stream.next_in = m_pIn.get();
    m_stream.avail_in = static_cast<uInt>(lRead);
    return true;
  }

  // inflate keeps the running Adler-32 of what it gives, in m_stream.adler.
  int iInflateChunk() {
    m_stream.next_out = m_pOut.get() + m_nHeld;
    m_stream.avail_out = m_params.chunkSize;
    const int iZlib = inflate(&m_stream, Z_SYNC_FLUSH);
    m_nHeld += m_params.chunkSize - m_stream.avail_out;
    if (m_params.pProgress) m_params.pProgress(m_params.total + m_nHeld);
    return iZlib;
  }

  bool bWriteBlock() {
    if (m_nHeld && !m_params.pOutput->bWrite(m_pOut.get(), m_nHeld)) return false;
    m_params.total += m_nHeld;
    m_nHeld = 0;
    return true;
  }

  SfxStreamParams& m_params;
  const uint32_t m_nBlock;
  std::unique_ptr<unsigned char[]> m_pIn;
  std::unique_ptr<unsigned char[]> m_pOut;
  uint32_t m_nHeld = 0;  // bytes in m_pOut that are not written yet
  uint32_t m_left;
  z_stream m_stream = {};
  bool m_bReady = false;
};

}  // namespace

bool bReadSfxStamp(OsFile& file, SfxStamp& stamp) {
  unsigned char bytes[SFX_STAMP_SIZE];
  if (!file.bSeek(SFX_STAMP_OFFSET)) return false;
  for (long lDone = 0; lDone < SFX_STAMP_SIZE;) {
    const long lRead = file.lRead(bytes + lDone, static_cast<size_t>(SFX_STAMP_SIZE - lDone));
    if (lRead <= 0) return false;
    lDone += lRead;
  }
  if (LittleEndian32(bytes) != SFX_MAGIC) return false;
  stamp.payloadOffset = LittleEndian32(bytes + OFFSET_FIELD);
  stamp.payloadLength = LittleEndian32(bytes + LENGTH_FIELD);
  return true;
}

void EncodeSfxStamp(const SfxStamp& stamp, unsigned char* pBytes) {
  memset(pBytes, 0, SFX_STAMP_SIZE);
  StoreLittleEndian32(pBytes, SFX_MAGIC);
  StoreLittleEndian32(pBytes + OFFSET_FIELD, stamp.payloadOffset);
  StoreLittleEndian32(pBytes + LENGTH_FIELD, stamp.payloadLength);
}

int ExpandStream(SfxStreamParams& params) {
  params.total = 0;
  if (!params.pInput || !params.pOutput || !params.chunkSize)
    return iLogReturn(1, "ERROR: ExpandStream -> !pInput || !pOutput || !chunkSize -> return 1");
  return Expansion(params).iRun();
}
