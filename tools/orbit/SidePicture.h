// The side picture of the carried script's pages for a product that brings none: a plain one, made here.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

// The content of a .bmp file of 160 by 440 pixels: an evening sky without anything in it.
std::vector<uint8_t> MakeSidePicture();
