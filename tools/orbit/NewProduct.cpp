#include "NewProduct.h"

#include <fstream>

#include "OrbitText.h"
#include "ProductFile.h"
#include "Programs.h"

namespace fs = std::filesystem;

namespace {

// {} is the product's name.
const char PRODUCT_FILE[] =
    R"(# What `orbit pack product.toml` makes a setup program of. Paths begin at this file's folder.
name = "{}"
version = "1.0.0"
# publisher = "Your company"
# web = "https://www.example.com"
# mail = "info@example.com"

# Everything in this folder is installed.
files = "files"

# An icon for the packed file and its windows; pictures for the wizard, of which wizard.bmp (160 by 440) is shown at the
# side; a wizard of your own in place of the one that orbit carries; another place for what is made.
# icon = "{}.ico"
# pictures = "pictures"
# script = "wizard.txt"
# output = "../build"

# Values for the variables of the wizard's script.
[variables]
program_file = "Readme.txt"   # what the shortcut, and OK on the last page, start: your program
desktop_shortcut = false      # whether these boxes begin ticked
quick_launch = false
)";
const char README[] = "{}\r\n\r\nReplace this file by those of your product.\r\n";

std::string Filled(std::string text, const std::string& name) {
  for (size_t at = 0; (at = text.find("{}", at)) != std::string::npos; at += name.size()) text.replace(at, 2, name);
  return text;
}

void WriteText(const fs::path& path, const std::string& text) {
  std::ofstream file(path, std::ios::binary);
  file << text;
  file.close();
  if (!file) throw OrbitError("cannot write " + FromPath(path));
}

std::vector<std::string> Fill(const fs::path& folder, const std::string& name) {
  std::vector<fs::path> paths = {folder / "product.toml", folder / "files" / "Readme.txt"};
  if (!fs::create_directory(folder / "files")) throw OrbitError("cannot make " + FromPath(folder / "files"));
  WriteText(paths[0], Filled(PRODUCT_FILE, name));
  WriteText(paths[1], "\xEF\xBB\xBF" + Filled(README, name));
  const std::string uninstaller = FindUninstaller();
  if (!uninstaller.empty()) {
    paths.push_back(folder / "files" / "UnInstall.exe");
    fs::copy_file(ToPath(uninstaller), paths.back());
  }
  std::vector<std::string> made;
  for (const fs::path& path : paths) made.push_back(FromPath(path));
  return made;
}

}  // namespace

std::vector<std::string> NewProduct(const std::string& folder) {
  fs::path path = ToPath(folder).lexically_normal();
  if (!path.has_filename()) path = path.parent_path();
  const std::string name = FromPath(path.filename());
  const std::string fault = NameFault(name);
  if (!fault.empty()) throw OrbitError("'" + name + "' cannot be used: " + fault);
  std::error_code error;
  if (!fs::create_directory(path, error))
    throw OrbitError(error ? "cannot make the folder " + folder + ": " + error.message()
                           : folder + " is there already: nothing was changed");
  try {
    return Fill(path, name);
  } catch (const std::exception&) {
    fs::remove_all(path, error);
    throw;
  }
}
