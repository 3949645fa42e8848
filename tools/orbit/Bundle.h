// What a packed file carries besides the product: the setup program, the script of its wizard and the pictures.
#pragma once

#include "ArchiveFile.h"
#include "ProductFile.h"

struct BundleContent {
  std::vector<uint8_t> setup;    // the setup program
  std::string script;            // code page 1250
  std::vector<uint8_t> picture;  // the carried script's side picture; empty: none
  std::string pictures;          // a folder (UTF-8), or empty
};

// Names of the entries; pictures stand below BUNDLE_PICTURES.
inline const char BUNDLE_SETUP[] = "setup.exe", BUNDLE_SCRIPT[] = "wizard.txt", BUNDLE_PICTURES[] = "pict\\";
// The picture at the side of the carried script's pages.
inline const char BUNDLE_SIDE_PICTURE[] = "wizard.bmp";

// Writes the bundle into an empty output and closes it. The same content gives the same bytes: entries have no times.
ArchiveTotals WriteBundle(const BundleContent& content, OutputFile& output);
