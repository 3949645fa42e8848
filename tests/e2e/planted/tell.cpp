// In the place of a product's program: says in C:\told.txt where it runs and what setup's starter has left in its
// environment, then stays until there is a file C:\enough, ten seconds at most. With an argument it only loads the
// library of that name, as carelessly as can be.
#include <windows.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR szArgument, int) {
  if (*szArgument) return !LoadLibraryA(szArgument);
  char szFolder[MAX_PATH] = "";
  GetCurrentDirectoryA(MAX_PATH, szFolder);
  if (FILE* pFile = fopen("C:\\told.txt", "w")) {
    fprintf(pFile, "%s\n", szFolder);
    for (char** pVariable = _environ; *pVariable; pVariable++)
      if (strncmp(*pVariable, "ORBIT_", 6) == 0) fprintf(pFile, "%s\n", *pVariable);
    fclose(pFile);
  }
  for (int i = 0; i < 200 && GetFileAttributesA("C:\\enough") == INVALID_FILE_ATTRIBUTES; i++) Sleep(50);
  return 0;
}
