// Shares of the network: searched by a worker, listed, and one of them given a shortcut to the installed program.
#include <windows.h>
// after windows.h
#include <winnetwk.h>

#include <cstring>
#include <memory>

#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/SystemLibrary.h"

static const char LOCAL_SHARES[] = "SYSTEM\\CurrentControlSet\\Services\\lanmanserver\\Shares";

static void GetComputer(CNString& csName) {
  wchar_t szName[MAX_COMPUTERNAME_LENGTH + 1] = L"";
  DWORD dwSize = MAX_COMPUTERNAME_LENGTH + 1;
  csName = "";
  if (GetComputerNameW(szName, &dwSize)) bNarrow(szName, csName);
}

// ---- the search ----

namespace {

// The network as a tree: networks, domains, computers, shares.
class NetTree {
 public:
  using Found = bool (*)(const char* szShare, void* pContext);

  // pFound returns false to stop the search.
  NetTree(Found pFound, void* pContext) : m_pFound(pFound), m_pContext(pContext), m_Library(L"mpr.dll") {
    m_pOpen = m_Library.Find<decltype(m_pOpen)>("WNetOpenEnumW");
    m_pNext = m_Library.Find<decltype(m_pNext)>("WNetEnumResourceW");
    m_pClose = m_Library.Find<decltype(m_pClose)>("WNetCloseEnum");
  }

  // False once the search was stopped.
  bool bWalk(NETRESOURCEW* pBelow, int iDepth = 0) {
    HANDLE hOpened = nullptr;
    if (!m_pOpen || !m_pNext || !m_pClose || iDepth > MAX_DEPTH ||
        m_pOpen(RESOURCE_GLOBALNET, RESOURCETYPE_DISK, 0, pBelow, &hOpened) != NO_ERROR)
      return true;  // what cannot be asked has nothing
    const std::unique_ptr<BYTE[]> pBuffer(new (std::nothrow) BYTE[BUFFER_SIZE]);
    bool bGoesOn = pBuffer != nullptr;
    for (DWORD dwCount = 1, dwSize = BUFFER_SIZE;
         bGoesOn && m_pNext(hOpened, &dwCount, pBuffer.get(), &dwSize) == NO_ERROR; dwCount = 1, dwSize = BUFFER_SIZE)
      bGoesOn = bTake(*reinterpret_cast<NETRESOURCEW*>(pBuffer.get()), iDepth);
    m_pClose(hOpened);
    return bGoesOn || !pBuffer;
  }

 private:
  static const int MAX_DEPTH = 5;
  static const DWORD BUFFER_SIZE = 16384;

  bool bTake(NETRESOURCEW& resource, int iDepth) {
    CNString csName;
    const bool bShare = (resource.dwUsage & RESOURCEUSAGE_CONNECTABLE) && resource.lpRemoteName &&
                        bNarrow(resource.lpRemoteName, csName);
    if (!m_pFound(bShare ? csName.Text() : "", m_pContext)) return false;
    return !(resource.dwUsage & RESOURCEUSAGE_CONTAINER) || bWalk(&resource, iDepth + 1);
  }

  const Found m_pFound;
  void* const m_pContext;
  const SystemLibrary m_Library;
  DWORD(WINAPI* m_pOpen)(DWORD, DWORD, DWORD, NETRESOURCEW*, HANDLE*);
  DWORD(WINAPI* m_pNext)(HANDLE, DWORD*, void*, DWORD*);
  DWORD(WINAPI* m_pClose)(HANDLE);
};

}  // namespace

// Any thread. Takes a share ("" for none); false when the search is to stop.
bool CNInstallWizard::bFoundShare(const char* szShare) {
  const CNSemHold hold(m_NetLock);
  if (*szShare && m_Shares.Find(szShare) == -1) m_Shares.Add(szShare, 1);
  return !m_bStopSearch;
}

// This computer's own shares first, for they are found without a network; then the computers that the script names,
// which today's networks no longer announce; then all that is announced.
void CNInstallWizard::SearchNetWork() {
  NetTree tree([](const char* szShare, void* p) { return static_cast<CNInstallWizard*>(p)->bFoundShare(szShare); },
               this);
  OsRegistryKey key;
  CNString csComputer, csShare, csPath;
  GetComputer(csComputer);
  if (key.bOpen(OS_HKEY_LOCAL_MACHINE, LOCAL_SHARES, OsRegAccess::Read))
    for (unsigned u = 0; key.bEnumValue(u, csShare); u++) {
      csPath.Printf("SearchNetWork", "csPath", "\\\\%s\\%s", csComputer.Text(), csShare.Text());
      bFoundShare(csPath.Text());
    }
  const TextList servers(m_csNetServers.Text());
  for (int i = 0; i < servers.Size() && !m_bStopSearch; i++) {
    CNString csServer = Joined(strncmp(servers[i], "\\\\", 2) == 0 ? "" : "\\\\", servers[i]);
    CNWideText server(csServer.Text());
    NETRESOURCEW resource = {};
    resource.dwScope = RESOURCE_GLOBALNET;
    resource.dwType = RESOURCETYPE_DISK;
    resource.dwDisplayType = RESOURCEDISPLAYTYPE_SERVER;
    resource.dwUsage = RESOURCEUSAGE_CONTAINER;
    resource.lpRemoteName = reinterpret_cast<wchar_t*>(const_cast<char16_t*>(server.Ptr()));
    tree.bWalk(&resource);
  }
  if (!m_bStopSearch) tree.bWalk(nullptr);
  m_bSearching = 0;
  PostWorkDone();
}

int CNInstallWizard::iSearchNet(const char* /*szParam*/, int* pCommandResult) {
  if (m_bSearching) return iAnswer(pCommandResult, COMMAND_DONE);  // one search is enough
  m_bStopSearch = 0;
  m_bSearching = 1;
  m_csNetServers = szValue("net_servers");
  m_Shares.RemoveAll();
  if (bStartTask(&CNInstallWizard::SearchNetWork)) return iAnswer(pCommandResult, COMMAND_DONE);
  m_bSearching = 0;
  return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iSearchNet -> !bStartTask -> return FUNCTION_ERROR");
}

int CNInstallWizard::iFillNetListView(const char* /*szParam*/, int* pCommandResult) {
  CNCharArray shares;
  {
    const CNSemHold hold(m_NetLock);
    for (int i = 0; i < m_Shares.Size(); i++) shares.Add(m_Shares[i]->Text(), 1);
  }
  if (!bFillList("lv_net_list", shares))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFillNetListView -> !bFillList(lv_net_list) -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, shares.Size() ? COMMAND_DONE : COMMAND_NEGATIVE);
}

// ---- the shortcut ----

// The part behind "Path=" in the several texts of a share's value; null without one.
static const char* szSharePath(const char* pTexts, long lSize) {
  for (const char* p = pTexts; p < pTexts + lSize && *p; p += strlen(p) + 1)
    if (strncmp(p, "Path=", 5) == 0) return p + 5;
  return nullptr;
}

// The name under which other computers see a folder of this one, through the first share that holds it.
static bool bNetworkName(const char* szFolder, CNString& csName) {
  OsRegistryKey key;
  CNString csShare, csRoot, csComputer;
  if (!key.bOpen(OS_HKEY_LOCAL_MACHINE, LOCAL_SHARES, OsRegAccess::Read)) return false;
  GetComputer(csComputer);
  for (unsigned u = 0; key.bEnumValue(u, csShare); u++) {
    char texts[2048] = "";
    OsRegType type = OsRegType::None;
    long lSize = 0;
    if (!key.bQuery(csShare.Text(), type, texts, sizeof(texts) - 1, lSize)) continue;
    csRoot = szSharePath(texts, lSize);
    if (csRoot.EndsWith("\\")) csRoot.SetLength(csRoot.Length() - 1);
    if (csRoot.bEmpty() || !bIsBelow(szFolder, csRoot.Text())) continue;
    csName.Printf("bNetworkName", "csName", "\\\\%s\\%s%s", csComputer.Text(), csShare.Text(),
                  szFolder + csRoot.Length());
    return true;
  }
  return false;
}

int CNInstallWizard::iCreateNetShortCut(const char* /*szParam*/, int* pCommandResult) {
  CNString csShare, csFolder, csName;
  GetDestination(csFolder);
  csGetField("lv_net_list", csShare);
  if (strncmp(csShare.Text(), "\\\\", 2) != 0)
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iCreateNetShortCut -> !lv_net_list -> COMMAND_NEGATIVE");
  if (!bNetworkName(csFolder.Text(), csName))  // a shortcut that leads nowhere on other computers helps nobody
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iCreateNetShortCut -> !bNetworkName(%s) -> COMMAND_NEGATIVE",
                      csFolder.Text());
  const CNString csTarget = Joined(csName.Text(), "\\", szValue("program_file"));
  if (bAddLink(csShare.Text(), csTarget.Text())) return iAnswer(pCommandResult, COMMAND_DONE);
  const CNString csText = Joined("The shortcut could not be made on:\n\n", csShare.Text());
  m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Error});
  return iAnswer(pCommandResult, COMMAND_NEGATIVE);
}
