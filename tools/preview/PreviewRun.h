// What `orbit preview` does.
#pragma once

#include <string>

struct PreviewJob {
  std::string script;  // UTF-8 path
  std::string page;    // the dialog to begin with (of pictures: the only one); empty: the first (all)
  std::string folder;  // where pictures of the dialogs go; empty: a person looks at them
};

// Returns the exit code: 0; the loader's result for a script that cannot be loaded; 2 for an unknown page or a picture
// that cannot be written.
int RunPreview(const PreviewJob& job);
