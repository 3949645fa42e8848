#include "window/WindowClasses.h"

#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "window/Pictures.h"
#include "window/SystemDialogs.h"

namespace {

const int SMALL_ICON = 16;

HICON hLoadIconFile(const char* szPath, int iSize) {
  return static_cast<HICON>(
      LoadImageW(nullptr, Wide(szPath), IMAGE_ICON, iSize, iSize, LR_LOADFROMFILE | (iSize ? 0 : LR_DEFAULTSIZE)));
}

HICON hLoadIconResource(HINSTANCE hInstance, const wchar_t* pName, int iSize) {
  return static_cast<HICON>(
      LoadImageW(hInstance, pName, IMAGE_ICON, iSize, iSize, LR_SHARED | (iSize ? 0 : LR_DEFAULTSIZE)));
}

struct IconPair {
  HINSTANCE hInstance;
  WNDCLASSEXW* pDescription;
};

void LoadPair(const wchar_t* pName, const IconPair& icons) {
  icons.pDescription->hIcon = hLoadIconResource(icons.hInstance, pName, 0);
  icons.pDescription->hIconSm = hLoadIconResource(icons.hInstance, pName, SMALL_ICON);
}

BOOL CALLBACK TakeFirstIcon(HMODULE, LPCWSTR, LPWSTR pName, LONG_PTR pIcons) {
  LoadPair(pName, *reinterpret_cast<const IconPair*>(pIcons));
  return FALSE;
}

int iFail(const char* szLogged, const char* szShown, const char* szClass) {
  CNString csError;
  OsErrorText(OsLastError(), csError);
  LogPrintf("%s: %s", szLogged, csError.Text());
  iSystemMessage(nullptr, {.szText = szShown, .szCaption = szClass, .icon = MessageIcon::Error, .bOwned = false});
  return FUNCTION_ERROR;
}

}  // namespace

void WizardClass::LoadIcons(const WizardWindowOptions& options, WNDCLASSEXW& description) {
  CNString csPath;
  if (bFindPictureFile(options.szProgramIcon, csPath)) {
    m_Icon.Reset(hLoadIconFile(csPath.Text(), 0));
    m_SmallIcon.Reset(hLoadIconFile(csPath.Text(), SMALL_ICON));
  }
  description.hIcon = m_Icon.Get();
  description.hIconSm = m_SmallIcon.Get();
  if (m_Icon) return;
  const IconPair icons = {m_hInstance, &description};
  if (options.iIconResource) LoadPair(MAKEINTRESOURCEW(options.iIconResource), icons);
  if (!description.hIcon)
    EnumResourceNamesW(m_hInstance, RT_GROUP_ICON, TakeFirstIcon, reinterpret_cast<LONG_PTR>(&icons));
}

int WizardClass::iInitWindowClass(HINSTANCE hInstance, const WizardWindowOptions& options, WNDPROC pProc) {
  Unregister();
  if (!options.szClassName || !*options.szClassName)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iInitWindowClass -> !szWindowClass ->return PRECONDITIONS_NOT_VALID");
  m_hInstance = hInstance;
  m_csName = options.szClassName;
  const CNWideText name(options.szClassName);
  WNDCLASSEXW description = {};
  description.cbSize = sizeof(description);
  description.style = CS_VREDRAW | CS_HREDRAW | CS_DBLCLKS;
  description.lpfnWndProc = pProc;
  description.hInstance = hInstance;
  description.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  description.hbrBackground = reinterpret_cast<HBRUSH>(COLOR_BTNFACE + 1);
  description.lpszClassName = reinterpret_cast<const wchar_t*>(name.Ptr());
  // A class that names a menu which the program does not hold could not be used.
  if (FindResourceW(hInstance, L"WizardMenu", RT_MENU)) description.lpszMenuName = L"WizardMenu";
  LoadIcons(options, description);
  m_Atom = RegisterClassExW(&description);
  return m_Atom ? EVERYTHING_IS_OK : iFail("RegisterClassEx", "Error in RegiststerClasssEx!", m_csName.Text());
}

WizardClass::~WizardClass() { Unregister(); }

void WizardClass::Unregister() {
  if (m_Atom && !UnregisterClassW(Atom(), m_hInstance))
    iFail("UnregisterClass", "Error in UnregisterClass!", m_csName.Text());
  m_Atom = 0;
}
