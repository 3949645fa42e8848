// Progress of long work on stderr: a percentage that counts up in place on a terminal, else a line every ten percent.
#pragma once

#include <cstdint>
#include <cstdio>
#include <string>

class Progress {
 public:
  // pOut null: silent. The label names the work.
  Progress(FILE* pOut, std::string label, uint64_t total);
  ~Progress();
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;

  void Advance(uint64_t nBytes);

 private:
  FILE* m_pOut;
  std::string m_label;
  uint64_t m_total;
  uint64_t m_done = 0;
  bool m_bTerminal;
  int m_iShown = -1;
};
