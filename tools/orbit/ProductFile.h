// A product file (TOML, UTF-8): what a product is called and what goes into its setup. docs/product-file.md describes
// every key.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "SourceReport.h"

struct ProductVariable {
  std::string name, value;  // code page 1250
  SourceReport::Place place;
};

// Texts are UTF-8, but hold nothing that code page 1250 has not. What is not given is empty.
struct Product {
  std::string name, version, publisher, web, mail;
  // Paths from the current folder on; what must be there is there.
  std::string files, script, pictures, icon;
  std::string output;  // a file: NAME-VERSION-install.exe beside the product file unless it is given
  std::vector<ProductVariable> variables;
  std::map<std::string, SourceReport::Place> places;  // of the values, by their keys
};

// Reads the text of a product file that lies in `folder` (UTF-8 path, may be empty). Every fault is reported; after an
// error the product is not complete.
Product ReadProduct(const std::string& text, const std::string& folder, SourceReport& report);

// Why a text (UTF-8) cannot be the name of a product, or empty: it is part of file names, shortcuts and registry keys.
std::string NameFault(const std::string& name);
