// A self-extracting file, written part by part: an image, perhaps more, and last the payload.
#pragma once

#include <functional>
#include <optional>
#include <vector>

#include "OutputFile.h"
#include "PeImage.h"

// Calls take(bytes, count) for every block of a file from its start. Throws OrbitError.
void ForEachBlock(OsFile& file, const std::string& shownPath,
                  const std::function<void(const unsigned char*, size_t)>& take);

class SfxFile {
 public:
  // The output is empty; `name` (UTF-8) is the one that messages say. It must outlive this.
  SfxFile(OutputFile& output, std::string name) : m_output(output), m_name(std::move(name)) {}

  void Put(const unsigned char* pBytes, size_t nBytes);
  // Begins the file with an image whose checksum is to cover the whole of it.
  void PutImage(std::vector<uint8_t> image);
  // Appends a whole file, given by its path for the foundation's file functions.
  void PutFile(const std::string& path, const std::string& shownPath);
  // Appends the product archive as a zlib stream. pProgress null: no progress shown.
  void PutPayload(const std::string& archivePath, uint64_t archiveBytes, FILE* pProgress);
  // Writes the stamp, which makes the payload known, and the image's checksum over the whole file. Throws OrbitError
  // for a file beyond 32 bits.
  void Finish();

  uint64_t Size() const { return m_size; }
  uint64_t PayloadSize() const { return m_size - m_payload; }

 private:
  void WriteAt(uint64_t place, const unsigned char* pBytes, size_t nBytes);

  OutputFile& m_output;
  std::string m_name;
  uint64_t m_size = 0;
  uint64_t m_payload = 0;  // where it begins
  std::optional<uint32_t> m_checksumPlace;
  PeChecksum m_checksum;
};
