#include "CheckReport.h"

#include <algorithm>
#include <array>

#include "OrbitText.h"

namespace {

const size_t LONGEST_WORD = 48;  // a longer word is no misspelling of one of ours

char Fold(char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; }

// Letters to insert, drop, change or swap with a neighbour to make one word of the other.
size_t Distance(Piece a, Piece b) {
  std::array<std::array<size_t, LONGEST_WORD + 1>, 3> rows;
  for (size_t j = 0; j <= b.size(); j++) rows[0][j] = j;
  for (size_t i = 1; i <= a.size(); i++) {
    auto& row = rows[i % 3];
    const auto& above = rows[(i + 2) % 3];
    row[0] = i;
    for (size_t j = 1; j <= b.size(); j++) {
      const bool bSame = Fold(a[i - 1]) == Fold(b[j - 1]);
      row[j] = std::min({row[j - 1] + 1, above[j] + 1, above[j - 1] + (bSame ? 0 : 1)});
      if (i > 1 && j > 1 && Fold(a[i - 1]) == Fold(b[j - 2]) && Fold(a[i - 2]) == Fold(b[j - 1]))
        row[j] = std::min(row[j], rows[(i + 1) % 3][j - 2] + 1);
    }
  }
  return rows[a.size() % 3][b.size()];
}

std::string Utf8(Piece text) { return ToUtf8(std::string(text).c_str()); }

}  // namespace

std::string NearMiss(Piece word, std::span<const Piece> candidates) {
  if (word.empty() || word.size() > LONGEST_WORD) return "";
  size_t best = word.size() < 4 ? 2 : word.size() < 8 ? 3 : 4;  // not as far as this
  Piece nearest;
  for (const Piece candidate : candidates) {
    const size_t longer = std::max(word.size(), candidate.size()), shorter = std::min(word.size(), candidate.size());
    if (candidate.size() > LONGEST_WORD || longer - shorter >= best || candidate == word) continue;
    const size_t distance = Distance(word, candidate);
    if (distance >= best || distance * 2 >= shorter) continue;
    best = distance;
    nearest = candidate;
  }
  return nearest.empty() ? "" : " (did you mean '" + Utf8(nearest) + "'?)";
}

void CheckReport::Add(Rule rule, const char* pPlace, std::initializer_list<Piece> fills, const std::string& hint) {
  std::string text;
  const Piece* pFill = fills.begin();
  for (const char* sz = RowOf(rule).szText; *sz; sz++) {
    const bool bFill = sz[0] == '{' && sz[1] == '}';
    if (bFill)
      text += pFill < fills.end() ? Utf8(*pFill++) : "";
    else
      text += *sz;
    sz += bFill;
  }
  m_faults.push_back({rule, pPlace, text + hint, pPlace});
}

void PrintFault(FILE* pOut, const CheckedText& file, CheckedText::Position position, bool bError,
                const std::string& text) {
  const std::string place = std::to_string(position.line) + ":" + std::to_string(position.column);
  std::string shown = text;
  for (char& c : shown)
    if (static_cast<unsigned char>(c) < ' ') c = ' ';
  std::fprintf(pOut, "%s:%s: %s: %s\n%s", file.ShownName().c_str(), place.c_str(), bError ? "error" : "warning",
               shown.c_str(), file.Excerpt(position).c_str());
}

int CheckReport::Print(FILE* pOut) {
  std::stable_sort(m_faults.begin(), m_faults.end(),
                   [](const CheckFault& a, const CheckFault& b) { return a.pPlace < b.pPlace; });
  int iErrors = 0;
  for (const CheckFault& fault : m_faults) {
    const bool bError = RowOf(fault.rule).bError;
    iErrors += bError;
    PrintFault(pOut, m_file, m_file.PositionOf(fault.pPlace), bError, fault.text);
  }
  return iErrors;
}
