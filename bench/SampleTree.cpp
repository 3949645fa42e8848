#include "SampleTree.h"

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <vector>

namespace fs = std::filesystem;

namespace {

using Bytes = std::vector<unsigned char>;

// Small numbers are much more frequent than great ones, as words and instructions are: below n.
uint32_t Skewed(SampleNoise& noise, uint32_t n) {
  const uint64_t a = noise.Next() >> 12, b = noise.Next() >> 12, c = noise.Next() >> 12;
  return static_cast<uint32_t>(a * b / (1u << 20) * c / (1u << 20) * n >> 20);
}

std::vector<std::string> MakeWords(size_t nWords) {
  static const char* const SYLLABLES[] = {"ba", "con",  "der",  "e",  "fi",  "gra", "in", "ja",
                                          "ko", "lo",   "ment", "na", "o",   "pre", "re", "si",
                                          "ti", "tion", "u",    "vi", "wer", "ste", "al", "ing"};
  SampleNoise noise(7);
  std::vector<std::string> words(nWords);
  for (size_t i = 0; i < nWords; i++)
    for (size_t n = 1 + (i > 30) + noise.Next() % 3; n > 0; n--)
      words[i] += SYLLABLES[noise.Next() % std::size(SYLLABLES)];
  return words;
}

void Text(Bytes& content, SampleNoise& noise) {
  static const std::vector<std::string> words = MakeWords(6000);
  static const char* const ENDS[] = {" ", " ", " ", " ", " ", ", ", ". ", ".\r\n"};
  while (content.size() < content.capacity()) {
    const std::string& word = words[Skewed(noise, static_cast<uint32_t>(words.size()))];
    const std::string part = word + ENDS[noise.Next() % std::size(ENDS)];
    content.insert(content.end(), part.begin(),
                   part.begin() + std::min(part.size(), content.capacity() - content.size()));
  }
}

// Instructions: few forms, each with operands of which only the low bytes vary much.
void Program(Bytes& content, SampleNoise& noise) {
  while (content.size() < content.capacity()) {
    const uint32_t form = Skewed(noise, 400) * 2654435761u;
    const unsigned char bytes[] = {static_cast<unsigned char>(form >> 24),
                                   static_cast<unsigned char>(form >> 16),
                                   static_cast<unsigned char>(Skewed(noise, 256)),
                                   static_cast<unsigned char>(form & 0x400 ? Skewed(noise, 16) : form >> 8),
                                   0,
                                   static_cast<unsigned char>(form & 0x800 ? 0xff : 0)};
    const size_t nLength = std::min<size_t>(2 + (form >> 5) % 5, content.capacity() - content.size());
    content.insert(content.end(), bytes, bytes + nLength);
  }
}

// Shades that change slowly, with a little grain.
void Bitmap(Bytes& content, SampleNoise& noise) {
  uint32_t shade = noise.Next();
  while (content.size() < content.capacity()) {
    if (noise.Next() % 16 == 0) shade += noise.Next() % 5 - 2;
    content.push_back(static_cast<unsigned char>(shade + (noise.Next() % 8 == 0)));
  }
}

void Compressed(Bytes& content, SampleNoise& noise) {
  while (content.size() < content.capacity()) content.push_back(static_cast<unsigned char>(noise.Next() >> 11));
}

const struct {
  const char* szExtension;
  void (*pFill)(Bytes& content, SampleNoise& noise);  // up to the capacity
} KINDS[] = {{"txt", Text},   {"dll", Program}, {"htm", Text},    {"png", Compressed}, {"dll", Program},
             {"bmp", Bitmap}, {"xml", Text},    {"exe", Program}, {"cab", Compressed}, {"txt", Text}};

bool bWriteFile(const fs::path& path, const Bytes& content) {
  std::ofstream file(path, std::ios::binary);
  file.write(reinterpret_cast<const char*>(content.data()), static_cast<std::streamsize>(content.size()));
  file.close();
  const std::chrono::sys_seconds date = std::chrono::sys_days(std::chrono::year(2026) / 11 / 20);
  std::error_code error;
  fs::last_write_time(path, std::chrono::file_clock::from_sys(date), error);
  return file && !error;
}

}  // namespace

bool bMakeSampleTree(const std::string& folder, const SampleSize& size) {
  std::error_code error;
  if (!fs::create_directory(folder, error)) return false;
  for (int i = 0; i < size.files; i++) {
    SampleNoise noise(static_cast<uint32_t>(i));
    for (int iWarmUp = 0; iWarmUp < 8; iWarmUp++) noise.Next();  // neighbours begin alike
    const auto& kind = KINDS[noise.Next() % std::size(KINDS)];
    Bytes content;
    content.reserve(static_cast<size_t>(SampleFileSize(size, i, noise)));
    kind.pFill(content, noise);
    const fs::path part =
        fs::path(folder) / ("folder" + std::to_string(i / 100)) / ("part" + std::to_string(i / 25 % 4));
    fs::create_directories(part, error);
    if (!bWriteFile(part / ("file" + std::to_string(i) + "." + kind.szExtension), content)) return false;
  }
  return true;
}
