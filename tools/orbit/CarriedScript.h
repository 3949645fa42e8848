// The installer script that setup carries, made to fit a product that brings none of its own.
#pragma once

#include <string>

// What it is to speak of; code page 1250. The product's name and version are variables and no part of this.
struct CarriedScriptFacts {
  std::string picture;        // the side picture: a file of the pictures or a bitmap resource of the setup program
  std::string web, mail;      // shown on the last page; empty: left out
  bool bProgram = false;      // there is one to make a shortcut to
  bool bUninstaller = false;  // there is an UnInstall.exe to make a shortcut to
  size_t nNameLetters = 0;    // a long name gets more room in the texts that it stands in
};

// The carried script as it stands, and with the product's facts in place of the sample's. The latter uses the variables
// of CARRIED_SCRIPT_NEEDS.
std::string CarriedScript();
std::string CarriedScriptFor(const CarriedScriptFacts& facts);

inline const char* const CARRIED_SCRIPT_NEEDS[] = {"program_name", "program_version", "product_web",   "product_mail",
                                                   "colvane_file", "colvane_link",    "uninstall_link"};
