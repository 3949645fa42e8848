// Writes values into the INIT block of a wizard script's text.
#pragma once

#include <map>
#include <string>
#include <vector>

// Texts are code page 1250. A value may hold anything but zero bytes.
using ScriptVariables = std::map<std::string, std::string>;

// The names that the script's INIT block declares, in order.
std::vector<std::string> DeclaredVariables(const std::string& script);

// The script with these values: a declaration has its value exchanged where it stands, the others stand at the end of
// the block, in the order of their names. A script without a block gets one. The script must have no errors.
std::string WithVariables(const std::string& script, const ScriptVariables& variables);
