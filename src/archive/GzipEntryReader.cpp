#include "archive/GzipEntryReader.h"

#include <cstring>

namespace {
// The gzip file reader shows inflate 8192 bytes at a time and asks for 16384. Both matter to the result: a block in
// which inflate finds an error is dropped whole, so that the same blocks must be asked for to keep the same bytes.
const size_t EXACT_WINDOW = 8192;
// Bigger ones are a fifth faster and make no difference as long as there is no error. When one shows, the entry is read
// once more in the exact way: what has been given already comes out the same, as the exact windows' ends are among
// those of the big ones.
const size_t QUICK_WINDOW = 8 * EXACT_WINDOW;
static_assert(QUICK_WINDOW <= BlockReader::BLOCK_SIZE, "a window must fit into the source's block");
const int GZIP_WINDOW_BITS = 15 + 16;
}  // namespace

GzipEntryReader::~GzipEntryReader() {
  if (m_bInflateReady) inflateEnd(&m_stream);
}

bool GzipEntryReader::bStart(BlockReader& source, uint32_t storedSize) {
  if (!m_bInflateReady) m_bInflateReady = inflateInit2(&m_stream, GZIP_WINDOW_BITS) == Z_OK;
  m_pSource = &source;
  m_start = source.Position();
  m_storedSize = storedSize;
  m_given = m_again = 0;
  m_bExact = false;
  m_bEnd = false;
  m_result = End::Complete;
  Begin();
  return m_bInflateReady;
}

void GzipEntryReader::Begin() {
  m_left = m_storedSize;
  m_nWindow = 0;
  m_iMembers = 0;
  m_stream.avail_in = 0;
  m_pStep = &GzipEntryReader::Look;
}

size_t GzipEntryReader::Read(unsigned char* pBytes, size_t nBytes) {
  size_t nDone = 0;
  while (!m_bEnd && nBytes - nDone >= OUTPUT_BLOCK) {
    size_t nGot = (this->*m_pStep)(pBytes + nDone, (nBytes - nDone) / OUTPUT_BLOCK * OUTPUT_BLOCK);
    const size_t nAgain = m_again < nGot ? static_cast<size_t>(m_again) : nGot;
    m_again -= nAgain;
    nGot -= nAgain;
    if (nAgain && nGot) memmove(pBytes + nDone, pBytes + nDone + nAgain, nGot);
    m_given += nGot;
    nDone += nGot;
  }
  return nDone;
}

// After an error: from the entry's first byte in the exact way, unless it was so already. What has been given is passed
// over.
bool GzipEntryReader::bStartsOver() {
  if (m_bExact || m_pSource->bFailed()) return false;
  m_pSource->SeekTo(m_start);
  m_again = m_given;
  m_given = 0;
  m_bExact = true;
  Begin();
  return true;
}

// Between members: another one, plain data, or garbage to be ignored.
size_t GzipEntryReader::Look(unsigned char*, size_t) {
  if (m_stream.avail_in < 2) TopUp();
  if (m_stream.avail_in == 0) return Finish(End::Complete);
  if (m_stream.avail_in > 1 && m_stream.next_in[0] == 0x1f && m_stream.next_in[1] == 0x8b) {
    inflateReset(&m_stream);
    m_iMembers++;
    m_pStep = &GzipEntryReader::InflateBlock;
    return 0;
  }
  if (m_iMembers) return Finish(End::Complete);
  m_pStep = &GzipEntryReader::CopyBlock;
  return 0;
}

size_t GzipEntryReader::CopyBlock(unsigned char* pOut, size_t nRoom) {
  if (m_stream.avail_in == 0) TopUp();
  const size_t nBytes = m_stream.avail_in < nRoom ? m_stream.avail_in : nRoom;
  if (nBytes == 0) return Finish(End::Complete);
  memcpy(pOut, m_stream.next_in, nBytes);
  m_stream.next_in += nBytes;
  m_stream.avail_in -= static_cast<uInt>(nBytes);
  return nBytes;
}

size_t GzipEntryReader::InflateBlock(unsigned char* pOut, size_t nRoom) {
  const size_t nBlock = m_bExact ? OUTPUT_BLOCK : nRoom;
  m_stream.next_out = pOut;
  m_stream.avail_out = static_cast<uInt>(nBlock);
  int iResult = Z_OK;
  while (m_stream.avail_out && iResult != Z_STREAM_END) {
    if (m_stream.avail_in == 0) TopUp();
    if (m_stream.avail_in == 0 && bStartsOver()) return 0;
    if (m_stream.avail_in == 0) {
      Finish(End::Early);
      break;
    }
    iResult = inflate(&m_stream, Z_NO_FLUSH);
    // A lack of room or input ends no stream; what else fails drops the block.
    if (iResult != Z_OK && iResult != Z_STREAM_END && iResult != Z_BUF_ERROR)
      return bStartsOver() ? 0 : Finish(End::Damaged);
  }
  if (iResult == Z_STREAM_END) {
    AddSum();
    m_pStep = &GzipEntryReader::Look;
  }
  return nBlock - m_stream.avail_out;
}

// inflate has just checked the member's CRC. Of a second member beyond 2 GB, which only a hostile archive has, the
// library cannot tell what it makes of the first.
void GzipEntryReader::AddSum() {
  const bool bJoins = m_iMembers > 1 && m_stream.total_out <= INT32_MAX;
  m_sum = static_cast<uint32_t>(bJoins ? crc32_combine(m_sum, m_stream.adler, static_cast<z_off_t>(m_stream.total_out))
                                       : m_stream.adler);
}

// Shows the stream the next bytes, together with those that it has left over.
void GzipEntryReader::TopUp() {
  const size_t nUsed = m_nWindow - m_stream.avail_in;
  m_pSource->Skip(nUsed);
  m_left -= static_cast<uint32_t>(nUsed);
  const unsigned char* pBytes;
  const size_t nWindow = m_bExact ? EXACT_WINDOW : QUICK_WINDOW;
  m_nWindow = m_pSource->Peek(m_left < nWindow ? m_left : nWindow, pBytes);
  m_stream.next_in = const_cast<Bytef*>(pBytes);
  m_stream.avail_in = static_cast<uInt>(m_nWindow);
}

size_t GzipEntryReader::Finish(End result) {
  m_bEnd = true;
  m_result = m_pSource->bFailed() ? End::Unreadable : result;
  return 0;
}
