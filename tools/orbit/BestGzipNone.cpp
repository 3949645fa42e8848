// Where there is only zlib.
#include "BestGzip.h"

std::unique_ptr<GzipMaker> pMakeBestGzip() { return nullptr; }
