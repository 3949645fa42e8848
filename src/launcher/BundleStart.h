// What the starter of a packed file (src/bootstrap) tells the setup program that it has put into a private folder.
// Without such a start there are no switches and nothing is read from beside the program.
#pragma once

#include <memory>

#include "installer/CarriedScripts.h"

// Setup makes this file in the folder when it ends by itself. Without it the starter knows that it was killed, whatever
// the exit code.
const char ENDED_FILE[] = "\\ended";

// Told in these two variables of the environment.
const wchar_t BUNDLE_VARIABLE[] = L"ORBIT_BUNDLE";
const wchar_t SWITCHES_VARIABLE[] = L"ORBIT_SWITCHES";

struct BundleStart {
  bool bStarted = false;  // false: nothing below is set
  CNString csFolder;      // the private folder, this program's own; full path without a trailing backslash
  std::unique_ptr<wchar_t[]> pSwitches;  // the packed file's command line behind the program's name; not null
};

// Reads both variables and takes them out of the environment, whatever they hold, so that no program that is started
// later inherits them. They are believed only when the folder is that of this program. To be called once, first thing.
void ReadBundleStart(BundleStart& start);

// To be called last: says that the run has come to its end. Nothing without a start from a bundle.
void TellEnd(const BundleStart& start);

// Takes the product's script from the folder in place of the carried one, and pictures from its folder pict and from
// nowhere else. start must outlive the wizard's windows. False, logged, when wizard.txt is not there or empty.
// Does nothing and returns true without a start from a bundle.
bool bUseBundle(const BundleStart& start, CarriedScripts& scripts);

// Where the payload is expanded to: give it to SetupSurroundings::szTempFolder. Null: the system's temporary folder.
inline const char* szTempFolderOf(const BundleStart& start) { return start.bStarted ? start.csFolder.Text() : nullptr; }
