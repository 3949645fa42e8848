#include "List.h"

#include <chrono>
#include <vector>

#include "Interrupt.h"
#include "OrbitText.h"
#include "PackedFile.h"
#include "SetupImage.h"
#include "archive/ArchiveWalk.h"
#include "archive/CNArchive.h"
#include "archive/EntryExtractor.h"
#include "archive/GzipEntryReader.h"
#include "archive/PathGuard.h"

namespace {

// A file in the system's folder for temporary files, removed at the end.
class TemporaryFile {
 public:
  TemporaryFile() {
    CNString csFolder;
    if (!bOsGetTempFolder(csFolder) || !bOsMakeTempFile(csFolder.Text(), "orb", m_csPath))
      throw OrbitError("cannot create a temporary file");
  }
  ~TemporaryFile() { bOsDeleteFile(m_csPath.Text()); }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;
  const char* Path() const { return m_csPath.Text(); }

 private:
  CNString m_csPath;
};

// The upper half of a file time, as far as it is known: to some seven minutes.
std::string ShownTime(uint32_t timeHigh) {
  using namespace std::chrono;
  const int64_t UNIX_EPOCH_SECONDS = 11644473600;
  const int64_t seconds = static_cast<int64_t>((static_cast<uint64_t>(timeHigh) << 32) / 10000000) - UNIX_EPOCH_SECONDS;
  const sys_seconds time{std::chrono::seconds(seconds)};
  if (!timeHigh) return "                ";  // none
  if (time >= sys_days(year(10000) / January / 1)) return "after 9999      ";
  const sys_days day = floor<days>(time);
  const year_month_day date(day);
  const int iMinutes = static_cast<int>(duration_cast<minutes>(time - day).count());
  char text[32];
  std::snprintf(text, sizeof text, "%04d-%02u-%02u %02d:%02d", static_cast<int>(date.year()),
                static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()), iMinutes / 60, iMinutes % 60);
  return text;
}

std::string ShownAttributes(uint32_t attributes) {
  std::string text = "----";
  const struct {
    uint32_t bit;
    char letter;
  } BITS[] = {{OS_READ_ONLY, 'R'}, {OS_HIDDEN, 'H'}, {OS_SYSTEM, 'S'}, {OS_ARCHIVE, 'A'}};
  for (size_t i = 0; i < 4; i++)
    if (attributes & BITS[i].bit) text[i] = BITS[i].letter;
  return text;
}

class Listing {
 public:
  Listing(FILE* pOut, FILE* pProblems) : m_pOut(pOut), m_pProblems(pProblems), m_buffer(256 * 1024) {}

  void Stamped(const std::string& path);
  void Archive(const std::string& shownPath, const char* szPath);
  int Problems() const { return m_iProblems; }

 private:
  void Problem(const std::string& text) {
    m_iProblems++;
    std::fprintf(m_pProblems, "%s\n", text.c_str());
  }
  void Bundle(const std::string& path, PackedFile& file);
  void Entry(const ArchiveEntryHeader& entry, BlockReader& data);
  void Totals(uint64_t files, uint64_t unpacked, uint64_t stored, bool bGood);

  FILE* m_pOut;
  FILE* m_pProblems;
  std::vector<unsigned char> m_buffer;
  GzipEntryReader m_reader;
  int m_iProblems = 0;
};

void Listing::Stamped(const std::string& path) {
  PackedFile file(path);
  const SfxStamp& stamp = file.Stamp();
  std::fprintf(m_pOut, "stamp: payload at %u, %u bytes\n", stamp.payloadOffset, stamp.payloadLength);
  if (!file.bHolds()) return Problem("the stamp points past the end of " + path);
  if (file.BundleSize() > 0) Bundle(path, file);
  TemporaryFile archive;
  OsFile output;
  if (!output.bOpen(archive.Path(), OsOpenMode::Truncate)) throw OrbitError("cannot expand the payload of " + path);
  uint32_t size = 0;
  if (!file.bExpandPayload(output, size))
    return Problem("the payload of " + path + " cannot be expanded: it is damaged, or there is no room for it");
  std::fprintf(m_pOut, "product archive: %u bytes\n", size);
  Archive("the product archive of " + path, archive.Path());
}

void Listing::Bundle(const std::string& path, PackedFile& file) {
  std::fprintf(m_pOut, "bundle: at %u, %u bytes\n", file.BundleOffset(), file.BundleSize());
  TemporaryFile archive;
  OsFile output;
  if (!output.bOpen(archive.Path(), OsOpenMode::Truncate) || !file.bCopyBundle(output))
    throw OrbitError("cannot copy the bundle of " + path + " into the folder for temporary files: is the drive full?");
  Archive("the bundle of " + path, archive.Path());
  std::fputs("\n", m_pOut);
}

void Listing::Archive(const std::string& shownPath, const char* szPath) {
  const int iBefore = m_iProblems;
  const int iCheck = CNArchive(szPath).CheckArchive();
  if (iCheck == ErrZipFileNotFound) throw OrbitError("cannot open " + shownPath);
  if (iCheck != ArchiveOk) Problem("the check value of " + shownPath + " does not match");
  ArchiveWalk walk;
  if (!walk.bOpen(szPath)) throw OrbitError("cannot open " + shownPath);
  std::fprintf(m_pOut, "%10s %10s  attr  %-16s  name\n", "unpacked", "stored", "written (UTC)");
  ArchiveEntryHeader entry;
  ArchiveWalk::Step step;
  uint64_t unpacked = 0, stored = 0;
  while ((step = walk.Next(entry)) == ArchiveWalk::Step::Entry) {
    unpacked += entry.unpackedSize;
    stored += entry.storedSize;
    Entry(entry, walk.Data());
  }
  if (step == ArchiveWalk::Step::Damaged) Problem("the entries of " + shownPath + " are damaged");
  Totals(static_cast<uint64_t>(walk.NextIndex()), unpacked, stored, m_iProblems == iBefore);
}

void Listing::Entry(const ArchiveEntryHeader& entry, BlockReader& data) {
  const std::string name = ToUtf8(csNameForLog(entry.csName).Text());
  std::fprintf(m_pOut, "%10u %10u  %s  %s  %s\n", entry.unpackedSize, entry.storedSize,
               ShownAttributes(entry.attributes).c_str(), ShownTime(entry.lastWriteTimeHigh).c_str(), name.c_str());
  CNString csSafe;
  if (!bMakeSafePath(entry.csName.Text(), csSafe) || csSafe.Length() != entry.csName.Length())
    Problem(name + ": the name is unsafe, extraction refuses it");
  if (!m_reader.bStart(data, entry.storedSize)) throw OrbitError("there is not enough memory");
  uint64_t size = 0;
  while (const size_t nBytes = m_reader.Read(m_buffer.data(), m_buffer.size())) {
    ThrowIfInterrupted();
    size += nBytes;
  }
  if (m_reader.Result() == GzipEntryReader::End::Early) Problem(name + ": the data ends early");
  if (m_reader.Result() == GzipEntryReader::End::Damaged) Problem(name + ": the data is damaged");
  if (m_reader.Result() == GzipEntryReader::End::Unreadable) Problem(name + ": the data cannot be read");
  if (size != entry.unpackedSize)
    Problem(name + ": holds " + std::to_string(size) + " bytes, not " + std::to_string(entry.unpackedSize));
}

void Listing::Totals(uint64_t files, uint64_t unpacked, uint64_t stored, bool bGood) {
  std::fprintf(m_pOut, "%s files, %s bytes unpacked, %s bytes stored: %s\n", std::to_string(files).c_str(),
               std::to_string(unpacked).c_str(), std::to_string(stored).c_str(),
               bGood ? "everything verified" : "NOT GOOD, see the problems reported");
}

}  // namespace

int List(const std::string& path, FILE* pOut, FILE* pProblems) {
  OsFile file;
  const std::string systemPath = SystemPath(path);
  if (!file.bOpen(systemPath.c_str(), OsOpenMode::Read)) throw OrbitError("cannot open " + path);
  Listing listing(pOut, pProblems);
  const ImageKind kind = KindOfImage(file);
  if (kind == ImageKind::Stamped) {
    listing.Stamped(path);
    return listing.Problems();
  }
  // An archive may have anything in front of its first entry, a program too.
  if (kind != ImageKind::NotExecutable && CNArchive(systemPath.c_str()).CheckArchive() != ArchiveOk)
    throw OrbitError(path + " is a program without a stamp");
  listing.Archive(path, systemPath.c_str());
  return listing.Problems();
}
