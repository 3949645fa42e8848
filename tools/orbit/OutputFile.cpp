#include "OutputFile.h"

#include "OrbitText.h"

namespace fs = std::filesystem;

OutputFile::OutputFile(const std::string& path) : m_path(path) {
  const fs::path target = ToPath(path);
  std::error_code ignored;
  if (!target.has_filename() || fs::is_directory(target, ignored)) throw OrbitError(path + " is a folder, not a file");
  std::string folder = SystemPath(FromPath(target.parent_path()));
  folder += folder.empty() ? "./" : "/";
  CNString csTemporary;
  if (!bOsMakeTempFile(folder.c_str(), "orb", csTemporary)) throw OrbitError("cannot create a file beside " + path);
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
  if (!bOsRename(m_temporary.c_str(), SystemPath(m_path).c_str())) throw OrbitError("cannot replace " + m_path);
  m_temporary.clear();
}
