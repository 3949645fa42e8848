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
#include "NewProduct.h"
#include "OrbitText.h"
#include "Pack.h"
#include "PackProduct.h"
#include "PackedFile.h"
#include "Preview.h"
#include "ProductScript.h"
#include "Run.h"
#include "RunSteps.h"
#ifdef _WIN32
#include <fcntl.h>
#include <io.h>
#include <windows.h>
#endif

namespace {

// pack and archive; the options that are not given are empty.
struct PackCommand {
  std::string source, output;
  SetupPrograms programs;

  bool bFolder() const {
    std::error_code ignored;
    return std::filesystem::is_directory(ToPath(source), ignored);
  }
};

// An option that a script left empty must not pass for one that was not given.
std::string NotEmpty(const std::string& text) { return text.empty() ? "must not be empty" : ""; }

CLI::App* AddPack(CLI::App& app, PackCommand& command) {
  CLI::App* const pack = app.add_subcommand("pack", "Make one executable of a product that installs it");
  pack->add_option("PRODUCT", command.source, "The product file (TOML), or a folder of files")->required();
  pack->add_option("--output", command.output, "The executable to make, in place of the product file's")
      ->check(NotEmpty);
  pack->add_option("--setup", command.programs.setup, "The setup program, unstamped")->check(NotEmpty);
  pack->add_option("--starter", command.programs.bootstrap, "The program to stand in front")->check(NotEmpty);
  pack->footer(ProgramsHelp() +
               "The script is checked first, as by orbit check. docs/product-file.md describes the product file.\n"
               "A folder needs --setup and --output: it is put into a stamped copy of the setup program, which is\n"
               "started with its own path as the argument.");
  return pack;
}

void CheckPackUsage(const PackCommand& command) {
  if (!command.bFolder()) return;
  const std::filesystem::path product = ToPath(command.source) / "product.toml";
  std::error_code ignored;
  if (command.programs.setup.empty() && std::filesystem::is_regular_file(product, ignored))
    throw CLI::ValidationError("PRODUCT", command.source + " is a folder: say " + FromPath(product));
  if (command.programs.setup.empty()) throw CLI::RequiredError("--setup, to pack a folder,");
  if (command.output.empty()) throw CLI::RequiredError("--output, to pack a folder,");
  if (!command.programs.bootstrap.empty()) throw CLI::ExcludesError("PRODUCT, a folder,", "--starter");
}

CLI::App* AddArchive(CLI::App& app, PackCommand& command) {
  CLI::App* const archive = app.add_subcommand("archive", "Make a product archive, or take it out of a packed file");
  archive->add_option("SOURCE", command.source, "The folder of the product's files, or a packed file")->required();
  archive->add_option("--output", command.output, "The product archive to make")->required()->check(NotEmpty);
  return archive;
}

std::string Text(uint64_t number) { return std::to_string(number); }

int PackFolder(const PackCommand& command) {
  PackJob job;
  job.folder = command.source;
  job.setup = command.programs.setup;
  job.output = command.output;
  job.pProgress = stderr;
  const PackSummary summary = Pack(job);
  std::printf("%s: %s files, %s bytes in, product archive %s bytes, %s bytes out\n", job.output.c_str(),
              Text(summary.archive.files).c_str(), Text(summary.archive.bytesIn).c_str(),
              Text(summary.archive.archiveBytes).c_str(), Text(summary.bytesOut).c_str());
  return 0;
}

int PackSource(const PackCommand& command) {
  if (command.bFolder()) return PackFolder(command);
  ProductJob job;
  job.product = command.source;
  job.programs = command.programs;
  job.output = command.output;
  job.pProgress = stderr;
  const ProductSummary summary = PackProduct(job);
  std::printf("%s: %s files, %s bytes in, product archive %s bytes\n", summary.output.c_str(),
              Text(summary.archive.files).c_str(), Text(summary.archive.bytesIn).c_str(),
              Text(summary.archive.archiveBytes).c_str());
  const struct {
    const char* szPart;
    uint64_t bytes;
  } PARTS[] = {{"starter", summary.starterBytes},
               {"bundle", summary.bundle.archiveBytes},
               {"payload", summary.payloadBytes},
               {"whole", summary.bytesOut}};
  for (const auto& part : PARTS) std::printf("  %-8s%10s bytes\n", part.szPart, Text(part.bytes).c_str());
  return 0;
}

int MakeArchive(const PackCommand& command) {
  if (command.bFolder()) return PackFolder(command);
  TakeOutArchive(command.source, command.output);
  std::printf("%s: the product archive of %s\n", command.output.c_str(), command.source.c_str());
  return 0;
}

int PrintNew(const std::vector<std::string>& files) {
  for (const std::string& file : files) std::printf("%s\n", file.c_str());
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
  dump->add_option("--output", job.output, "Write a file in code page 1250 instead of printing")->check(NotEmpty);
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

// A script may show what every product gives it without declaring it.
CheckJob WithProductVariables(CheckJob job) {
  const std::vector<std::string> names = ProductVariableNames();
  job.options.variables.insert(job.options.variables.end(), names.begin(), names.end());
  return job;
}

CLI::App* AddPreview(CLI::App& app, PreviewCommand& command) {
  CLI::App* const preview = app.add_subcommand("preview", "Show a wizard script with native windows");
  preview->add_option("SCRIPT", command.script, "The wizard script; it is read again when it changes")->required();
  preview->add_option("--page", command.page, "NAME: the dialog to begin with; with --picture the only one");
  preview->add_option("--dpi", command.iDpi, "N: dots per inch (where Wine runs it)")->check(CLI::Range(72, 480));
  preview->add_option("--picture", command.folder, "DIR: write a PNG of every dialog there, and end")->check(NotEmpty);
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
  PackCommand packing;
  CLI::App* const pack = AddPack(app, packing);
  CLI::App* const archive = AddArchive(app, packing);
  CLI::App* const begin =
      app.add_subcommand("new", "Begin a product: a folder with a product file that packs as it is");
  begin->add_option("NAME", packing.source, "The folder to make; its last part is the product's name")->required();
  begin->footer(
      "Makes product.toml and the folder files in it. The uninstaller is put there when it lies beside orbit or\n"
      "in the project's build. Then: orbit pack NAME/product.toml");
  std::string listed;
  CLI::App* const list =
      app.add_subcommand("list", "List and verify a packed file, a stamped setup program or a product archive");
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
    if (pack->parsed()) CheckPackUsage(packing);
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? 0 : 2;
  }
  try {
    if (check->parsed()) return CheckScripts(WithProductVariables(checkJob), stdout, stderr);
    if (run->parsed()) return RunScript(runJob, stdout, stderr);
    if (preview->parsed()) return StartPreview(previewCommand);
    if (dump->parsed()) return DumpScript(dumpJob, stdout, stderr);
    const InterruptWatch watch;  // these have temporary files to take away; whatever else runs just ends
    if (list->parsed()) return List(listed, stdout, stderr) == 0 ? 0 : 1;
    if (begin->parsed()) return PrintNew(NewProduct(packing.source));
    return archive->parsed() ? MakeArchive(packing) : PackSource(packing);
  } catch (const std::exception& error) {
    std::fprintf(stderr, "orbit: %s\n", error.what());
    return 1;
  }
}

// What was to be printed and could not be is as bad as a file that could not be written.
int RunAndPrint(std::vector<std::string> arguments) {
  const int iCode = Run(std::move(arguments));
  if (std::fflush(stdout) == 0 && !std::ferror(stdout)) return iCode;
  std::fputs("orbit: the output cannot be written: is the drive full?\n", stderr);
  return iCode ? iCode : 1;
}

}  // namespace

// CLI11 takes its arguments last to first.
#ifdef _WIN32
// Everything is printed in UTF-8. A console is told so, and gets its own code page back; it must not get a character in
// pieces or as letters of another code page either: hence the buffers and the binary mode.
class Utf8Console {
 public:
  Utf8Console() : m_uFormer(GetConsoleOutputCP()) {
    SetConsoleOutputCP(CP_UTF8);
    for (FILE* const pStream : {stdout, stderr}) {
      std::setvbuf(pStream, nullptr, _IOFBF, 1 << 16);
      if (_isatty(_fileno(pStream))) _setmode(_fileno(pStream), _O_BINARY);
    }
  }
  ~Utf8Console() {
    for (FILE* const pStream : {stdout, stderr}) std::fflush(pStream);
    SetConsoleOutputCP(m_uFormer);
  }
  Utf8Console(const Utf8Console&) = delete;
  Utf8Console& operator=(const Utf8Console&) = delete;

 private:
  const UINT m_uFormer;
};

extern "C" int wmain(int argc, wchar_t** argv) {
  const Utf8Console console;
  std::vector<std::string> arguments;
  for (int i = argc - 1; i > 0; i--) arguments.push_back(FromPath(std::filesystem::path(argv[i])));
  return RunAndPrint(std::move(arguments));
}
#else
int main(int argc, char** argv) {
  std::vector<std::string> arguments;
  for (int i = argc - 1; i > 0; i--) arguments.emplace_back(argv[i]);
  return RunAndPrint(std::move(arguments));
}
#endif
