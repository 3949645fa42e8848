// orbit: makes and verifies setup programs from the command line. Exit codes: 0 done, 1 refused, failed or something
// found wrong, 2 wrong usage.
#include <CLI/CLI.hpp>
#include <cstdio>
#include <string>
#include <vector>

#include "List.h"
#include "OrbitText.h"
#include "Pack.h"

namespace {

int PrintSummary(const PackJob& job, const PackSummary& summary) {
  std::printf("%s: %s files, %s bytes in, product archive %s bytes, %s bytes out\n", job.output.c_str(),
              std::to_string(summary.files).c_str(), std::to_string(summary.bytesIn).c_str(),
              std::to_string(summary.archiveBytes).c_str(), std::to_string(summary.bytesOut).c_str());
  return 0;
}

int Run(std::vector<std::string> arguments) {
  CLI::App app("Makes and verifies self-extracting setup programs.", "orbit");
  app.require_subcommand(1);
  PackJob job;
  job.pProgress = stderr;
  std::string listed;
  CLI::App* const pack = app.add_subcommand("pack", "Pack a folder into a copy of the setup program");
  pack->add_option("FOLDER", job.folder, "The product's files")->required();
  pack->add_option("--setup", job.setup, "The setup program, unstamped")->required();
  pack->add_option("--output", job.output, "The stamped setup program to make")->required();
  CLI::App* const archive = app.add_subcommand("archive", "Pack a folder into a product archive only");
  archive->add_option("FOLDER", job.folder, "The product's files")->required();
  archive->add_option("--output", job.output, "The product archive to make")->required();
  CLI::App* const list = app.add_subcommand("list", "List and verify a product archive or a stamped setup program");
  list->add_option("FILE", listed, "The file")->required();
  try {
    app.parse(std::move(arguments));
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? 0 : 2;
  }
  try {
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
