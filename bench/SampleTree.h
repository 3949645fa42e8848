// Makes a folder like a product's, for measuring: the same bytes for the same numbers, every time and everywhere.
#pragma once

#include <string>

#include "SampleProduct.h"

// Writes the files into szFolder, which must not exist, three levels deep, all of one date. They are texts, programs,
// bitmaps and files that are compressed already, in the sizes of SampleFileSize. False when something cannot be
// written.
bool bMakeSampleTree(const std::string& folder, const SampleSize& size);
