#include "PackedFile.h"

#include <algorithm>
#include <vector>

#include "Interrupt.h"
#include "OrbitText.h"
#include "OutputFile.h"
#include "PeImage.h"

namespace {

// An image whose sections cannot be told has nothing known behind them.
uint32_t BundleOf(OsFile& file, uint32_t payloadOffset) {
  std::vector<uint8_t> front(payloadOffset);
  if (!file.bSeek(0) || file.lRead(front.data(), front.size()) != static_cast<long>(front.size())) return payloadOffset;
  try {
    return std::min(FindOverlay(front), payloadOffset);
  } catch (const OrbitError&) {
    return payloadOffset;
  }
}

}  // namespace

PackedFile::PackedFile(const std::string& path) {
  if (!m_file.bOpen(SystemPath(path).c_str(), OsOpenMode::Read)) throw OrbitError("cannot open " + path);
  if (!bReadSfxStamp(m_file, m_stamp)) throw OrbitError(path + " is not stamped");
  const uint64_t end = static_cast<uint64_t>(m_stamp.payloadOffset) + m_stamp.payloadLength;
  m_bHolds = end <= static_cast<uint64_t>(m_file.Size());
  m_bundle = m_bHolds ? BundleOf(m_file, m_stamp.payloadOffset) : m_stamp.payloadOffset;
}

bool PackedFile::bCopyBundle(OsFile& output) {
  std::vector<unsigned char> block(BundleSize());
  return m_file.bSeek(m_bundle) && m_file.lRead(block.data(), block.size()) == static_cast<long>(block.size()) &&
         output.bWrite(block.data(), block.size()) && output.bClose();
}

bool PackedFile::bExpandPayload(OsFile& output, uint32_t& size) {
  SfxStreamParams params;
  params.pInput = &m_file;
  params.pOutput = &output;
  params.payloadLength = m_stamp.payloadLength;
  const bool bExpanded = m_file.bSeek(m_stamp.payloadOffset) && ExpandStream(params) == 0 && output.bClose();
  size = params.total;
  ThrowIfInterrupted();
  return bExpanded;
}

void TakeOutArchive(const std::string& packed, const std::string& output) {
  PackedFile file(packed);
  CheckOutput(output, "", {packed});
  OutputFile archive(output);
  uint32_t size = 0;
  if (!file.bHolds() || !file.bExpandPayload(archive.File(), size))
    throw OrbitError("the payload of " + packed + " cannot be expanded: it is damaged, or there is no room for it");
  archive.Commit("");
}
