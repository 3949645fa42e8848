#include "PackProduct.h"

#include <algorithm>
#include <fstream>
#include <iterator>

#include "Bundle.h"
#include "IconFile.h"
#include "OrbitText.h"
#include "Pack.h"
#include "PeImage.h"
#include "PeResources.h"
#include "ProductFile.h"
#include "ProductScript.h"
#include "SetupImage.h"
#include "SfxFile.h"
#include "SidePicture.h"

namespace fs = std::filesystem;

namespace {

const uint32_t RESOURCE_BITMAP = 2;
const std::streamoff MOST_BYTES = 64 << 20;  // of a program, an icon or a product file
const char16_t SAMPLE_PICTURE[] = u"IDB_PLUMO";
const char SAMPLE_PICTURE_WORD[] = "IDB_PLUMO";

template <class Content>
Content ReadWhole(const std::string& path) {
  std::error_code ignored;
  std::ifstream file(ToPath(path), std::ios::binary | std::ios::ate);
  Content content;
  if (!file || fs::is_directory(ToPath(path), ignored)) throw OrbitError("cannot read " + path);
  if (file.tellg() > MOST_BYTES) throw OrbitError(path + " is larger than 64 MB");
  file.seekg(0);
  content.assign(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
  if (file.bad()) throw OrbitError("cannot read " + path);
  return content;
}

std::vector<uint8_t> ReadProgram(const std::string& path) {
  OsFile file;
  OpenSetup(path, file);
  std::vector<uint8_t> image = ReadWhole<std::vector<uint8_t>>(path);
  if (FindOverlay(image) != image.size())
    throw OrbitError(path + " has something behind its last section: give the program as it was linked");
  return image;
}

// The sample's picture in the setup program: as zeros it takes no room in the bundle.
void BlankPicture(std::vector<uint8_t>& image) {
  for (const auto& [way, data] : ReadResources(image, ReadPeHeaders(image))) {
    if (way[0] != ById(RESOURCE_BITMAP) || way[1].name != SAMPLE_PICTURE) continue;
    const auto found = std::search(image.begin(), image.end(), data.bytes.begin(), data.bytes.end());
    if (found != image.end()) std::fill_n(found, data.bytes.size(), uint8_t{0});
  }
}

class ProductPacker {
 public:
  ProductPacker(const ProductJob& job, const std::string& text)
      : m_job(job),
        m_report(job.product, text),
        m_product(ReadProduct(text, FromPath(ToPath(job.product).parent_path()), m_report)) {
    if (!job.output.empty()) m_product.output = job.output;
    const fs::path pictures = ToPath(m_product.script).parent_path() / "pict";
    std::error_code ignored;
    if (m_product.pictures.empty() && !m_product.script.empty() && fs::is_directory(pictures, ignored))
      m_product.pictures = FromPath(pictures);  // where orbit preview finds them as well
  }

  ProductSummary Pack() {
    StopOnErrors(true);
    SetupPrograms programs = m_job.programs;
    FindPrograms(programs);
    std::vector<ProductFile> files = ScanFolder(m_product.files);
    WarnOfName();
    ProductScript script;
    const bool bScript = bMakeScript(m_product, files, m_report, m_job.pFaults, script);
    const std::vector<uint8_t> icon = ReadIcon();
    StopOnErrors(bScript);
    std::vector<uint8_t> starter = ReadProgram(programs.bootstrap), setup = ReadProgram(programs.setup);
    if (script.text.find(SAMPLE_PICTURE_WORD) == std::string::npos) BlankPicture(setup);
    SetResources(starter, icon, m_product.output);
    SetResources(setup, icon, BUNDLE_SETUP);
    const std::vector<std::string> inputs = {programs.setup, programs.bootstrap, m_job.product, m_product.script,
                                             m_product.icon};
    CheckOutput(m_product.output, m_product.files, inputs);
    if (!m_product.pictures.empty()) CheckOutput(m_product.output, m_product.pictures, inputs);
    return Write(std::move(starter), {std::move(setup), script.text, SidePicture(script), m_product.pictures}, files,
                 programs.bootstrap);
  }

 private:
  void StopOnErrors(bool bGood) {
    if (m_report.Print(m_job.pFaults) > 0 || !bGood)
      throw OrbitError(m_job.product + " has errors: nothing was packed");
  }

  // Windows loads libraries that lie beside programs of these names.
  void WarnOfName() {
    const std::string name = FoldName(FromPath(ToPath(m_product.output).filename()));
    if (name == "setup.exe" || name == "install.exe")
      m_report.Warning(m_product.places["output"],
                       "a program named " + name +
                           " is started with libraries from its own folder: another name is "
                           "safer");
  }

  static std::vector<uint8_t> SidePicture(const ProductScript& script) {
    return script.bSidePicture ? MakeSidePicture() : std::vector<uint8_t>();
  }

  // Empty when the product has no icon, or one that is none, which is reported.
  std::vector<uint8_t> ReadIcon() {
    if (m_product.icon.empty()) return {};
    try {
      std::vector<uint8_t> icon = ReadWhole<std::vector<uint8_t>>(m_product.icon);
      ReadIconFile(icon);
      return icon;
    } catch (const OrbitError& error) {
      m_report.Error(m_product.places["icon"], error.what());
      return {};
    }
  }

  // The setup program gets them as well: it shows the icon in its windows.
  void SetResources(std::vector<uint8_t>& image, const std::vector<uint8_t>& icon, const std::string& name) const {
    PeVersionInfo info;
    info.product = m_product.name;
    info.version = m_product.version;
    info.publisher = m_product.publisher;
    info.description = m_product.name + " Setup";
    info.originalName = FromPath(ToPath(name).filename());
    SetPeResources(image, icon, info);
  }

  ProductSummary Write(std::vector<uint8_t> starter, const BundleContent& content, std::vector<ProductFile>& files,
                       const std::string& model) {
    ProductSummary summary;
    summary.output = m_product.output;
    summary.starterBytes = starter.size();
    OutputFile bundle(m_product.output), archive(m_product.output), output(m_product.output);
    summary.bundle = WriteBundle(content, bundle);
    summary.archive = WriteArchive(files, m_product.files, archive, m_job.pProgress, 9);
    SfxFile sfx(output, m_product.output);
    sfx.PutImage(std::move(starter));
    sfx.PutFile(bundle.TemporaryPath(), "the bundle");
    sfx.PutPayload(archive.TemporaryPath(), summary.archive.archiveBytes, m_job.pProgress);
    sfx.Finish();
    summary.payloadBytes = sfx.PayloadSize();
    summary.bytesOut = sfx.Size();
    output.Commit(model);
    return summary;
  }

  const ProductJob& m_job;
  SourceReport m_report;
  Product m_product;
};

}  // namespace

ProductSummary PackProduct(const ProductJob& job) {
  std::string text = ReadWhole<std::string>(job.product);
  if (text.rfind("\xEF\xBB\xBF", 0) == 0) text.erase(0, 3);
  return ProductPacker(job, text).Pack();
}
