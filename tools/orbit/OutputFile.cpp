#include "OutputFile.h"

#include "OrbitText.h"

namespace fs = std::filesystem;

namespace {

// Only a file is replaced, or nothing.
std::string Target(const std::string& path) {
  const fs::path target = ToPath(path), folder = target.parent_path();
  if (fs::path::preferred_separator != '\\' && path.find('\\') != std::string::npos)
    throw OrbitError("no file can be written as " + path + ": on this system folders are separated by '/'");
  std::error_code ignored;
  const fs::file_status status = fs::status(target, ignored);
  if (!target.has_filename() || fs::is_directory(status)) throw OrbitError(path + " is a folder, not a file");
  if (fs::exists(status) && !fs::is_regular_file(status))
    throw OrbitError(path + " is a device or the like, not a file");
  if (!folder.empty() && !fs::is_directory(folder, ignored))
    throw OrbitError("cannot create a file beside " + path + ": there is no folder " + FromPath(folder));
  const bool bLink = fs::exists(status) && fs::is_symlink(fs::symlink_status(target, ignored));
  return bLink ? FromPath(fs::canonical(target, ignored)) : path;
}

}  // namespace

OutputFile::OutputFile(const std::string& path) : m_path(path), m_target(Target(path)) {
  std::string folder = SystemPath(FromPath(ToPath(m_target).parent_path()));
  folder += folder.empty() ? "./" : "/";
  CNString csTemporary;
  if (!bOsMakeTempFile(folder.c_str(), "orb", csTemporary))
    throw OrbitError("cannot create a file beside " + path + ": may the folder be written to, and is the drive full?");
  m_temporary = csTemporary.Text();
  if (m_file.bOpen(m_temporary.c_str(), OsOpenMode::Truncate)) return;
  bOsDeleteFile(m_temporary.c_str());
  throw OrbitError("cannot write beside " + path);
}

OutputFile::~OutputFile() {
  m_file.bClose();
  if (!m_temporary.empty()) bOsDeleteFile(m_temporary.c_str());
}

void OutputFile::Write(const void* pBytes, size_t nBytes) {
  if (nBytes && !m_file.bWrite(pBytes, nBytes)) throw OrbitError("cannot write " + m_path + ": is the drive full?");
}

void OutputFile::Commit(const std::string& modelPath) {
  if (!m_file.bClose()) throw OrbitError("cannot write " + m_path + ": is the drive full?");
  // A temporary file is its owner's alone; a product is for everybody who may read its model.
  const fs::perms readable =
      fs::perms::owner_read | fs::perms::owner_write | fs::perms::group_read | fs::perms::others_read;
  std::error_code error;
  const fs::perms rights = modelPath.empty() ? readable : fs::status(ToPath(modelPath), error).permissions();
  if (!error) fs::permissions(ToPath(ToUtf8(m_temporary.c_str())), rights | fs::perms::owner_write, error);
  if (!bOsRename(m_temporary.c_str(), SystemPath(m_target).c_str()))
    throw OrbitError("cannot replace " + m_path + ": is it in use?");
  m_temporary.clear();
}

void CheckOutput(const std::string& output, const std::string& folder, const std::vector<std::string>& inputs) {
  std::error_code error, ignored;
  const fs::path target = fs::weakly_canonical(fs::absolute(ToPath(output)), error);
  if (error) throw OrbitError("cannot write " + output + ": " + error.message());
  for (const std::string& input : inputs)
    if (fs::equivalent(target, ToPath(input), ignored)) throw OrbitError("the output would overwrite " + input);
  for (fs::path above = target.parent_path(); !above.empty(); above = above.parent_path()) {
    if (fs::equivalent(above, ToPath(folder), ignored))
      throw OrbitError("the output lies in the folder that is packed: choose another place");
    if (above == above.parent_path()) break;
  }
}
