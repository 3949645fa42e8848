// Says in C:\planted.txt that it was loaded, and into which program.
#include <windows.h>

#include <cstdio>

BOOL WINAPI DllMain(HINSTANCE hLibrary, DWORD dwReason, LPVOID) {
  char szLibrary[MAX_PATH] = "", szProgram[MAX_PATH] = "";
  if (dwReason != DLL_PROCESS_ATTACH) return TRUE;
  GetModuleFileNameA(hLibrary, szLibrary, MAX_PATH);
  GetModuleFileNameA(nullptr, szProgram, MAX_PATH);
  if (FILE* pFile = fopen("C:\\planted.txt", "a")) {
    fprintf(pFile, "%s in %s\n", szLibrary, szProgram);
    fclose(pFile);
  }
  return TRUE;
}
