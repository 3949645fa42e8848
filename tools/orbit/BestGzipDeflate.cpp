// With libdeflate, which searches longer than zlib can be told to: three percent less, in three times the time.
#include <libdeflate.h>

#include <new>
#include <vector>

#include "BestGzip.h"

namespace {

const int LEVEL = 12;

class DeflateGzip : public GzipMaker {
 public:
  DeflateGzip() : m_pCompressor(libdeflate_alloc_compressor(LEVEL)) {
    if (m_pCompressor) m_member.resize(libdeflate_gzip_compress_bound(m_pCompressor, MOST));
  }
  ~DeflateGzip() override { libdeflate_free_compressor(m_pCompressor); }
  DeflateGzip(const DeflateGzip&) = delete;
  DeflateGzip& operator=(const DeflateGzip&) = delete;

  bool bReady() const { return m_pCompressor != nullptr; }
  size_t Make(const unsigned char* pBytes, size_t nBytes, const unsigned char*& pMember) override {
    pMember = m_member.data();
    return libdeflate_gzip_compress(m_pCompressor, pBytes, nBytes, m_member.data(), m_member.size());
  }

 private:
  libdeflate_compressor* m_pCompressor;
  std::vector<unsigned char> m_member;
};

}  // namespace

std::unique_ptr<GzipMaker> pMakeBestGzip() {
  auto pMaker = std::make_unique<DeflateGzip>();
  return pMaker->bReady() ? std::move(pMaker) : nullptr;
}
