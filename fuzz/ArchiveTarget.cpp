// An archive, checked, listed and extracted into the folder "out": whatever it holds, nothing stands beside that.
#include <filesystem>

#include "Fuzz.h"
#include "archive/CNArchive.h"

namespace {

const int MAX_ENTRIES = 16;

class Percent : public ArchiveProgress {
 public:
  void OnPercent(int iPercent) override { FUZZ_REQUIRE(iPercent >= 0 && iPercent <= 100); }
};

void Extract(const char* szFolder, bool bKeepFolder) {
  Percent percent;
  CNArchive archive("archive");
  archive.CheckArchive(&percent);
  CNArray<CNArchiveEntry> entries;
  archive.ListEntries(entries);
  const int iCount = entries.Size() < MAX_ENTRIES ? entries.Size() : MAX_ENTRIES;
  for (int i = 0; i <= iCount; i++) archive.ExtractEntry(i, szFolder, &percent, 10, 80, bKeepFolder);
  // Once more: the file is there, the walk begins anew.
  archive.ExtractEntry(0, szFolder, &percent, 0, 100, bKeepFolder);
}

}  // namespace

FUZZ_TARGET(archive, input) {
  FuzzWriteFile("archive", input);
  std::filesystem::create_directory("out");
  Extract("out\\", false);
  Extract("out\\", true);
  for (const auto& entry : std::filesystem::directory_iterator("."))
    FUZZ_REQUIRE(entry.path() == "./archive" || entry.path() == "./out" || entry.path() == "./execution.log");
  std::filesystem::remove_all("out");
  std::filesystem::remove("archive");
}
