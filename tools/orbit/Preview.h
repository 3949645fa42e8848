// Starts the preview of scripts, a Windows program of its own (tools/preview): directly on Windows, through
// scripts/preview.sh and Wine elsewhere.
#pragma once

#include <string>

struct PreviewCommand {
  std::string script;  // UTF-8 path
  std::string page;    // the dialog to begin with; empty: the first
  std::string folder;  // for pictures of the dialogs; empty: they are shown
  int iDpi = 0;        // dots per inch; 0: the usual
};

// Returns the preview's exit code, after it has ended. Throws OrbitError when it cannot be found or started.
int StartPreview(const PreviewCommand& command);
