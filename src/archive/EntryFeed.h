// The entries of an archive one after the other, each header followed by its content. A thread may read and inflate
// ahead, as far as a ring of blocks goes, so that inflating and writing take place at the same time; what comes out is
// the same without it. One thread at a time besides the feed's own.
#pragma once

#include <atomic>
#include <memory>

#include "archive/ArchiveWalk.h"
#include "archive/GzipEntryReader.h"

class EntryFeed {
 public:
  EntryFeed() = default;
  ~EntryFeed();
  EntryFeed(const EntryFeed&) = delete;
  EntryFeed& operator=(const EntryFeed&) = delete;

  // Stands before entry iFirst (from 0). False when the archive cannot be opened or there is no memory. bAhead: inflate
  // on a thread, when one can be had. To be called once.
  bool bOpen(const char* szPath, int iFirst, bool bAhead);
  // Index of the entry that the coming Next reads.
  int NextIndex() const { return m_iNext; }
  // As ArchiveWalk::Next. What was not read of the entry before is passed over.
  ArchiveWalk::Step Next(ArchiveEntryHeader& entry);
  // Points pBytes at the entry's next bytes, which stay there until the next call. The count, 0 at the end.
  size_t Read(const unsigned char*& pBytes);
  // How the content ended; valid once Read has returned 0. False of bStarted: there was no memory for it.
  bool bStarted() const { return m_pBlock->bStarted; }
  GzipEntryReader::End Result() const { return m_pBlock->result; }
  uint32_t Sum() const { return m_pBlock->sum; }

 private:
  static const unsigned BLOCKS = 64;  // a power of two
  static const size_t BLOCK_BYTES = 4 * GzipEntryReader::OUTPUT_BLOCK;

  // A stretch of an entry's content; the first comes with the entry's header, the last with the result.
  struct Block {
    ArchiveWalk::Step step = ArchiveWalk::Step::Entry;
    bool bStarted = false;
    bool bLast = false;
    ArchiveEntryHeader header;
    size_t nBytes = 0;
    GzipEntryReader::End result = GzipEntryReader::End::Complete;
    uint32_t sum = 0;
  };
  // One side's way to sleep until the other has something for it.
  struct Bed {
    template <class Ready>
    void SleepUntil(Ready bReady);
    void Wake();

    OsSemaphore semaphore;
    std::atomic<bool> bAsleep{false};
  };

  void Fill(Block& block, unsigned char* pBytes);
  void WorkAhead();
  bool bEndsAll(const Block& block) const { return block.bLast && block.step != ArchiveWalk::Step::Entry; }
  void Advance();

  // The feeding side's.
  ArchiveWalk m_walk;
  GzipEntryReader m_reader;
  bool m_bWithinEntry = false;
  // The ring: how many blocks have been filled, and how many have been given back; both wrap.
  std::unique_ptr<Block[]> m_pRing;
  std::unique_ptr<unsigned char[]> m_pBytes;
  std::atomic<unsigned> m_uFilled{0}, m_uReturned{0};
  std::atomic<bool> m_bStop{false}, m_bAllFed{false}, m_bThreadRuns{false};
  Bed m_feeder, m_eater;
  // The taking side's.
  const Block* m_pBlock = nullptr;
  const unsigned char* m_pContent = nullptr;
  bool m_bUnread = false;
  int m_iNext = 0;
  ArchiveWalk::Step m_step = ArchiveWalk::Step::Entry;
};
