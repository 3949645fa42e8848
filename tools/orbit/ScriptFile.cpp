#include "ScriptFile.h"

#include <algorithm>
#include <fstream>
#include <iterator>

#include "OrbitText.h"

namespace {

const char BYTE_ORDER_MARK[] = "\xEF\xBB\xBF";

// How many bytes follow this first one in UTF-8, or -1 when it cannot be a first one.
int FollowingBytes(unsigned char c) {
  static const struct {
    unsigned char mask, value;
    int following;
  } ROWS[] = {{0x80, 0x00, 0}, {0xE0, 0xC0, 1}, {0xF0, 0xE0, 2}, {0xF8, 0xF0, 3}};
  for (const auto& row : ROWS)
    if ((c & row.mask) == row.value) return row.following;
  return -1;
}

bool IsUtf8(const std::string& bytes) {
  int following = 0;
  for (const char c : bytes) {
    const bool bFollows = (c & 0xC0) == 0x80;
    if (bFollows != (following > 0)) return false;
    following = bFollows ? following - 1 : FollowingBytes(static_cast<unsigned char>(c));
    if (following < 0) return false;
  }
  return following == 0;
}

}  // namespace

bool bReadScriptFile(const std::string& path, ScriptFile& script) {
  std::error_code ignored;
  std::ifstream file(ToPath(path), std::ios::binary);
  if (!file || std::filesystem::is_directory(ToPath(path), ignored)) return false;
  std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  if (file.bad()) return false;
  std::replace(bytes.begin(), bytes.end(), '\0', ' ');
  const bool bMarked = bytes.rfind(BYTE_ORDER_MARK, 0) == 0;
  if (bMarked) bytes.erase(0, 3);
  const bool bAscii = std::all_of(bytes.begin(), bytes.end(), [](char c) { return (c & 0x80) == 0; });
  script.bUtf8 = bMarked || (!bAscii && IsUtf8(bytes));
  script.bReplaced = script.bUtf8 && !ToCp1250(bytes, script.text);
  if (!script.bUtf8) script.text = bytes;
  return true;
}
