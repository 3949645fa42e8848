// The identifiers of the shell's objects that the program uses. Defined here they keep the import library's one unit
// with all of the system's identifiers (40 KB) out of the program. One that is missing here makes the linker fetch that
// unit, which it reports as a second definition of these: add it here.
#include <windows.h>
// after windows.h, which they build on
#include <objbase.h>

extern "C" {
extern const GUID CLSID_ShellLink, IID_IShellLinkW, IID_IPersistFile;
const GUID CLSID_ShellLink = {0x00021401, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
const GUID IID_IShellLinkW = {0x000214F9, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
const GUID IID_IPersistFile = {0x0000010B, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
}
