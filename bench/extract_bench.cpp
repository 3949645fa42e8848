// Measures extraction as the installer does it against a loop that merely inflates, creates and writes the same files,
// in one run, and the memory that it takes. See README.md.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>
#include <vector>

#include "PeakMemory.h"
#include "PlainLoop.h"
#include "SampleProduct.h"
#include "archive/CNArchive.h"
#include "installer/InstallJournal.h"

namespace fs = std::filesystem;

namespace {

const double BOUND = 1.2;
const double MEGABYTE = 1024 * 1024;

struct Options {
  uint64_t megabytes = 500;
  int files = 2000;
  int rounds = 5;
  std::string folder = "bench-scratch";
  std::string archive;  // empty: one is made
};

struct Percents : ArchiveProgress {
  void OnPercent(int) override {}
};

template <class Work>
double Milliseconds(Work work) {
  const auto start = std::chrono::steady_clock::now();
  work();
  return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
}

[[noreturn]] void Fail(const char* szWhat) {
  std::fprintf(stderr, "extract_bench: %s\n", szWhat);
  std::exit(1);
}

// The times of one round, in milliseconds.
struct Round {
  double check, extract, plain;
};

class Bench {
 public:
  Bench(const std::string& archive, const std::string& folder) : m_archive(archive), m_folder(folder) {
    if (CNArchive(archive.c_str()).ListEntries(m_entries) != ArchiveOk) Fail("the archive cannot be read");
  }

  uint64_t ContentBytes() const {
    uint64_t bytes = 0;
    for (int i = 0; i < m_entries.Size(); i++) bytes += m_entries[i]->unpackedSize;
    return bytes;
  }
  int Files() const { return m_entries.Size(); }

  // Both ways through the whole archive, each into an empty folder of its own, by turns of a few megabytes, so that
  // whatever else the machine does meets both alike; who goes first changes from turn to turn. The check has read the
  // archive before, so that both find it in the system's cache.
  Round Run() {
    Round round = {};
    round.check = Milliseconds([&] {
      if (CNArchive(m_archive.c_str()).CheckArchive(&m_percents) != ArchiveOk)
        Fail("the archive's check value is wrong");
    });
    Prepare();
    CNArchive archive(m_archive.c_str());
    auto journal = KeepJournal(archive);
    PlainLoop plain;
    CNArray<CNArchiveEntry> entries;
    round.extract = Milliseconds([&] { archive.ListEntries(entries); });
    if (!plain.bOpen(m_archive)) Fail("the plain loop failed");
    bool bPlainFirst = false;
    for (int iFrom = 0; iFrom < Files();) {
      const int iTo = TurnEnd(iFrom);
      for (const bool bPlain : {bPlainFirst, !bPlainFirst})
        (bPlain ? round.plain : round.extract) += Milliseconds([&] {
          for (int i = iFrom; i < iTo; i++) bPlain ? ExtractPlainly(plain) : ExtractOne(archive, i);
        });
      bPlainFirst = !bPlainFirst;
      iFrom = iTo;
    }
    journal.reset();
    Remove();
    return round;
  }

  // All of it as the installer does it, for the memory that it takes.
  void Extract() {
    CNArchive archive(m_archive.c_str());
    CNArray<CNArchiveEntry> entries;
    auto journal = KeepJournal(archive);
    archive.CheckArchive(&m_percents);
    archive.ListEntries(entries);
    for (int i = 0; i < entries.Size(); i++) ExtractOne(archive, i);
    journal.reset();
    Remove();
  }

 private:
  // The installer's list of what it made: part of its work, and of the measure. To be closed before the files go.
  std::unique_ptr<InstallJournal> KeepJournal(CNArchive& archive) const {
    auto journal = std::make_unique<InstallJournal>((m_folder + "\\").c_str());
    archive.SetJournal(journal.get());
    return journal;
  }

  void Remove() {
    std::error_code error;
    for (const char* szSuffix : {"", ".plain"})
      if (!error) fs::remove_all(m_folder + szSuffix, error);
    if (error) Fail("the extracted files cannot be removed");
  }

  // A turn is 4 MB or a hundred entries.
  int TurnEnd(int iFrom) const {
    uint64_t bytes = 0;
    int i = iFrom;
    while (i < Files() && i < iFrom + 100 && bytes < 4 * 1024 * 1024) bytes += m_entries[i++]->unpackedSize;
    return i;
  }

  void ExtractOne(CNArchive& archive, int i) {
    if (archive.ExtractEntry(i, (m_folder + "\\").c_str(), &m_percents) != ArchiveOk) Fail("extraction failed");
  }
  void ExtractPlainly(PlainLoop& plain) {
    if (!plain.bExtractNext(m_folder + ".plain\\")) Fail("the plain loop failed");
  }

  // The plain loop finds its folders made; extraction makes them within its time.
  void Prepare() {
    Remove();
    for (int i = 0; i < Files(); i++) {
      std::string name = m_entries[i]->csName.Text();
      std::replace(name.begin(), name.end(), '\\', '/');
      fs::create_directories((fs::path(m_folder + ".plain") / name).parent_path());
    }
  }

  std::string m_archive;
  std::string m_folder;
  CNArray<CNArchiveEntry> m_entries;
  Percents m_percents;
};

double Ratio(const Round& round) { return round.extract / round.plain; }

void PrintMemory(const char* szAfter) {
  const PeakMemory peak = GetPeakMemory();
  std::printf("peak memory %-28s working set %.1f MB, private %.1f MB\n", szAfter, peak.workingSet / MEGABYTE,
              peak.privateBytes / MEGABYTE);
}

// Memory first, on a small and then on the whole product: a peak never falls, so what the second adds shows.
bool Measure(const Options& options, const std::string& archive) {
  const std::string small = options.folder + "/small.dat", target = options.folder + "/out";
  PrintMemory("at the start:");
  if (!bMakeSampleProduct(small, {5 * 1024 * 1024, 20})) Fail("the small product cannot be made");
  PrintMemory("after making a 5 MB product:");
  Bench smallBench(small, target);
  smallBench.Extract();
  PrintMemory("after extracting it:");
  Bench bench(archive, target);
  bench.Extract();
  PrintMemory("after the whole product:");

  std::printf("%d files, %.1f MB of content, archive of %.1f MB\n", bench.Files(), bench.ContentBytes() / MEGABYTE,
              fs::file_size(archive) / MEGABYTE);
  std::vector<Round> rounds;
  for (int i = 0; i < options.rounds; i++) {
    const Round round = bench.Run();
    std::printf(
        "round %d: check %.0f ms, extraction %.0f ms, plain loop %.0f ms: ratio %.3f, with the check pass %.3f\n",
        i + 1, round.check, round.extract, round.plain, Ratio(round), (round.check + round.extract) / round.plain);
    std::fflush(stdout);
    rounds.push_back(round);
  }
  std::sort(rounds.begin(), rounds.end(), [](const Round& a, const Round& b) { return Ratio(a) < Ratio(b); });
  const double ratio = Ratio(rounds[rounds.size() / 2]);
  std::printf("extraction / plain loop, median: %.2f (bound %.1f)\n", ratio, BOUND);
  return ratio <= BOUND;
}

bool bParse(int argc, char** argv, Options& options) {
  for (int i = 1; i < argc; i++) {
    const char* const szValue = i + 1 < argc ? argv[i + 1] : nullptr;
    const bool bOption = strncmp(argv[i], "--", 2) == 0;
    if (!bOption)
      options.archive = argv[i];
    else if (!szValue)
      return false;
    else if (!strcmp(argv[i], "--size"))
      options.megabytes = strtoul(argv[++i], nullptr, 10);
    else if (!strcmp(argv[i], "--files"))
      options.files = atoi(argv[++i]);
    else if (!strcmp(argv[i], "--rounds"))
      options.rounds = atoi(argv[++i]);
    else if (!strcmp(argv[i], "--folder"))
      options.folder = argv[++i];
    else
      return false;
  }
  return options.megabytes > 0 && options.megabytes < 4000 && options.files > 0 && options.rounds > 0;
}

}  // namespace

int main(int argc, char** argv) {
  Options options;
  if (!bParse(argc, argv, options)) {
    std::fprintf(stderr, "usage: extract_bench [--size MB] [--files N] [--rounds N] [--folder SCRATCH] [ARCHIVE]\n");
    return 2;
  }
  // Everything in the scratch folder is removed in the end: it must be ours.
  if (!fs::create_directory(options.folder)) Fail("the scratch folder exists already");
  std::error_code error;
  std::string archive = options.archive;
  if (archive.empty()) {
    archive = options.folder + "/product.dat";
    std::printf("making a product of %d MB in %d files ...\n", static_cast<int>(options.megabytes), options.files);
    std::fflush(stdout);
    if (!bMakeSampleProduct(archive, {options.megabytes << 20, options.files})) Fail("the product cannot be made");
  }
  const bool bWithin = Measure(options, archive);
  fs::remove_all(options.folder, error);
  return bWithin ? 0 : 1;
}
