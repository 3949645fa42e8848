// Lists and verifies a product archive, a stamped setup program's, or both archives of a packed file.
#pragma once

#include <cstdio>
#include <string>

// Prints every entry and the totals to pOut, and one line to pProblems for everything that is wrong: the stamp, the
// payload, the check value, damage, a name that extraction would refuse, content that does not match its sizes or its
// check. Returns the number of problems. Throws OrbitError when the file (UTF-8 path) is neither.
int List(const std::string& path, FILE* pOut, FILE* pProblems);
