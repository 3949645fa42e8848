// The version resource of a program.
#pragma once

#include <cstdint>
#include <vector>

#include "PeImage.h"

// Throws OrbitError for texts that are no UTF-8, hold a zero character, or are too long together (32 KB).
std::vector<uint8_t> EncodeVersion(const PeVersionInfo& info);
