// The best compressor that this build of the tool has.
#pragma once

#include <memory>

#include "archive/ArchiveWriter.h"

// Null: it has none besides zlib (the tool for Windows), or there is no memory.
std::unique_ptr<GzipMaker> pMakeBestGzip();
