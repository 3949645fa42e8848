#include "archive/GzipEntryReader.h"

#include <cstring>

namespace {
// The gzip file reader shows inflate 8192 bytes at a time and asks for 16384. Both matter to the result: a block in
// which inflate finds an error is dropped whole, so that the same blocks must be asked for to keep the same bytes.
const size_t INPUT_WINDOW = 8192;
static_assert(INPUT_WINDOW <= GzipEntryReader::OUTPUT_BLOCK, "plain data is copied a window at a time");
const int GZIP_WINDOW_BITS = 15 + 16;
}  // namespace

GzipEntryReader::~GzipEntryReader() {
  if (m_bInflateReady) inflateEnd(&m_stream);
}

bool GzipEntryReader::bStart(BlockReader& source, uint32_t storedSize) {
  if (!m_bInflateReady) m_bInflateReady = inflateInit2(&m_stream, GZIP_WINDOW_BITS) == Z_OK;
  m_stream.avail_in = 0;
  m_pSource = &source;
  m_left = storedSize;
  m_nWindow = 0;
  m_iMembers = 0;
  m_bEnd = false;
  m_result = End::Complete;
  m_pStep = &GzipEntryReader::Look;
  return m_bInflateReady;
}

size_t GzipEntryReader::Read(unsigned char* pBytes, size_t nBytes) {
  size_t nDone = 0;
  while (!m_bEnd && nBytes - nDone >= OUTPUT_BLOCK) nDone += (this->*m_pStep)(pBytes + nDone);
  return nDone;
}

// Between members: another one, plain data, or garbage to be ignored.
size_t GzipEntryReader::Look(unsigned char*) {
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

size_t GzipEntryReader::CopyBlock(unsigned char* pOut) {
  if (m_stream.avail_in == 0) TopUp();
  const size_t nBytes = m_stream.avail_in;
  if (nBytes == 0) return Finish(End::Complete);
  memcpy(pOut, m_stream.next_in, nBytes);
  m_stream.avail_in = 0;
  return nBytes;
}

size_t GzipEntryReader::InflateBlock(unsigned char* pOut) {
  m_stream.next_out = pOut;
  m_stream.avail_out = OUTPUT_BLOCK;
  int iResult = Z_OK;
  while (m_stream.avail_out && iResult != Z_STREAM_END) {
    if (m_stream.avail_in == 0) TopUp();
    if (m_stream.avail_in == 0) {
      Finish(End::Early);
      break;
    }
    iResult = inflate(&m_stream, Z_NO_FLUSH);
    // A lack of room or input ends no stream; what else fails drops the block.
    if (iResult != Z_OK && iResult != Z_STREAM_END && iResult != Z_BUF_ERROR) return Finish(End::Damaged);
  }
  if (iResult == Z_STREAM_END) {
    m_sum = static_cast<uint32_t>(m_stream.adler);  // inflate has just checked it
    m_pStep = &GzipEntryReader::Look;
  }
  return OUTPUT_BLOCK - m_stream.avail_out;
}

// Shows the stream the next bytes, together with those that it has left over.
void GzipEntryReader::TopUp() {
  const size_t nUsed = m_nWindow - m_stream.avail_in;
  m_pSource->Skip(nUsed);
  m_left -= static_cast<uint32_t>(nUsed);
  const unsigned char* pBytes;
  m_nWindow = m_pSource->Peek(m_left < INPUT_WINDOW ? m_left : INPUT_WINDOW, pBytes);
  m_stream.next_in = const_cast<Bytef*>(pBytes);
  m_stream.avail_in = static_cast<uInt>(m_nWindow);
}

size_t GzipEntryReader::Finish(End result) {
  m_bEnd = true;
  m_result = m_pSource->bFailed() ? End::Unreadable : result;
  return 0;
}
