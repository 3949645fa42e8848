// Faults of a file that its author writes in UTF-8, printed as those of a script are: in order of place, each with its
// line and a caret.
#pragma once

#include <cstdio>
#include <string>
#include <vector>

#include "CheckText.h"

class SourceReport {
 public:
  using Place = CheckedText::Position;

  // The name is the one that is shown; both are UTF-8.
  SourceReport(const std::string& shownName, const std::string& text);

  // Places outside of the text count as the nearest one within it.
  void Error(Place place, const std::string& text) { m_faults.push_back({Within(place), true, text}); }
  void Warning(Place place, const std::string& text) { m_faults.push_back({Within(place), false, text}); }
  // The place of the first such text (UTF-8) from one place up to another; `from` when it does not stand there.
  Place Find(const std::string& wanted, Place from, Place to) const;
  // Prints what has been reported since the last time and returns the number of all errors so far.
  int Print(FILE* pOut);

 private:
  struct Fault {
    Place place;
    bool bError;
    std::string text;
  };
  Place Within(Place place) const;

  std::vector<std::string> m_lines;  // UTF-8
  CheckedText m_file;
  std::vector<Fault> m_faults;
  int m_iErrors = 0;
};
