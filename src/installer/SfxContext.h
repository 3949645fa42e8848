// What the launcher made for one run and the installer's commands read: paths only, each null until it is known. The
// launcher owns the object and deletes both files when the run has ended.
#pragma once

#include "foundation/os/Os.h"

struct SfxContext {
  CNString csTempFolder;    // with its trailing backslash
  CNString csExpandedFile;  // the temporary file that holds the product archive
  OsFile held;              // csExpandedFile, open for reading: a setup that starts now finds it in use
  CNString csExtraArchive;  // an archive for a folder "Savjetnici" beside it; this product has none

  // Null when there is none.
  const char* GetExpandedFile() const { return csExpandedFile.Ptr(); }
  const char* GetExtraArchive() const { return csExtraArchive.Ptr(); }
};
