#include "ScriptVariables.h"

#include <set>

#include "CheckScan.h"

namespace {

// The engine drops the character behind a backslash that begins none of its escapes. In front of the closing quote one
// is needed, for a quote behind a backslash closes nothing, not even behind two.
std::string Declaration(const std::string& name, const std::string& value) {
  static const char PLAIN[] = "\n\r\t\"\\", LETTERS[] = "nrt\"\\";
  std::string line = name + " = \"";
  for (const char c : value) {
    const size_t at = std::string(PLAIN).find(c);
    line += at == std::string::npos ? std::string(1, c) : std::string("\\") + LETTERS[at];
  }
  if (!value.empty() && value.back() == '\\') line.back() = ' ';
  return line + "\"";
}

struct Block {
  Block(const std::string& script) : text("", script), report(text), rest(ScanInit(report, scanned)) {}
  size_t PlaceOf(Piece piece) const { return static_cast<size_t>(piece.data() - text.Text().data()); }
  bool bThere() const { return PlaceOf(rest) > 0; }

  CheckedText text;
  CheckReport report;
  ScannedScript scanned;
  Piece rest;  // of the text, behind END_INIT
};

}  // namespace

std::vector<std::string> DeclaredVariables(const std::string& script) {
  const Block block(script);
  return {block.scanned.variables.begin(), block.scanned.variables.end()};
}

std::string WithVariables(const std::string& script, const ScriptVariables& variables) {
  const Block block(script);
  const std::vector<Piece>& names = block.scanned.variables;
  const size_t end = block.bThere() ? block.PlaceOf(block.rest) - Piece("END_INIT").size() : 0;
  std::string out;
  size_t copied = 0;
  std::set<std::string> done;
  for (size_t i = 0; i < names.size(); i++) {
    const auto found = variables.find(std::string(names[i]));
    if (found == variables.end()) continue;
    // Comments are blanks here, so what is left in front of the next name ends with the value.
    const size_t from = block.PlaceOf(names[i]), to = i + 1 < names.size() ? block.PlaceOf(names[i + 1]) : end;
    const size_t length = piece::Trim(block.text.Text().substr(from, to - from)).size();
    out += script.substr(copied, from - copied) + Declaration(found->first, found->second);
    copied = from + length;
    done.insert(found->first);
  }
  out += script.substr(copied, end - copied);
  std::string added;
  for (const auto& [name, value] : variables)
    if (!done.count(name)) added += Declaration(name, value) + "\n";
  out += block.bThere() ? added : "INIT\n" + added + "END_INIT\n";
  return out + script.substr(end);
}
