// A script's text as its author wrote it, for faults that point at their place. Everything that checks a script works
// on pieces of one cleaned copy of the text; since the copy is as long as the file, a piece's address is its place.
#pragma once

#include <string>
#include <string_view>
#include <vector>

using Piece = std::string_view;

class CheckedText {
 public:
  // The file's text in code page 1250 and the name it is shown by (UTF-8). A file that was written in UTF-8 gives its
  // own text besides, of as many characters, for the lines that are shown.
  CheckedText(std::string shownName, std::string bytes, std::string utf8 = "");
  CheckedText(const CheckedText&) = delete;
  CheckedText& operator=(const CheckedText&) = delete;

  const std::string& ShownName() const { return m_name; }
  const std::string& Written() const { return m_bytes; }
  // What the engine's loader reads: comments, carriage returns, tabs outside quotes and zero bytes are blanks.
  Piece Text() const { return m_clean; }

  // A line and a column, both counted from 1; a column is one character of the line as written, tabs too.
  struct Position {
    size_t line, column;
  };
  // p points into Text(), or to its end.
  Position PositionOf(const char* p) const;
  // The first character of the line that is no blank. Lines beyond the text give its end.
  const char* LineText(size_t line) const;
  // The line as written, without its line end, and the line below it with a caret under the column. UTF-8.
  std::string Excerpt(Position position) const;

 private:
  void Clean();
  std::string WrittenLine(size_t line) const;

  std::string m_name;
  std::string m_bytes;  // as written
  std::string m_utf8;   // the same where the file was UTF-8, else empty
  std::string m_clean;
  std::vector<size_t> m_lines;  // where each line begins
};

// Reading pieces. Blanks are spaces and tabs; space is blanks and line feeds.
namespace piece {

inline Piece Between(const char* p, const char* pEnd) { return Piece(p, static_cast<size_t>(pEnd - p)); }
inline const char* End(Piece text) { return text.data() + text.size(); }
Piece TrimFront(Piece text);
Piece Trim(Piece text);       // blanks, line feeds and carriage returns at both ends
Piece SkipSpace(Piece text);  // line feeds too
bool bStarts(Piece text, Piece word);
bool bIsWordLetter(char c);  // of a word: a letter, a digit or an underscore
// The word that the text begins with, perhaps empty.
Piece Word(Piece text);
// Takes the next line off the text, its line feed too; false when nothing is left.
bool bNextLine(Piece& text, Piece& line);

}  // namespace piece
