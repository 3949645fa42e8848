// For every floor's tests: a fresh folder that goes away with the test, and the diagnostic lines written meanwhile.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include "foundation/os/Os.h"

// A new empty folder below the system's temporary one; removed with all it holds by the destructor.
class TestFolder {
 public:
  TestFolder() {
    CNString csTemp, csName;
    if (!bOsGetTempFolder(csTemp) || !bOsMakeTempFile(csTemp.Text(), "orb", csName) || !bOsDeleteFile(csName.Text()) ||
        OsMakeFolder(csName.Text()) != OsMakeFolderResult::Made) {
      ADD_FAILURE() << "no temporary folder";
      return;
    }
    m_root = csName.Text();
  }
  ~TestFolder() {
    if (!m_root.empty()) RemoveTree(m_root);
  }
  TestFolder(const TestFolder&) = delete;
  TestFolder& operator=(const TestFolder&) = delete;

  // The folder, without a trailing separator, and the path of something in it ('/' separates in the name).
  const std::string& Root() const { return m_root; }
  std::string Path(const std::string& name) const { return m_root + Separator() + name; }

  // Makes a folder, and every missing one above it, below the root.
  void MakeFolder(const std::string& name) const {
    for (size_t at = name.find('/'); at != std::string::npos; at = name.find('/', at + 1))
      OsMakeFolder(Path(name.substr(0, at)).c_str());
    EXPECT_NE(OsMakeFolder(Path(name).c_str()), OsMakeFolderResult::Failed) << name;
  }
  void Write(const std::string& name, const std::string& bytes) const { WriteFile(Path(name), bytes); }
  std::string Read(const std::string& name) const { return ReadFile(Path(name)); }
  bool Exists(const std::string& name) const { return bOsExists(Path(name).c_str()); }
  // The names in a folder below the root, sorted.
  std::vector<std::string> Names(const std::string& name = "") const {
    std::vector<std::string> names;
    bOsListFolder((name.empty() ? m_root : Path(name)).c_str(), KeepName, &names);
    std::sort(names.begin(), names.end());
    return names;
  }

  // Whole files by any path. A failure fails the test.
  static void WriteFile(const std::string& path, const std::string& bytes) {
    OsFile file;
    EXPECT_TRUE(file.bOpen(path.c_str(), OsOpenMode::Create) && file.bWrite(bytes.data(), bytes.size()) &&
                file.bClose())
        << "cannot write " << path;
  }
  static std::string ReadFile(const std::string& path) {
    OsFile file;
    if (!file.bOpen(path.c_str(), OsOpenMode::Read)) {
      ADD_FAILURE() << "cannot read " << path;
      return "";
    }
    std::string bytes;
    char buffer[4096];
    for (long lRead; (lRead = file.lRead(buffer, sizeof buffer)) > 0;) bytes.append(buffer, size_t(lRead));
    return bytes;
  }

 private:
  static const char* Separator() {
#ifdef _WIN32
    return "\\";
#else
    return "/";
#endif
  }
  static bool KeepName(const OsFolderEntry& entry, void* pNames) {
    static_cast<std::vector<std::string>*>(pNames)->push_back(entry.csName.Text());
    return true;
  }
  static bool RemoveEntry(const OsFolderEntry& entry, void* pFolder) {
    const std::string path = *static_cast<std::string*>(pFolder) + Separator() + entry.csName.Text();
    bOsSetAttributes(path.c_str(), OS_NORMAL);
    const bool bFolder = entry.info.attributes & OS_DIRECTORY;
    if (bFolder && !(entry.info.attributes & OS_REPARSE_POINT))
      RemoveTree(path);
    else if (!bOsDeleteFile(path.c_str()))
      bOsDeleteFolder(path.c_str());
    return true;
  }
  static void RemoveTree(std::string path) {
    bOsListFolder(path.c_str(), RemoveEntry, &path);
    bOsDeleteFolder(path.c_str());
  }

  std::string m_root;
};

// While it lives, its folder is the current one and the diagnostic log there is switched on.
class TestLog {
 public:
  explicit TestLog(const TestFolder& folder) : m_previous(std::filesystem::current_path()) {
    m_path = folder.Path("execution.log");
    std::filesystem::current_path(folder.Root());
    Clear();
  }
  ~TestLog() {
    std::error_code ignored;
    std::filesystem::current_path(m_previous, ignored);
  }
  TestLog(const TestLog&) = delete;
  TestLog& operator=(const TestLog&) = delete;

  void Clear() { TestFolder::WriteFile(m_path, ""); }
  // The messages logged since the start or the last Clear, without their thread and time.
  std::vector<std::string> Lines() const {
    const std::string text = Raw();
    std::vector<std::string> lines;
    for (size_t at = 0; at < text.size();) {
      const size_t next = text.find("\n[", at + 1);
      const std::string entry = text.substr(at, next == std::string::npos ? next : next - at);
      const size_t message = MessageAt(entry);
      if (message == std::string::npos && !lines.empty())
        lines.back() += entry;  // "\n[" inside a message
      else
        lines.push_back(message == std::string::npos ? entry : entry.substr(message));
      at = next == std::string::npos ? text.size() : next;
    }
    return lines;
  }
  // The log as it is, with '\n' as its line end everywhere.
  std::string Raw() const {
    std::string text = TestFolder::ReadFile(m_path);
#ifdef _WIN32
    for (size_t at = 0; (at = text.find("\r\n", at)) != std::string::npos; at++) text.erase(at, 1);
#endif
    return text;
  }

 private:
  // Behind "\n[123, Sat Nov 14 12:30:11 2026] ", or npos.
  static size_t MessageAt(const std::string& entry) {
    const size_t digits = entry.find_first_not_of("0123456789", 2);
    const size_t end = digits == std::string::npos || digits == 2 ? digits : digits + 2 + 24;
    const bool bHeader = end != std::string::npos && entry.compare(digits, 2, ", ") == 0 && entry.size() >= end + 2 &&
                         entry.compare(end, 2, "] ") == 0;
    return bHeader ? end + 2 : std::string::npos;
  }

  std::filesystem::path m_previous;
  std::string m_path;
};
