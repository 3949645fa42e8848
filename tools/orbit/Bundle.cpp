#include "Bundle.h"

#include <list>

#include "OrbitText.h"

namespace {

class Entries {
 public:
  // Contents in memory go through temporary files beside the output.
  explicit Entries(std::string beside) : m_beside(std::move(beside)) {}

  void Add(const std::string& name, const void* pBytes, size_t nBytes) {
    OutputFile& scratch = m_scratch.emplace_back(m_beside);
    scratch.Write(pBytes, nBytes);
    if (!scratch.File().bClose()) throw OrbitError("cannot write " + m_beside + ": is the drive full?");
    ProductFile file;
    file.path = scratch.TemporaryPath();
    file.shownPath = ToUtf8(name.c_str());
    file.size = nBytes;
    Add(name, std::move(file));
  }

  void Add(const std::string& name, ProductFile file) {
    file.header = ArchiveEntryHeader();
    file.header.csName = name.c_str();
    file.header.attributes = OS_ARCHIVE;
    m_files.push_back(std::move(file));
  }

  std::vector<ProductFile>& Sorted() {
    SortByName(m_files);
    return m_files;
  }

 private:
  std::string m_beside;
  std::list<OutputFile> m_scratch;
  std::vector<ProductFile> m_files;
};

}  // namespace

ArchiveTotals WriteBundle(const BundleContent& content, OutputFile& output) {
  Entries entries(output.Path());
  const std::string pictures = BUNDLE_PICTURES;
  if (!content.pictures.empty())
    for (ProductFile& file : ScanFolder(content.pictures)) {
      const std::string name = pictures + file.header.csName.Text();
      entries.Add(name, std::move(file));
    }
  entries.Add(BUNDLE_SETUP, content.setup.data(), content.setup.size());
  entries.Add(BUNDLE_SCRIPT, content.script.data(), content.script.size());
  if (!content.picture.empty())
    entries.Add(pictures + BUNDLE_SIDE_PICTURE, content.picture.data(), content.picture.size());
  return WriteArchive(entries.Sorted(), "the setup program", output, nullptr, 9);
}
