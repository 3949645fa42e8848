// The programs that go into a packed file, found where they lie when nobody says where.
#pragma once

#include <filesystem>
#include <string>

// UTF-8 paths.
struct SetupPrograms {
  std::string setup;      // setup.exe, unstamped
  std::string bootstrap;  // bootstrap.exe, which stands in front
};

// Fills in what is empty: first the program beside orbit itself, else the one of the project's build (build/windows).
// Throws OrbitError that says where it has looked.
void FindPrograms(SetupPrograms& programs);
// The uninstaller that new products begin with, from the same places; empty when there is none.
std::string FindUninstaller();

// The folder of the running program. Throws OrbitError when the system does not say.
std::filesystem::path OwnFolder();

// For --help.
std::string ProgramsHelp();
