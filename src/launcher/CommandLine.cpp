#include "launcher/CommandLine.h"

#include <windows.h>

#include <shlwapi.h>

#include <memory>
#include <new>

#include "foundation/os/OsWide.h"

void ReadCommandLine(const wchar_t* pCommandLine, SetupCommandLine& out) {
  const int iSize = lstrlenW(pCommandLine) + 1;
  const std::unique_ptr<wchar_t[]> pLine(new (std::nothrow) wchar_t[static_cast<size_t>(iSize)]);
  if (!pLine) return;
  lstrcpynW(pLine.get(), pCommandLine, iSize);
  wchar_t* pArgument = GetFirstArgument(pLine.get());
  if (pArgument) PathUnquoteSpacesW(pArgument);  // in place, so the whole line is shown without these quotes too
  bNarrow(pLine.get(), out.csLine);
  if (pArgument && !bNarrowPath(pArgument, out.csArgument)) bNarrow(pArgument, out.csArgument);
}
