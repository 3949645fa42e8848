#include "OrbitText.h"

#include <algorithm>
#include <cstring>

#include "foundation/Text.h"

bool ToCp1250(const std::string& utf8, std::string& text) {
  CNString csOut;
  const bool bFits = bUtf8ToCp1250(utf8.c_str(), csOut);
  text = csOut.Text();
  return bFits;
}

std::string ToUtf8(const char* szText) {
  CNString csOut;
  Cp1250ToUtf8(szText, csOut);
  return csOut.Text();
}

std::vector<std::string> Characters(const std::string& utf8) {
  std::vector<std::string> characters;
  for (const char c : utf8) {
    const bool bFollows = (c & 0xC0) == 0x80 && !characters.empty() && (characters.back()[0] & 0x80);
    if (!bFollows)
      characters.emplace_back(1, c);
    else
      characters.back() += c;
  }
  return characters;
}

std::string ForeignCharacter(const std::string& utf8) {
  std::string narrow;
  for (const std::string& character : Characters(utf8))
    if (!ToCp1250(character, narrow) || narrow.empty()) return character;
  return "";
}

std::string OneLine(const std::string& text) {
  std::string line;
  for (const char c : text) line += c == '\n' ? "\\n" : c == '\r' ? "\\r" : std::string(1, c);
  return line;
}

std::string FileNamePart(const std::string& utf8) {
  std::string name;
  for (const char c : utf8)
    name += static_cast<unsigned char>(c) < ' ' || c == '\x7f' || std::strchr("\\/:*?\"<>|", c) ? '-' : c;
  name.erase(name.find_last_not_of(". ") + 1);
  name.erase(0, std::min(name.find_first_not_of(' '), name.size()));
  return name;
}

std::filesystem::path ToPath(const std::string& utf8) {
  return std::filesystem::path(std::u8string(utf8.begin(), utf8.end()));
}

std::string FromPath(const std::filesystem::path& path) {
  const std::u8string text = path.u8string();
  return std::string(text.begin(), text.end());
}

std::string SystemPath(const std::string& utf8) {
  std::string text;
  if (!ToCp1250(utf8, text)) throw OrbitError("code page 1250 cannot hold the path " + utf8);
  return text;
}
