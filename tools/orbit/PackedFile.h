// A stamped program and its parts: image, perhaps a bundle, payload.
#pragma once

#include <string>

#include "archive/Payload.h"

class PackedFile {
 public:
  // Opens a file (UTF-8 path). Throws OrbitError when it cannot be read or has no stamp.
  explicit PackedFile(const std::string& path);

  const SfxStamp& Stamp() const { return m_stamp; }
  // False when the stamp points past the end of the file.
  bool bHolds() const { return m_bHolds; }
  // Where the bundle begins; it ends at the payload. They are the same without one.
  uint32_t BundleOffset() const { return m_bundle; }
  uint32_t BundleSize() const { return m_stamp.payloadOffset - m_bundle; }

  // Each writes a whole product archive. False when the payload is damaged or the output cannot be written.
  bool bCopyBundle(OsFile& output);
  bool bExpandPayload(OsFile& output, uint32_t& size);

 private:
  OsFile m_file;
  SfxStamp m_stamp;
  bool m_bHolds = false;
  uint32_t m_bundle = 0;
};

// Writes the product archive that a packed or stamped file carries; both paths are UTF-8. Throws OrbitError.
void TakeOutArchive(const std::string& packed, const std::string& output);
