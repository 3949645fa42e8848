#include "FolderScan.h"

#include <algorithm>
#include <map>
#include <set>

#include "OrbitText.h"
#include "archive/PathGuard.h"

namespace fs = std::filesystem;

namespace {

// Upper-case letters of code page 1250 outside ASCII whose lower-case partner is not 32 or 16 places further.
const std::map<unsigned char, unsigned char> LOWER_CASE = {
    {0xa3, 0xb3}, {0xa5, 0xb9}, {0xaa, 0xba}, {0xaf, 0xbf}, {0xbc, 0xbe}};

unsigned char Fold(unsigned char c) {
  if (c == '/') return '\\';
  if ((c >= 'A' && c <= 'Z') || (c >= 0xc0 && c <= 0xde && c != 0xd7)) return c + 0x20;
  if (c >= 0x8a && c <= 0x8f && c != 0x8b) return c + 0x10;
  const auto found = LOWER_CASE.find(c);
  return found == LOWER_CASE.end() ? c : found->second;
}

// What setup itself writes into the destination folder.
const char* const SETUPS_OWN_FILES[] = {"installed.lst", "uninstall.log", "config.ini"};

bool bIsSetupsOwn(const std::string& name) {
  const std::string folded = FoldName(name);
  return std::any_of(std::begin(SETUPS_OWN_FILES), std::end(SETUPS_OWN_FILES),
                     [&](const char* szOwn) { return folded == szOwn; });
}

class Scan {
 public:
  // Adds what lies in `folder`; `prefix` is its name in the archive with a backslash, or empty.
  void Visit(const fs::path& folder, const std::string& prefix) {
    std::error_code error;
    fs::directory_iterator it(folder, error);
    if (error) throw OrbitError("cannot read the folder " + FromPath(folder) + ": " + error.message());
    bool bEmpty = true;
    for (; it != fs::directory_iterator(); it.increment(error)) {
      bEmpty = false;
      VisitEntry(it->path(), prefix + EntryName(it->path()));
      if (error) break;
    }
    if (error) throw OrbitError("cannot read the folder " + FromPath(folder) + ": " + error.message());
    if (bEmpty) throw OrbitError("the folder " + FromPath(folder) + " is empty: an archive carries files only");
  }

  std::vector<ProductFile> Sorted() {
    SortByName(m_files);
    return std::move(m_files);
  }

 private:
  std::string EntryName(const fs::path& path) {
    const std::string shown = FromPath(path.filename());
    std::string name;
    if (!ToCp1250(shown, name)) throw OrbitError("code page 1250 cannot hold the name of " + FromPath(path));
    CNString csSafe;
    if (name.find('\\') != std::string::npos || !bMakeSafePath(name.c_str(), csSafe))
      throw OrbitError("the name of " + FromPath(path) + " is no file name on Windows");
    return name;
  }

  void VisitEntry(const fs::path& path, const std::string& name) {
    ProductFile file;
    file.shownPath = FromPath(path);
    file.path = SystemPath(file.shownPath);
    OsFileInfo info;
    if (!bOsGetFileInfo(file.path.c_str(), info)) throw OrbitError("cannot read " + file.shownPath);
    std::error_code error;
    const fs::file_type type = fs::symlink_status(path, error).type();
    if (type == fs::file_type::symlink || (info.attributes & OS_REPARSE_POINT))
      throw OrbitError(file.shownPath + " is a link: put the file itself in its place");
    if (bIsSetupsOwn(name))
      throw OrbitError("setup writes a file of its own named " + name + " into the destination folder: rename " +
                       file.shownPath + " or put it into a folder");
    if (!m_names.insert(FoldName(name)).second)
      throw OrbitError("Windows takes the name of " + file.shownPath + " and another in its folder for the same");
    if (type == fs::file_type::directory) return Visit(path, name + "\\");
    if (type != fs::file_type::regular) throw OrbitError(file.shownPath + " is neither a file nor a folder");
    if (info.size > UINT32_MAX) throw OrbitError(file.shownPath + " is larger than an archive can carry (4 GB)");
    if (name.size() > ARCHIVE_MAX_NAME) throw OrbitError("the path of " + file.shownPath + " is too long");
    Describe(info, name, file);
    m_files.push_back(std::move(file));
  }

  // The archive depends on the files alone: reading one must not change its last access, so the last write stands for
  // it; and a creation after the last write only tells when this copy was made.
  static void Describe(const OsFileInfo& info, const std::string& name, ProductFile& file) {
    const bool bOriginal = info.times.creation && info.times.creation < info.times.lastWrite;
    const uint64_t created = bOriginal ? info.times.creation : info.times.lastWrite;
    file.size = info.size;
    file.header.csName = name.c_str();
    file.header.creationTimeHigh = static_cast<uint32_t>(created >> 32);
    file.header.lastWriteTimeHigh = static_cast<uint32_t>(info.times.lastWrite >> 32);
    file.header.lastAccessTimeHigh = file.header.lastWriteTimeHigh;
    file.header.attributes = (info.attributes & (OS_READ_ONLY | OS_HIDDEN | OS_SYSTEM)) | OS_ARCHIVE;
  }

  std::vector<ProductFile> m_files;
  std::set<std::string> m_names;
};

}  // namespace

void SortByName(std::vector<ProductFile>& files) {
  std::sort(files.begin(), files.end(), [](const ProductFile& a, const ProductFile& b) {
    return std::string_view(a.header.csName.Text()) < std::string_view(b.header.csName.Text());
  });
}

std::string FoldName(const std::string& name) {
  std::string folded = name;
  for (char& c : folded) c = static_cast<char>(Fold(static_cast<unsigned char>(c)));
  return folded;
}

std::vector<ProductFile> ScanFolder(const std::string& folder) {
  std::error_code error;
  if (!fs::is_directory(ToPath(folder), error)) throw OrbitError(folder + " is no folder");
  Scan scan;
  scan.Visit(ToPath(folder), "");
  return scan.Sorted();
}
