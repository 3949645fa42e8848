#include "installer/ShellLinks.h"

#include <shlobj.h>

#include "foundation/ResultCodes.h"
#include "foundation/os/OsWide.h"
#include "installer/ComPointer.h"

namespace {

// The system's link object with its two faces.
class LinkObject {
 public:
  HRESULT Create() {
    const HRESULT hres =
        CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW, m_pLink.Receive());
    return FAILED(hres) ? hres : m_pLink->QueryInterface(IID_IPersistFile, m_pFile.Receive());
  }
  IShellLinkW* Link() const { return m_pLink.operator->(); }
  IPersistFile* File() const { return m_pFile.operator->(); }

 private:
  const ComApartment m_Apartment;
  ComPointer<IShellLinkW> m_pLink;
  ComPointer<IPersistFile> m_pFile;
};

}  // namespace

static HRESULT FillLink(IShellLinkW* pLink, const ShellLink& link) {
  const HRESULT results[] = {
      pLink->SetPath(Wide(link.csTarget.Text())),
      pLink->SetArguments(Wide(link.csArguments.Text())),
      pLink->SetWorkingDirectory(Wide(link.csWorkingFolder.Text())),
      pLink->SetDescription(Wide(link.csDescription.Text())),
      pLink->SetIconLocation(Wide(link.csIcon.Text()), 0),
  };
  for (const HRESULT hres : results)
    if (FAILED(hres)) return hres;
  return S_OK;
}

int iCreateLink(const ShellLink& link, const char* szLinkPath) {
  LinkObject object;
  HRESULT hres = object.Create();
  if (SUCCEEDED(hres)) hres = FillLink(object.Link(), link);
  if (SUCCEEDED(hres)) hres = object.File()->Save(Wide(szLinkPath), TRUE);
  if (!SUCCEEDED(hres))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateLink -> !SUCCEEDED(hres) -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

int iResolveIt(const char* szLinkPath, ShellLink& link) {
  LinkObject object;
  HRESULT hres = object.Create();
  if (SUCCEEDED(hres)) hres = object.File()->Load(Wide(szLinkPath), STGM_READ);
  if (!SUCCEEDED(hres))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iResolveIt -> !SUCCEEDED(hres) -> return FUNCTION_ERROR");
  wchar_t szText[INFOTIPSIZE] = L"";
  int iIcon = 0;
  if (SUCCEEDED(object.Link()->GetPath(szText, MAX_PATH, nullptr, SLGP_RAWPATH))) bNarrow(szText, link.csTarget);
  if (SUCCEEDED(object.Link()->GetArguments(szText, INFOTIPSIZE))) bNarrow(szText, link.csArguments);
  if (SUCCEEDED(object.Link()->GetWorkingDirectory(szText, MAX_PATH))) bNarrow(szText, link.csWorkingFolder);
  if (SUCCEEDED(object.Link()->GetDescription(szText, INFOTIPSIZE))) bNarrow(szText, link.csDescription);
  if (SUCCEEDED(object.Link()->GetIconLocation(szText, MAX_PATH, &iIcon))) bNarrow(szText, link.csIcon);
  return EVERYTHING_IS_OK;
}
