#include "Pack.h"

#include "OrbitText.h"
#include "SetupImage.h"
#include "SfxFile.h"

namespace fs = std::filesystem;

void CheckOutput(const std::string& output, const std::string& folder, const std::vector<std::string>& inputs) {
  std::error_code error, ignored;
  const fs::path target = fs::weakly_canonical(fs::absolute(ToPath(output)), error);
  if (error) throw OrbitError("cannot write " + output + ": " + error.message());
  for (const std::string& input : inputs)
    if (fs::equivalent(target, ToPath(input), ignored)) throw OrbitError("the output would overwrite " + input);
  for (fs::path above = target.parent_path(); !above.empty(); above = above.parent_path()) {
    if (fs::equivalent(above, ToPath(folder), ignored))
      throw OrbitError("the output lies in the folder that is packed: choose another place");
    if (above == above.parent_path()) break;
  }
}

PackSummary Pack(const PackJob& job) {
  PackSummary summary;
  OsFile setup;
  const bool bSetup = !job.setup.empty();
  if (bSetup) OpenSetup(job.setup, setup);
  std::vector<ProductFile> files = ScanFolder(job.folder);
  CheckOutput(job.output, job.folder, bSetup ? std::vector{job.setup} : std::vector<std::string>{});
  OutputFile archive(job.output);
  summary.archive = WriteArchive(files, job.folder, archive, job.pProgress, job.iLevel);
  summary.bytesOut = summary.archive.archiveBytes;
  if (!bSetup) {
    archive.Commit("");
    return summary;
  }
  OutputFile output(job.output);
  SfxFile sfx(output, job.output);
  sfx.PutFile(SystemPath(job.setup), job.setup);
  sfx.PutPayload(archive.TemporaryPath(), summary.archive.archiveBytes, job.pProgress);
  sfx.Finish();
  summary.bytesOut = sfx.Size();
  output.Commit(job.setup);
  return summary;
}
