// The files that describe the user and the installation: the user's profile and size.dat.
#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/Text.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/InstallJournal.h"

// A full path is the user's own choice, and what is there is the user's: it stays when the product goes.
static bool bWriteProfile(const char* szFolder, const char* szFile, const CNString& csText) {
  CNString csSafe;
  OsFile file;
  if (!bIsFullPath(szFile)) return bMakeSafePath(szFile, csSafe) && bWriteListed(szFolder, csSafe.Text(), csText);
  return file.bOpen(szFile, OsOpenMode::Create) && file.bWrite(csText.Text(), static_cast<size_t>(csText.Length())) &&
         file.bClose();
}

// ---- the user's profile ----

// Control characters have no place in XML; a line end and a tab have.
static void AppendEscaped(const char* szText, CNString& csOut) {
  static const struct {
    char c;
    const char* szEntity;
  } ENTITIES[] = {{'&', "&amp;"}, {'<', "&lt;"}, {'>', "&gt;"}, {'"', "&quot;"}, {'\'', "&apos;"}};
  for (; *szText; szText++) {
    const char szPlain[2] = {*szText, 0};
    const char* szOut = static_cast<unsigned char>(*szText) < ' ' && !strchr("\t\r\n", *szText) ? " " : szPlain;
    for (const auto& entity : ENTITIES)
      if (*szText == entity.c) szOut = entity.szEntity;
    csOut.Concat(szOut);
  }
}

int CNInstallWizard::iWriteUserProfile(const char* /*szParam*/, int* pCommandResult) {
  static const struct {
    const char *szVariable, *szElement;
  } FIELDS[] = {{"name", "commonname"},
                {"company", "company"},
                {"address", "address"},
                {"city", "locality"},
                {"postal_code", "postalcode"},
                {"country", "country"},
                {"phone", "telephonenumber"},
                {"fax", "facsimiletelephonenumber"},
                {"mail", "mail"}};
  CNString csFile, csText, csUtf8, csFolder;
  csFile = szValue("user_profile_path");
  GetDestination(csFolder);
  if (csFile.bEmpty())
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iWriteUserProfile -> !user_profile_path -> COMMAND_NEGATIVE");
  csText = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<userprofile>\n";
  for (const auto& field : FIELDS) {
    csText.Concat(Joined("  <", field.szElement, ">").Text());
    AppendEscaped(szValue(field.szVariable), csText);
    csText.Concat(Joined("</", field.szElement, ">\n").Text());
  }
  csText.Concat("</userprofile>\n");
  Cp1250ToUtf8(csText.Text(), csUtf8);
  if (!bWriteProfile(csFolder.Text(), csFile.Text(), csUtf8))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iWriteUserProfile -> !bWriteProfile(%s) -> return FUNCTION_ERROR",
                      csFile.Text());
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- size.dat ----

static void AddSize(const char* szFolder, const char* szName, CNString& csText) {
  OsFileInfo info;
  CNString csLine;
  if (!bOsGetFileInfo(Joined(szFolder, "\\", szName).Text(), info) || (info.attributes & OS_DIRECTORY)) return;
  const long lSize = info.size > 0x7fffffff ? 0x7fffffff : static_cast<long>(info.size);
  csLine.Printf("AddSize", "csLine", "%s=%ld\n", szName, lSize);
  csText.Concat(csLine.Text());
}

// The program first, then every other file of the list, each once.
int CNInstallWizard::iCreateSizeFile(const char* /*szParam*/, int* pCommandResult) {
  static const char SIZE_FILE[] = "size.dat";
  CNString csFolder, csText;
  const char* szProgram = szValue("program_file");
  GetDestination(csFolder);
  if (csFolder.bEmpty())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateSizeFile -> !default_path -> return FUNCTION_ERROR");
  if (!*szProgram)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateSizeFile -> !program_file -> return FUNCTION_ERROR");
  csText = "";
  AddSize(csFolder.Text(), szProgram, csText);
  InstalledList list;
  list.bRead(Joined(csFolder.Text(), "\\", InstalledList::FILE_NAME).Text());
  for (int i = 0; i < list.Size(); i++) {
    const InstalledList::Line& line = list[i];
    const bool bLast = line.cKind == 'F' && list.pFile(line.szText) == &line;  // of an upgraded file's several lines
    if (bLast && iOsCompareNoCase(line.szText, szProgram) != 0 && iOsCompareNoCase(line.szText, SIZE_FILE) != 0)
      AddSize(csFolder.Text(), line.szText, csText);
  }
  if (!bWriteListed(csFolder.Text(), SIZE_FILE, csText))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateSizeFile -> !bWriteListed -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}
