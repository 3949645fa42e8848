// Text of the orbit tool: UTF-8 from and to its user, code page 1250 inside archives and for the foundation's file
// functions.
#pragma once

#include <filesystem>
#include <stdexcept>
#include <string>
#include <vector>

#include "foundation/CNString.h"

// A refusal or failure; what() is the whole message for the user, in UTF-8.
struct OrbitError : std::runtime_error {
  using std::runtime_error::runtime_error;
};

// Convert a UTF-8 text. ToCp1250 returns false when code page 1250 cannot hold it.
bool ToCp1250(const std::string& utf8, std::string& text);
std::string ToUtf8(const char* szText);
// The characters of a UTF-8 text, one by one; a byte that is none stands for itself.
std::vector<std::string> Characters(const std::string& utf8);
// The first character that code page 1250 cannot hold, a zero byte too; empty without.
std::string ForeignCharacter(const std::string& utf8);
// With \n and \r in place of line ends.
std::string OneLine(const std::string& text);
// A text as part of a file's name on Windows: without the characters and ends that names cannot have.
std::string FileNamePart(const std::string& utf8);

std::filesystem::path ToPath(const std::string& utf8);
std::string FromPath(const std::filesystem::path& path);
// A path for the foundation's file functions. Throws OrbitError when code page 1250 cannot hold it.
std::string SystemPath(const std::string& utf8);
