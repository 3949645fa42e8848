#include "SourceReport.h"

#include <algorithm>
#include <tuple>

#include "CheckReport.h"
#include "OrbitText.h"

namespace {

// One byte for each character, so that columns are bytes.
std::string Narrowed(const std::string& utf8) {
  std::string narrow, one;
  for (const std::string& character : Characters(utf8)) narrow += ToCp1250(character, one) && !one.empty() ? one : "?";
  return narrow;
}

std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines(1);
  for (const char c : text) {
    if (c == '\n')
      lines.emplace_back();
    else
      lines.back() += c;
  }
  return lines;
}

bool bBefore(SourceReport::Place a, SourceReport::Place b) {
  return std::tie(a.line, a.column) < std::tie(b.line, b.column);
}

}  // namespace

SourceReport::SourceReport(const std::string& shownName, const std::string& text)
    : m_lines(Lines(text)), m_file(shownName, Narrowed(text), text) {}

SourceReport::Place SourceReport::Within(Place place) const {
  const size_t line = std::clamp<size_t>(place.line, 1, m_lines.size());
  const size_t length = Characters(m_lines[line - 1]).size();
  return {line, std::clamp<size_t>(place.column, 1, length + 1)};
}

SourceReport::Place SourceReport::Find(const std::string& wanted, Place from, Place to) const {
  for (size_t line = from.line; line >= 1 && line <= std::min(to.line, m_lines.size()); line++) {
    const std::string& text = m_lines[line - 1];
    for (size_t at = text.find(wanted); at != std::string::npos; at = text.find(wanted, at + 1)) {
      const Place place = {line, Characters(text.substr(0, at)).size() + 1};
      if (!bBefore(place, from) && bBefore(place, to)) return place;
    }
  }
  return from;
}

int SourceReport::Print(FILE* pOut) {
  std::stable_sort(m_faults.begin(), m_faults.end(),
                   [](const Fault& a, const Fault& b) { return bBefore(a.place, b.place); });
  for (const Fault& fault : m_faults) {
    m_iErrors += fault.bError;
    PrintFault(pOut, m_file, fault.place, fault.bError, fault.text);
  }
  m_faults.clear();
  return m_iErrors;
}
