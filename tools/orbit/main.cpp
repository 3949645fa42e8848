// orbit: makes and verifies setup programs, and runs their wizard scripts, from the command line. Exit codes: 0 done, 1
// refused, failed or something found wrong, 2 wrong usage; run and dump have the script loader's results as well.
#include <CLI/CLI.hpp>
#include <cstdio>
#include <string>
#include <vector>

#include "Check.h"
#include "Dump.h"
#include "Interrupt.h"
#include "List.h"
#include "OrbitText.h"
#include "Pack.h"
#include "Preview.h"
#include "Run.h"
#include "RunSteps.h"

namespace {

int PrintSummary(const PackJob& job, const PackSummary& summary) {
  std::printf("%s: %s files, %s bytes in, product archive %s bytes, %s bytes out\n", job.output.c_str(),
              std::to_string(summary.files).c_str(), std::to_string(summary.bytesIn).c_str(),
              std::to_string(summary.archiveBytes).c_str(), std::to_string(summary.bytesOut).c_str());
  return 0;
}

CLI::App* AddRun(CLI::App& app, RunJob& job) {
  CLI::App* const run = app.add_subcommand("run", "Run a wizard script without a screen");
  run->add_option("SCRIPT", job.script, "The wizard script")->required();
  run->add_option("STEP", job.steps, "What to do, in order: see below");
  run->add_option("--set", job.settings, "NAME=VALUE: set a variable once the script is loaded")
      ->allow_extra_args(false);
  run->add_option("--answer", job.answers, "The answer for the next message box: see below")->allow_extra_args(false);
  run->footer(RUN_HELP);
  return run;
}

CLI::App* AddDump(CLI::App& app, DumpJob& job) {
  CLI::App* const dump = app.add_subcommand("dump", "Write a wizard script back as the engine understands it");
  dump->add_option("SCRIPT", job.script, "The wizard script")->required();
  dump->add_option("--output", job.output, "Write a file in code page 1250 instead of printing");
  dump->add_flag("--time", job.bTime, "Tell on the error output how long the loading took");
  dump->footer(DUMP_HELP);
  return dump;
}

CLI::App* AddCheck(CLI::App& app, CheckJob& job) {
  CLI::App* const check = app.add_subcommand("check", "Report every fault of wizard scripts");
  check->add_option("SCRIPT", job.scripts, "The wizard scripts")->required();
  check->add_option("--command", job.options.commands, "NAME: a command of a wizard program of your own")
      ->allow_extra_args(false);
  check->add_option("--variable", job.options.variables, "NAME: a variable that a program of your own sets")
      ->allow_extra_args(false);
  check->footer(CheckHelp());
  return check;
}

CLI::App* AddPreview(CLI::App& app, PreviewCommand& command) {
  CLI::App* const preview = app.add_subcommand("preview", "Show a wizard script with native windows");
  preview->add_option("SCRIPT", command.script, "The wizard script; it is read again when it changes")->required();
  preview->add_option("--page", command.page, "NAME: the dialog to begin with; with --picture the only one");
  preview->add_option("--dpi", command.iDpi, "N: dots per inch (where Wine runs it)")->check(CLI::Range(72, 480));
  preview->add_option("--picture", command.folder, "DIR: write a PNG of every dialog there, and end");
  preview->footer(
      "Prints events, commands and changed variables as they happen. Commands of the setup program are printed only.\n"
      "Ctrl+PgDn and Ctrl+PgUp show the next and the former dialog of the text. Pictures, clips and sounds are taken\n"
      "from the folder pict beside the script.");
  return preview;
}

int Run(std::vector<std::string> arguments) {
  CLI::App app("Makes and verifies self-extracting setup programs, and runs their wizard scripts.", "orbit");
  app.allow_windows_style_options(false);  // "/folder/file" is a path; subcommands made after this follow
  app.require_subcommand(1);
  PackJob job;
  job.pProgress = stderr;
  std::string listed;
  CLI::App* const pack = app.add_subcommand("pack", "Pack a folder into a copy of the setup program");
  pack->add_option("FOLDER", job.folder, "The product's files")->required();
  // Without a setup program only an archive would be made: a name that a script left empty must not ask for that.
  const auto notEmpty = [](const std::string& text) { return std::string(text.empty() ? "must not be empty" : ""); };
  pack->add_option("--setup", job.setup, "The setup program, unstamped")->required()->check(notEmpty);
  pack->add_option("--output", job.output, "The stamped setup program to make")->required()->check(notEmpty);
  CLI::App* const archive = app.add_subcommand("archive", "Pack a folder into a product archive only");
  archive->add_option("FOLDER", job.folder, "The product's files")->required();
  archive->add_option("--output", job.output, "The product archive to make")->required()->check(notEmpty);
  CLI::App* const list = app.add_subcommand("list", "List and verify a product archive or a stamped setup program");
  list->add_option("FILE", listed, "The file")->required();
  RunJob runJob;
  CLI::App* const run = AddRun(app, runJob);
  DumpJob dumpJob;
  CLI::App* const dump = AddDump(app, dumpJob);
  CheckJob checkJob;
  CLI::App* const check = AddCheck(app, checkJob);
  PreviewCommand previewCommand;
  CLI::App* const preview = AddPreview(app, previewCommand);
  try {
    app.parse(std::move(arguments));
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? 0 : 2;
  }
  try {
    if (check->parsed()) return CheckScripts(checkJob, stdout, stderr);
    if (run->parsed()) return RunScript(runJob, stdout, stderr);
    if (preview->parsed()) return StartPreview(previewCommand);
    if (dump->parsed()) return DumpScript(dumpJob, stdout, stderr);
    const InterruptWatch watch;  // these two have temporary files to take away; whatever else runs just ends
    if (list->parsed()) return List(listed, stdout, stderr) == 0 ? 0 : 1;
    return PrintSummary(job, Pack(job));
  } catch (const std::exception& error) {
    std::fprintf(stderr, "orbit: %s\n", error.what());
    return 1;
  }
}

}  // namespace

// CLI11 takes its arguments last to first.
#ifdef _WIN32
extern "C" int wmain(int argc, wchar_t** argv) {
  std::vector<std::string> arguments;
  for (int i = argc - 1; i > 0; i--) arguments.push_back(FromPath(std::filesystem::path(argv[i])));
  return Run(std::move(arguments));
}
#else
int main(int argc, char** argv) {
  std::vector<std::string> arguments;
  for (int i = argc - 1; i > 0; i--) arguments.emplace_back(argv[i]);
  return Run(std::move(arguments));
}
#endif
