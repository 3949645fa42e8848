#include "Pack.h"

#include "OrbitText.h"
#include "SetupImage.h"
#include "SfxFile.h"

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
