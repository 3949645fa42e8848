#include <unordered_set>

#include "CheckScan.h"
#include "wizard/TextRange.h"

namespace {

// The first line that consists of the word, from its first letter on; empty without.
Piece FindLine(Piece text, Piece word) {
  for (Piece line; piece::bNextLine(text, line);)
    if (piece::Trim(line) == word) return piece::Trim(line);
  return {};
}

class InitScan {
 public:
  InitScan(CheckReport& report, ScannedScript& script) : m_report(report), m_script(script) {}

  void Read(Piece text) {
    CheckLineEnds(text);
    while (!(text = piece::SkipSpace(text)).empty()) text = ReadVariable(text);
  }

 private:
  static Piece LineOf(Piece text) { return text.substr(0, text.find('\n')); }
  static bool bEndsInQuote(Piece line) { return piece::Trim(line).empty() || piece::Trim(line).back() == '"'; }
  static Piece After(Piece text, const char* p) { return piece::Between(p, piece::End(text)); }

  void CheckLineEnds(Piece text) {
    for (Piece line; piece::bNextLine(text, line);)
      if (!bEndsInQuote(line)) m_report.Add(Rule::LineQuote, piece::End(piece::Trim(line)));
  }

  // Returns the text behind the variable's last line.
  Piece ReadVariable(Piece text) {
    const Piece line = LineOf(text);
    const size_t equals = line.find('=');
    if (equals == Piece::npos) {
      if (bEndsInQuote(line)) m_report.Add(Rule::EqualsMissing, line);
      return text.substr(line.size());
    }
    const Piece name = piece::Trim(line.substr(0, equals));
    if (name.empty())
      m_report.Add(Rule::VariableName, line);
    else if (!m_names.insert(name).second)
      m_report.Add(Rule::DeclaredTwice, name, {name});
    m_script.variables.push_back(name);
    return ReadValue(text.substr(equals + 1), line.data());
  }

  Piece ReadValue(Piece text, const char* pVariable) {
    for (;;) {
      const Piece line = LineOf(text);
      const char* const pEnd = piece::End(line);
      const char* const pOpen = range::FindChar(line.data(), pEnd, '"');
      const char* const pClose = pOpen ? range::FindClosingQuote(pOpen + 1, pEnd) : nullptr;
      if (!pClose) {
        if (pOpen && bEndsInQuote(line)) ReportQuote(pOpen, pVariable);  // else the line's end was reported
        return After(text, pEnd);
      }
      ReportIgnored(piece::Between(line.data(), pOpen));
      CheckEscapes(piece::Between(pOpen + 1, pClose));
      const Piece rest = piece::SkipSpace(After(text, pClose + 1));
      if (rest.empty() || rest.front() != '>') {
        const Piece tail = LineOf(After(text, pClose + 1));
        ReportIgnored(tail);
        return After(text, piece::End(tail));
      }
      text = rest.substr(1);
    }
  }

  void ReportQuote(const char* pPlace, const char* pVariable) {
    const bool bEscaped = piece::End(piece::Trim(LineOf(After(m_report.File().Text(), pPlace))))[-2] == '\\';
    m_report.Add(Rule::ValueQuote, pPlace, {}, bEscaped ? " (a quote behind a backslash does not end it)" : "");
    m_report.EngineSeesLastAt(pVariable);
  }

  void ReportIgnored(Piece text) {
    if (!piece::Trim(text).empty()) m_report.Add(Rule::TextIgnored, piece::Trim(text));
  }

  void CheckEscapes(Piece value) {
    for (size_t i = 0; i + 1 < value.size(); i++) {
      if (value[i] != '\\') continue;
      i++;
      if (Piece("nrt\"\\").find(value[i]) == Piece::npos)
        m_report.Add(Rule::UnknownEscape, value.substr(i - 1), {value.substr(i, 1)});
    }
  }

  CheckReport& m_report;
  ScannedScript& m_script;
  std::unordered_set<Piece> m_names;
};

}  // namespace

Piece ScanInit(CheckReport& report, ScannedScript& script) {
  const Piece text = report.File().Text();
  const Piece init = FindLine(text, "INIT"), endInit = FindLine(text, "END_INIT");
  if (init.empty() && endInit.empty()) return text;
  const bool bOrdered = !init.empty() && (endInit.empty() || init.data() < endInit.data());
  if (!bOrdered) {
    report.Add(Rule::InitMissing, endInit);
    return piece::Between(piece::End(endInit), piece::End(text));
  }
  const Piece before = piece::SkipSpace(piece::Between(text.data(), init.data()));
  if (!before.empty()) report.Add(Rule::TextIgnored, before);
  const char* pBlockEnd = endInit.data();
  if (endInit.empty()) {
    // What looks like the first dialog ends the block.
    report.Add(Rule::EndInitMissing, init);
    const char* const pDialog = range::FindText(init.data(), piece::End(text), "\nDIALOG");
    pBlockEnd = pDialog ? pDialog + 1 : piece::End(text);
  }
  InitScan(report, script).Read(piece::Between(piece::End(init), pBlockEnd));
  return piece::Between(endInit.empty() ? pBlockEnd : piece::End(endInit), piece::End(text));
}
