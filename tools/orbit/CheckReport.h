// Collects the faults of one script and prints them in order of place:
//   FILE:LINE:COLUMN: error: text
//   the source line
//      ^
#pragma once

#include <cstdio>
#include <initializer_list>
#include <set>
#include <span>

#include "CheckRules.h"
#include "CheckText.h"

// Prints one fault; the text is UTF-8, its control characters are printed as blanks.
void PrintFault(FILE* pOut, const CheckedText& file, CheckedText::Position position, bool bError,
                const std::string& text);

struct CheckFault {
  Rule rule;
  const char* pPlace;
  std::string text;          // UTF-8
  const char* pEnginePlace;  // where the engine sees the same fault
};

class CheckReport {
 public:
  // The file must outlive the report.
  explicit CheckReport(const CheckedText& file) : m_file(file) {}

  const CheckedText& File() const { return m_file; }
  // A fault at a place of the file's text. The pieces (code page 1250) fill the rule's words.
  void Add(Rule rule, const char* pPlace, std::initializer_list<Piece> fills = {}, const std::string& hint = "");
  void Add(Rule rule, Piece place, std::initializer_list<Piece> fills = {}, const std::string& hint = "") {
    Add(rule, place.data(), fills, hint);
  }
  // For the fault added last, when the engine reports it for another line.
  void EngineSeesLastAt(const char* pPlace) { m_faults.back().pEnginePlace = pPlace; }
  const std::vector<CheckFault>& Faults() const { return m_faults; }
  // The line at p cannot be told apart after its fault: what the engine makes of the rest is no news.
  void GiveUpLine(const char* p) { m_givenUp.insert(m_file.PositionOf(p).line); }
  bool bGivenUp(size_t line) const { return m_givenUp.count(line) != 0; }

  // Prints all faults, the earliest first, and returns the number of errors.
  int Print(FILE* pOut);

 private:
  const CheckedText& m_file;
  std::vector<CheckFault> m_faults;
  std::set<size_t> m_givenUp;  // lines
};

// " (did you mean 'X'?)" with the candidate nearest to the word, or "" when none is near. Letter case counts little.
std::string NearMiss(Piece word, std::span<const Piece> candidates);
