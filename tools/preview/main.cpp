// orbit-preview: shows a wizard script with native windows. `orbit preview` starts it.
#include <CLI/CLI.hpp>
#include <cstdio>

#include "OrbitText.h"
#include "PreviewRun.h"
#include "window/ScreenScale.h"

// The program's own view of the screen does not matter: a system-wide number is asked for.
static void TellDpi(int iWanted) {
  const ScaleScope scope(ScreenScaling::ByScript);
  const int iDpi = static_cast<int>(dScreenScale() * 96 + 0.5);
  if (iWanted && iWanted != iDpi) std::fprintf(stderr, "note: the screen has %d dots per inch\n", iDpi);
}

extern "C" int wmain(int argc, wchar_t** argv) {
  std::vector<std::string> arguments;  // CLI11 takes them last to first
  for (int i = argc - 1; i > 0; i--) arguments.push_back(FromPath(std::filesystem::path(argv[i])));
  CLI::App app("Shows a wizard script as its user sees it, and tells what happens.", "orbit preview");
  app.allow_windows_style_options(false);
  PreviewJob job;
  app.add_option("SCRIPT", job.script, "The wizard script")->required();
  app.add_option("--picture", job.folder, "DIR: write a PNG of every dialog there, and end");
  app.add_option("--page", job.page, "NAME: the dialog to begin with; with --picture the only one");
  int iDpi = 0;
  app.add_option("--dpi", iDpi, "N: dots per inch; Wine's can be chosen, on Windows the system says what they are");
  try {
    app.parse(std::move(arguments));
    TellDpi(iDpi);
    return RunPreview(job);
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? 0 : 2;
  } catch (const std::exception& error) {
    std::fprintf(stderr, "error: %s\n", error.what());
    return 2;
  }
}
