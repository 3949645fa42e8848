// The script of a product's wizard: the author's or the carried one, with the product's values written into its INIT
// block.
#pragma once

#include "FolderScan.h"
#include "ProductFile.h"

struct ProductScript {
  std::string text;           // code page 1250
  bool bSidePicture = false;  // it shows a side picture that the product does not bring
};

// The variables that every product's script has, declared or not.
std::vector<std::string> ProductVariableNames();

// Checks the author's script as `orbit check` does, printing to pFaults, and writes the values in. The files are the
// product's. What is wrong with the product's variables is reported; false when the script has errors or cannot be
// read.
bool bMakeScript(const Product& product, const std::vector<ProductFile>& files, SourceReport& report, FILE* pFaults,
                 ProductScript& script);
