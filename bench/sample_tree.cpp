// sample_tree FOLDER [MEGABYTES [FILES]]: makes a folder like a product's (SampleTree.h).
#include <cstdio>
#include <cstdlib>

#include "SampleTree.h"

int main(int argc, char** argv) {
  const uint64_t megabytes = argc > 2 ? strtoul(argv[2], nullptr, 10) : 130;
  const int iFiles = argc > 3 ? atoi(argv[3]) : 2000;
  if (argc < 2 || argc > 4 || !megabytes || iFiles < 1) {
    std::fprintf(stderr, "usage: sample_tree FOLDER [MEGABYTES [FILES]]\n");
    return 2;
  }
  if (bMakeSampleTree(argv[1], {megabytes << 20, iFiles})) return 0;
  std::fprintf(stderr, "sample_tree: %s exists already or cannot be written\n", argv[1]);
  return 1;
}
