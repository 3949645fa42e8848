#include "archive/EntryFeed.h"

#include <new>

// Neither side wakes the other for a single block: waking costs about as much as a small file.
static const unsigned WORTH_WAKING = 4;

template <class Ready>
void EntryFeed::Bed::SleepUntil(Ready bReady) {
  while (!bReady()) {
    bAsleep = true;
    if (!bReady() && !semaphore.bWait()) OsSleep(1);
    bAsleep = false;
  }
}

void EntryFeed::Bed::Wake() {
  if (bAsleep.exchange(false)) semaphore.bRelease();
}

EntryFeed::~EntryFeed() {
  m_bStop = true;
  m_feeder.Wake();
  while (m_bThreadRuns) OsSleep(1);  // it stops behind the block that it fills
}

bool EntryFeed::bOpen(const char* szPath, int iFirst, bool bAhead) {
  m_pRing.reset(new (std::nothrow) Block[BLOCKS]);
  m_pBytes.reset(new (std::nothrow) unsigned char[BLOCKS * BLOCK_BYTES]);
  if (!m_pRing || !m_pBytes || !m_walk.bOpen(szPath)) return false;
  Block& passed = m_pRing[0];
  while (m_walk.NextIndex() < iFirst && (m_step = m_walk.Next(passed.header)) == ArchiveWalk::Step::Entry) continue;
  m_iNext = m_walk.NextIndex();
  if (!bAhead || !m_feeder.semaphore.bCreated() || !m_eater.semaphore.bCreated()) return true;
  m_bThreadRuns = true;
  if (!bOsStartThread([](void* pFeed) { static_cast<EntryFeed*>(pFeed)->WorkAhead(); }, this)) m_bThreadRuns = false;
  return true;
}

// ---- the feeding side ----

void EntryFeed::Fill(Block& block, unsigned char* pBytes) {
  block.nBytes = 0;
  block.bStarted = true;
  block.step = ArchiveWalk::Step::Entry;
  if (!m_bWithinEntry) {
    block.step = m_walk.Next(block.header);
    if (block.step == ArchiveWalk::Step::Entry)
      m_bWithinEntry = block.bStarted = m_reader.bStart(m_walk.Data(), block.header.storedSize);
  }
  if (m_bWithinEntry) block.nBytes = m_reader.Read(pBytes, BLOCK_BYTES);
  block.bLast = !m_bWithinEntry || m_reader.bEnded();
  block.result = m_reader.Result();
  block.sum = m_reader.Sum();
  m_bWithinEntry = !block.bLast;
}

void EntryFeed::WorkAhead() {
  while (!m_bAllFed && !m_bStop) {
    const auto used = [this] { return m_uFilled - m_uReturned; };
    if (used() == BLOCKS) m_feeder.SleepUntil([&] { return used() <= BLOCKS / 2 || m_bStop; });
    if (m_bStop) break;
    const unsigned uAt = m_uFilled % BLOCKS;
    Fill(m_pRing[uAt], m_pBytes.get() + uAt * BLOCK_BYTES);
    m_uFilled++;
    m_bAllFed = bEndsAll(m_pRing[uAt]);  // only now: it says that there is something to take
    if (used() >= WORTH_WAKING || m_bAllFed) m_eater.Wake();
  }
  m_bThreadRuns = false;  // last: from here on the feed may be gone
}

// ---- the taking side ----

// Gives the present block back, when there is one, and takes the next.
void EntryFeed::Advance() {
  if (m_pBlock) m_uReturned++;
  const unsigned uAt = m_uReturned % BLOCKS;
  const auto nReady = [this] { return m_uFilled - m_uReturned; };
  if (!m_bThreadRuns && !nReady()) {
    Fill(m_pRing[uAt], m_pBytes.get() + uAt * BLOCK_BYTES);
    m_uFilled++;
  }
  if (BLOCKS - nReady() >= BLOCKS / 2) m_feeder.Wake();
  if (!nReady()) m_eater.SleepUntil([&] { return nReady() >= WORTH_WAKING || m_bAllFed; });
  m_pBlock = &m_pRing[uAt];
  m_pContent = m_pBytes.get() + uAt * BLOCK_BYTES;
}

ArchiveWalk::Step EntryFeed::Next(ArchiveEntryHeader& entry) {
  if (m_step != ArchiveWalk::Step::Entry) return m_step;
  while (m_pBlock && !m_pBlock->bLast) Advance();
  Advance();
  m_step = m_pBlock->step;
  if (m_step != ArchiveWalk::Step::Entry) return m_step;
  entry = m_pBlock->header;
  m_bUnread = true;
  m_iNext++;
  return m_step;
}

size_t EntryFeed::Read(const unsigned char*& pBytes) {
  if (!m_bUnread && m_pBlock->bLast) return 0;
  if (!m_bUnread) Advance();
  m_bUnread = false;
  pBytes = m_pContent;
  return m_pBlock->nBytes;
}
