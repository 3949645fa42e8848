#include "ToolWizard.h"

#include "OrbitText.h"

int ToolWizard::iLoadScript(const std::string& path, FILE* pErrors) {
  m_script = {};
  m_bRead = bReadScriptFile(path, m_script);
  if (m_script.bUtf8)
    std::fprintf(pErrors, "note: %s is UTF-8; the setup program reads scripts in code page 1250\n", path.c_str());
  if (m_script.bReplaced)
    std::fprintf(pErrors, "note: %s has characters that code page 1250 does not have, read as '?'\n", path.c_str());
  // An argument with this word would be taken for the script itself.
  std::string name;
  ToCp1250(path, name);
  for (size_t at; (at = name.find("DIALOG")) != std::string::npos;) name.replace(at, 6, "Dialog");
  m_iExitCode = 0;
  const int iResult = iLoadMainList(name.c_str());
  if (m_bRead && iResult == SYNTAX_ERROR && !m_iExitCode)
    std::fprintf(pErrors, "error: %s has no dialog\n", path.c_str());
  return iResult && m_iExitCode ? m_iExitCode : iResult;
}

// The text has been read; the engine's own reading tells of a file that could not be.
int ToolWizard::iReadScriptFile(const char* szFileName, CNString& csText) {
  if (!m_bRead) return COrbitWizard::iReadScriptFile(szFileName, csText);
  csText.Copy(m_script.text.data(), static_cast<long>(m_script.text.size()));
  return EVERYTHING_IS_OK;
}
