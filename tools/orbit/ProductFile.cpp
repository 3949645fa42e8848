#include "ProductFile.h"

#include <algorithm>

#include "CheckReport.h"
#include "FolderScan.h"
#include "OrbitText.h"
#include "Toml.h"
#include "archive/PathGuard.h"

namespace fs = std::filesystem;
using Place = SourceReport::Place;

namespace {

// A name stands twice in the paths of shortcuts, which Windows bounds at 260; the others are part of paths as well, and
// of a version resource, whose length is bounded.
const size_t LONGEST_TEXT = 100;

std::string ForeignFault(const std::string& foreign) {
  return "setup cannot show '" + foreign + "': code page 1250 has no such character";
}

Place PlaceOf(const toml::source_position& position) { return {position.line, position.column}; }

std::string AddressFault(const std::string& text) {
  const bool bPlain = text.find_first_of(" \"()<>\\") == std::string::npos;
  return bPlain ? "" : "an address has no blanks, quotes, brackets and backslashes";
}

std::string MailFault(const std::string& text) {
  return text.rfind("mailto:", 0) == 0 ? "the address alone is wanted, without mailto:" : AddressFault(text);
}

// The text is `what`.
std::string LengthFault(const std::string& what, const std::string& text) {
  return Characters(text).size() <= LONGEST_TEXT ? "" : what + " has at most 100 characters";
}

// Where a text is part of a path the shell would put a folder of its own in the place of %TEMP%, and find no program.
std::string PercentFault(const std::string& text) {
  const size_t open = text.find('%'), close = text.find('%', open + 1);
  const std::string name = close == std::string::npos ? "" : text.substr(open, close + 1 - open);
  if (name.size() <= 2 || name.find(' ') != std::string::npos)
    return close == std::string::npos ? "" : PercentFault(text.substr(close));
  return "Windows would take '" + name + "' for a variable of its own: no two % in a word";
}

std::string PublisherFault(const std::string& text) {
  if (text.find("<%") != std::string::npos) return "setup would take '<%' for the beginning of a variable's marker";
  const std::string fault = PercentFault(text);
  return fault.empty() ? LengthFault("a publisher's name", text) : fault;
}

std::string VersionFault(const std::string& text) {
  const bool bDigit = text[0] >= '0' && text[0] <= '9';
  if (!bDigit || FileNamePart(text) != text) return "a version begins with a digit and can be part of a file's name";
  return LengthFault("a version", text);
}

std::string FolderFault(const std::string& path) {
  std::error_code ignored;
  return fs::is_directory(ToPath(path), ignored) ? "" : "there is no folder " + path;
}

std::string FileFault(const std::string& path) {
  std::error_code ignored;
  return fs::is_regular_file(ToPath(path), ignored) ? "" : "there is no file " + path;
}

std::string OutputFault(const std::string& path) {
  const fs::path output = ToPath(path);
  if (FolderFault(path).empty()) return "";  // for a file of the usual name
  if (FoldName(FromPath(output.extension())) != ".exe") return "the output is a folder that is there, or a file .exe";
  const fs::path folder = output.parent_path();
  return folder.empty() ? "" : FolderFault(FromPath(folder));
}

enum class Kind { Text, Path };

const struct KeyRow {
  const char* szKey;
  std::string Product::*pText;
  Kind kind;
  bool bNeeded;
  std::string (*pFault)(const std::string&);  // what is wrong with the text, or empty
} KEYS[] = {
    {"name", &Product::name, Kind::Text, true, NameFault},
    {"version", &Product::version, Kind::Text, true, VersionFault},
    {"publisher", &Product::publisher, Kind::Text, false, PublisherFault},
    {"web", &Product::web, Kind::Text, false, AddressFault},
    {"mail", &Product::mail, Kind::Text, false, MailFault},
    {"files", &Product::files, Kind::Path, true, FolderFault},
    {"script", &Product::script, Kind::Path, false, FileFault},
    {"pictures", &Product::pictures, Kind::Path, false, FolderFault},
    {"icon", &Product::icon, Kind::Path, false, FileFault},
    {"output", &Product::output, Kind::Path, false, OutputFault},
};
const char VARIABLES[] = "variables";

class Reader {
 public:
  Reader(const std::string& folder, SourceReport& report, Product& product)
      : m_folder(folder), m_report(report), m_product(product) {}

  void Read(const toml::table& table) {
    for (const auto& [key, node] : table) ReadKey(key, node);
    for (const KeyRow& row : KEYS)
      if (row.bNeeded && !table.contains(row.szKey))
        m_report.Error({1, 1}, "'" + std::string(row.szKey) + "' is missing: " + row.szKey + " = \"...\"");
  }

 private:
  void ReadKey(const toml::key& key, const toml::node& node) {
    const std::string name(key.str());
    const KeyRow* const pRow =
        std::find_if(std::begin(KEYS), std::end(KEYS), [&](const KeyRow& row) { return name == row.szKey; });
    if (pRow != std::end(KEYS)) return ReadText(*pRow, node);
    if (name == VARIABLES) return ReadVariables(node);
    std::vector<Piece> keys = {VARIABLES};
    for (const KeyRow& row : KEYS) keys.push_back(row.szKey);
    m_report.Error(PlaceOf(key.source().begin), "unknown key '" + name + "'" + NearMiss(name, keys));
  }

  void ReadText(const KeyRow& row, const toml::node& node) {
    const Place place = PlaceOf(node.source().begin);
    m_product.places[row.szKey] = place;
    const auto* const pValue = node.as_string();
    if (!pValue) return m_report.Error(place, "'" + std::string(row.szKey) + "' is a text: \"...\"");
    if (!bHolds(pValue->get(), node, false)) return;
    std::string text = row.kind == Kind::Path && !pValue->get().empty() ? From(pValue->get()) : pValue->get();
    const std::string fault = text.empty() ? "this must not be empty" : row.pFault(text);
    if (!fault.empty()) m_report.Error(place, fault);
    m_product.*row.pText = std::move(text);
  }

  // A path of the product file; Windows' own way of writing it is understood everywhere.
  std::string From(std::string path) const {
    std::replace(path.begin(), path.end(), '\\', '/');
    return FromPath((ToPath(m_folder) / ToPath(path)).lexically_normal());
  }

  // Whether setup can keep the text. A variable's may have several lines.
  bool bHolds(const std::string& text, const toml::node& node, bool bLines) {
    const Place from = PlaceOf(node.source().begin), to = PlaceOf(node.source().end);
    const std::string allowed = bLines ? "\n\r\t" : "";
    for (const char c : text)
      if (static_cast<unsigned char>(c) < ' ' && allowed.find(c) == std::string::npos)
        return m_report.Error(from, bLines ? "a variable's text has no control characters" : "this must be one line"),
               false;
    const std::string foreign = ForeignCharacter(text);
    if (foreign.empty()) return true;
    m_report.Error(m_report.Find(foreign, from, to), ForeignFault(foreign));
    return false;
  }

  void ReadVariables(const toml::node& node) {
    const toml::table* const pTable = node.as_table();
    if (!pTable) return m_report.Error(PlaceOf(node.source().begin), "'variables' is a table: [variables]");
    for (const auto& [key, value] : *pTable) ReadVariable(key, value);
    std::sort(m_product.variables.begin(), m_product.variables.end(), [](const auto& a, const auto& b) {
      return a.place.line != b.place.line ? a.place.line < b.place.line : a.place.column < b.place.column;
    });
  }

  void ReadVariable(const toml::key& key, const toml::node& node) {
    const std::string name(key.str());
    const Place place = PlaceOf(key.source().begin);
    std::string narrow;
    const bool bWord = ToCp1250(name, narrow) && !narrow.empty() && piece::Word(narrow).size() == narrow.size();
    if (!bWord) return m_report.Error(place, "a variable's name consists of letters, digits and underscores");
    const auto text = TextOf(node);
    if (!text)
      return m_report.Error(PlaceOf(node.source().begin), "a variable is a text, a whole number, true or false");
    if (!bHolds(*text, node, true)) return;
    ProductVariable variable = {narrow, "", place};
    ToCp1250(*text, variable.value);
    m_product.variables.push_back(std::move(variable));
  }

  static std::optional<std::string> TextOf(const toml::node& node) {
    if (const auto* const pText = node.as_string()) return pText->get();
    if (const auto* const pNumber = node.as_integer()) return std::to_string(pNumber->get());
    if (const auto* const pBool = node.as_boolean()) return pBool->get() ? "1" : "0";
    return std::nullopt;
  }

  const std::string& m_folder;
  SourceReport& m_report;
  Product& m_product;
};

}  // namespace

std::string NameFault(const std::string& name) {
  const std::string foreign = ForeignCharacter(name);
  if (!foreign.empty()) return ForeignFault(foreign);
  std::string narrow;
  CNString csSafe;
  const bool bName = ToCp1250(name, narrow) && bMakeSafePath(narrow.c_str(), csSafe) && csSafe.Text() == narrow &&
                     FileNamePart(name) == name;
  if (!bName)
    return "a product's name is part of file names: no \\ / : * ? \" < > |, no blank or dot at its end, no device's "
           "such as nul";
  const std::string fault = PercentFault(name);
  return fault.empty() ? LengthFault("a product's name", name) : fault;
}

Product ReadProduct(const std::string& text, const std::string& folder, SourceReport& report) {
  Product product;
  try {
    Reader(folder, report, product).Read(toml::parse(text));
  } catch (const toml::parse_error& error) {
    report.Error(PlaceOf(error.source().begin), std::string(error.description()));
  }
  const std::string name = FileNamePart(product.name) + "-" + FileNamePart(product.version) + "-install.exe";
  const std::string beside = product.output.empty() ? folder : product.output;
  if (product.output.empty() || FolderFault(product.output).empty())
    product.output = FromPath((ToPath(beside) / ToPath(name)).lexically_normal());
  return product;
}
