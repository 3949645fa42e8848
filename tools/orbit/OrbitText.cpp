#include "OrbitText.h"

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
