#include "ProductScript.h"

#include <algorithm>

#include "Bundle.h"
#include "CarriedScript.h"
#include "Check.h"
#include "CheckReport.h"
#include "OrbitText.h"
#include "ScriptFile.h"
#include "ScriptVariables.h"

namespace {

const char WIZARD_PICTURE[] = "wizard_picture";

// The product's keys that every script can show, by the variables that hold them.
const struct {
  const char* szVariable;
  std::string Product::*pText;
} PRODUCT_VARIABLES[] = {{"program_name", &Product::name},
                         {"program_version", &Product::version},
                         {"publisher", &Product::publisher},
                         {"product_web", &Product::web},
                         {"product_mail", &Product::mail}};

std::string Narrow(const std::string& utf8) {
  std::string text;
  ToCp1250(utf8, text);
  return text;
}

class Maker {
 public:
  Maker(const Product& product, const std::vector<ProductFile>& files, SourceReport& report)
      : m_product(product), m_files(files), m_report(report) {
    for (const ProductVariable& variable : product.variables) m_given[variable.name] = variable.value;
  }

  void FromAuthor(const std::string& text, ProductScript& script) {
    const std::vector<std::string> declared = DeclaredVariables(text);
    ScriptVariables values = Values(declared);
    Finish(text, declared, values, script);
  }

  void FromCarried(ProductScript& script) {
    const std::vector<std::string> declared = DeclaredVariables(CarriedScript());
    ScriptVariables values = Values(declared);
    CarriedScriptFacts facts;
    facts.web = Narrow(m_product.web);
    facts.mail = Narrow(m_product.mail);
    facts.picture = SidePicture(script);
    facts.bProgram = bNameProgram(values);
    facts.bUninstaller = bNameUninstaller(values);
    facts.nNameLetters = values["program_name"].size();
    const std::string name = values["program_name"], maker = Narrow(FileNamePart(m_product.publisher));
    values["default_path"] = maker.empty() ? name : maker + "\\" + name;
    values["program_folder"] = name;
    Finish(CarriedScriptFor(facts), declared, values, script);
  }

 private:
  static bool bHas(const std::vector<std::string>& names, const std::string& name) {
    return std::find(names.begin(), names.end(), name) != names.end();
  }

  // What is not given gives way to the script's own value.
  ScriptVariables Values(const std::vector<std::string>& declared) const {
    ScriptVariables values;
    for (const auto& row : PRODUCT_VARIABLES) {
      const std::string& text = m_product.*row.pText;
      if (!text.empty() || !bHas(declared, row.szVariable)) values[row.szVariable] = Narrow(text);
    }
    return values;
  }

  SourceReport::Place PlaceOf(const std::string& variable) const {
    for (const ProductVariable& given : m_product.variables)
      if (given.name == variable) return given.place;
    return PlaceOfFiles();
  }
  SourceReport::Place PlaceOfFiles() const { return m_product.places.at("files"); }

  bool bHasFile(const std::string& name) const {
    return std::any_of(m_files.begin(), m_files.end(),
                       [&](const ProductFile& file) { return FoldName(file.header.csName.Text()) == FoldName(name); });
  }

  // NAME.exe, else the only program that is no uninstaller.
  std::string FindProgram(const std::string& name) const {
    if (bHasFile(name + ".exe")) return name + ".exe";
    std::vector<std::string> programs;
    for (const ProductFile& file : m_files) {
      const std::string folded = FoldName(file.header.csName.Text());
      const bool bProgram = folded.size() > 4 && folded.substr(folded.size() - 4) == ".exe";
      if (bProgram && folded.find('\\') == std::string::npos && folded.rfind("uninstall", 0) != 0)
        programs.push_back(file.header.csName.Text());
    }
    return programs.size() == 1 ? programs[0] : "";
  }

  bool bNameProgram(ScriptVariables& values) {
    const auto given = m_given.find("program_file");
    const std::string program = given == m_given.end() ? FindProgram(values["program_name"]) : given->second;
    values["program_file"] = values["colvane_file"] = program;
    values["colvane_link"] = values["program_name"] + ".lnk";
    if (program.empty() && given == m_given.end())
      m_report.Warning(PlaceOfFiles(),
                       "no file is known to be the program: say program_file = \"...\" under [variables]");
    if (!program.empty() && !bHasFile(program))
      m_report.Warning(PlaceOf("program_file"), "the product's files hold no '" + ToUtf8(program.c_str()) + "'");
    return !program.empty();
  }

  bool bNameUninstaller(ScriptVariables& values) {
    values["uninstall"] = bHasFile("UnInstall01.exe") ? "UnInstall01.exe" : "";
    values["uninstall_link"] = "UnInstall " + values["program_name"] + ".lnk";
    if (bHasFile("UnInstall.exe")) return true;
    m_report.Warning(PlaceOfFiles(), "the product's files hold no UnInstall.exe: it can be installed, but not removed");
    return false;
  }

  // As Windows will find it: whatever the case of its letters.
  bool bHasPicture(const std::string& name) const {
    std::error_code ignored;
    for (const auto& entry : std::filesystem::directory_iterator(ToPath(m_product.pictures), ignored))
      if (entry.is_regular_file(ignored) && FoldName(Narrow(FromPath(entry.path().filename()))) == FoldName(name))
        return true;
    return false;
  }

  std::string SidePicture(ProductScript& script) {
    const auto given = m_given.find(WIZARD_PICTURE);
    if (given == m_given.end()) {
      script.bSidePicture = !bHasPicture(BUNDLE_SIDE_PICTURE);
      return BUNDLE_SIDE_PICTURE;
    }
    const std::string name = given->second;
    const bool bWord = !name.empty() && std::all_of(name.begin(), name.end(), [](char c) {
      return piece::bIsWordLetter(c) || c == '.' || c == '-';
    });
    if (!bWord || (name.rfind("IDB_", 0) != 0 && !bHasPicture(name)))
      m_report.Error(PlaceOf(WIZARD_PICTURE), "the pictures hold no '" + ToUtf8(name.c_str()) + "'");
    m_given.erase(given);
    return name;
  }

  // What the product file says comes last and wins.
  void Finish(const std::string& text, std::vector<std::string> names, ScriptVariables& values, ProductScript& script) {
    for (const auto& [name, value] : values) names.push_back(name);
    const std::vector<Piece> candidates(names.begin(), names.end());
    for (const auto& [name, value] : m_given) {
      const std::string hint = bHas(names, name) ? "" : NearMiss(name, candidates);
      if (!hint.empty())
        m_report.Warning(PlaceOf(name),
                         "the script has no variable '" + ToUtf8(name.c_str()) + "': it is added" + hint);
      values[name] = value;
    }
    script.text = WithVariables(text, values);
  }

  const Product& m_product;
  const std::vector<ProductFile>& m_files;
  SourceReport& m_report;
  ScriptVariables m_given;
};

}  // namespace

std::vector<std::string> ProductVariableNames() {
  std::vector<std::string> names;
  for (const auto& row : PRODUCT_VARIABLES) names.push_back(row.szVariable);
  return names;
}

bool bMakeScript(const Product& product, const std::vector<ProductFile>& files, SourceReport& report, FILE* pFaults,
                 ProductScript& script) {
  Maker maker(product, files, report);
  if (product.script.empty()) return maker.FromCarried(script), true;
  CheckJob job;
  job.scripts = {product.script};
  job.options.variables = ProductVariableNames();
  for (const ProductVariable& variable : product.variables)
    job.options.variables.push_back(ToUtf8(variable.name.c_str()));
  ScriptFile file;
  if (CheckScripts(job, pFaults, pFaults) != 0 || !bReadScriptFile(product.script, file)) return false;
  maker.FromAuthor(file.text, script);
  return true;
}
