#include "Preview.h"

#include <vector>

#include "OrbitText.h"
#include "Programs.h"
#ifdef _WIN32
#include <process.h>
#else
#include <unistd.h>

#include <cerrno>
#include <cstring>
#endif

namespace {

// Where the preview lies: beside this program when they are handed out together, else in the folders of the project.
#ifdef _WIN32
const char* const NAMES[] = {"orbit-preview.exe", "preview/orbit-preview.exe"};
const int LEVELS = 2;
#else
const char* const NAMES[] = {"preview.sh", "scripts/preview.sh"};
const int LEVELS = 5;
#endif

std::filesystem::path FindProgram() {
  std::filesystem::path folder = OwnFolder();
  std::error_code ignored;
  for (int i = 0; i < LEVELS; i++, folder = folder.parent_path())
    for (const char* szName : NAMES)
      if (std::filesystem::is_regular_file(folder / szName, ignored)) return folder / szName;
  throw OrbitError(std::string("the preview (") + NAMES[0] + ") is neither beside this program nor in its project");
}

std::vector<std::string> Arguments(const PreviewCommand& command) {
  std::vector<std::string> arguments = {command.script};
  const auto add = [&](const char* szOption, const std::string& value) {
    if (value.empty()) return;
    arguments.push_back(szOption);
    arguments.push_back(value);
  };
  add("--page", command.page);
  add("--picture", command.folder);
  add("--dpi", command.iDpi ? std::to_string(command.iDpi) : "");
  return arguments;
}

#ifdef _WIN32

// The started program takes its command line apart again: there backslashes in front of a quote count double.
std::wstring Quoted(const std::string& text) {
  const std::filesystem::path wide = ToPath(text);
  std::wstring quoted = L"\"";
  size_t nBackslashes = 0;
  for (const wchar_t c : wide.native()) {
    if (c == L'"') quoted.append(nBackslashes + 1, L'\\');
    quoted += c;
    nBackslashes = c == L'\\' ? nBackslashes + 1 : 0;
  }
  return quoted.append(nBackslashes, L'\\') + L"\"";
}

int Start(const std::filesystem::path& program, const std::vector<std::string>& arguments) {
  std::vector<std::wstring> quoted = {L"\"" + program.native() + L"\""};
  for (const std::string& argument : arguments) quoted.push_back(Quoted(argument));
  std::vector<const wchar_t*> words;
  for (const std::wstring& word : quoted) words.push_back(word.c_str());
  words.push_back(nullptr);
  const intptr_t iCode = _wspawnv(_P_WAIT, program.c_str(), words.data());
  if (iCode == -1) throw OrbitError(FromPath(program) + " cannot be started");
  return static_cast<int>(iCode);
}

#else

// The wrapper takes this program's place: a signal reaches it, and its exit code is this program's.
int Start(const std::filesystem::path& program, std::vector<std::string> arguments) {
  arguments.insert(arguments.begin(), program.native());
  std::vector<char*> words;
  for (std::string& argument : arguments) words.push_back(argument.data());
  words.push_back(nullptr);
  execv(program.c_str(), words.data());
  throw OrbitError(FromPath(program) + " cannot be started: " + std::strerror(errno));
}

#endif

}  // namespace

int StartPreview(const PreviewCommand& command) { return Start(FindProgram(), Arguments(command)); }
