// Product archives that a killed run has left in the temporary folder.
#pragma once

#include <cstdint>

// Deletes them from szFolder (ends with a backslash). A file is taken for one when it bears such a name ("@", up to
// eight hexadecimal digits, ".tmp"), nobody holds it open as a running setup does, and it begins like a product
// archive; one too short to tell must also be unchanged for ten minutes. now: the present, as in OsFileTimes.
void RemoveLeftTempArchives(const char* szFolder, uint64_t now);
