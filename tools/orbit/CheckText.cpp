#include "CheckText.h"

#include <algorithm>

#include "OrbitText.h"
#include "wizard/TextRange.h"

CheckedText::CheckedText(std::string shownName, std::string bytes, std::string utf8)
    : m_name(std::move(shownName)), m_bytes(std::move(bytes)), m_utf8(std::move(utf8)) {
  m_lines.push_back(0);
  for (size_t at = 0; (at = m_bytes.find('\n', at)) != std::string::npos;) m_lines.push_back(++at);
  m_clean = m_bytes;
  Clean();
}

// The loader's own cleaning, but what it takes away becomes blanks.
void CheckedText::Clean() {
  char* p = m_clean.data();
  char* const pEnd = p + m_clean.size();
  while (p < pEnd) {
    char* const pLineEnd = std::find(p, pEnd, '\n');
    if (range::bStarts(range::SkipBlanks(p, pLineEnd), pLineEnd, "//")) std::fill(p, pLineEnd, ' ');
    bool bQuoted = false;
    for (const char* pLine = p; p < pLineEnd; p++) {
      if (*p == '"' && (p == pLine || p[-1] != '\\')) bQuoted = !bQuoted;
      if (*p == '\r' || !*p || (*p == '\t' && !bQuoted)) *p = ' ';
    }
    if (p < pEnd) p++;
  }
}

CheckedText::Position CheckedText::PositionOf(const char* p) const {
  const size_t at = static_cast<size_t>(p - m_clean.data());
  const size_t line = static_cast<size_t>(std::upper_bound(m_lines.begin(), m_lines.end(), at) - m_lines.begin());
  return {line, at - m_lines[line - 1] + 1};
}

const char* CheckedText::LineText(size_t line) const {
  if (line < 1 || line > m_lines.size()) return piece::End(m_clean);
  return range::SkipBlanks(m_clean.data() + m_lines[line - 1], piece::End(m_clean));
}

// UTF-8, with blanks for control characters: they would move a terminal's cursor.
std::string CheckedText::WrittenLine(size_t line) const {
  const Piece whole = m_utf8.empty() ? Piece(m_bytes) : Piece(m_utf8);
  size_t from = m_lines[line - 1];
  if (!m_utf8.empty()) {
    from = 0;
    for (size_t i = 1; i < line && from != Piece::npos; i++) from = whole.find('\n', from) + 1;
  }
  std::string text(whole.substr(from, whole.find('\n', from) - from));
  while (!text.empty() && text.back() == '\r') text.pop_back();
  for (char& c : text)
    if (static_cast<unsigned char>(c) < ' ' && c != '\t') c = ' ';
  return m_utf8.empty() ? ToUtf8(text.c_str()) : text;
}

std::string CheckedText::Excerpt(Position position) const {
  std::string below = m_bytes.substr(m_lines[position.line - 1], position.column - 1);
  below.resize(position.column - 1, ' ');
  for (char& c : below)
    if (c != '\t') c = ' ';
  return WrittenLine(position.line) + "\n" + below + "^\n";
}

Piece piece::TrimFront(Piece text) {
  const size_t from = text.find_first_not_of(" \t");
  return from == Piece::npos ? text.substr(text.size()) : text.substr(from);
}

Piece piece::Trim(Piece text) {
  text = SkipSpace(text);
  return text.substr(0, text.find_last_not_of(" \t\r\n") + 1);
}

Piece piece::SkipSpace(Piece text) {
  const size_t from = text.find_first_not_of(" \t\r\n");
  return from == Piece::npos ? text.substr(text.size()) : text.substr(from);
}

bool piece::bStarts(Piece text, Piece word) { return text.substr(0, word.size()) == word; }

bool piece::bIsWordLetter(char c) {
  return IsLetter(static_cast<unsigned char>(c)) || ScriptText::bIsDigit(c) || c == '_';
}

Piece piece::Word(Piece text) {
  size_t length = 0;
  while (length < text.size() && bIsWordLetter(text[length])) length++;
  return text.substr(0, length);
}

bool piece::bNextLine(Piece& text, Piece& line) {
  if (text.empty()) return false;
  const size_t feed = text.find('\n');
  line = text.substr(0, feed);
  text.remove_prefix(feed == Piece::npos ? text.size() : feed + 1);
  return true;
}
