// Choices that commands fill: dictionaries, and the East Asian languages that the system does not support yet.
#include <windows.h>

#include <cstring>
#include <memory>

#include "controls/ItemKinds.h"
#include "foundation/CNSystem.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/Programs.h"

// ---- lists ----

// Gives the list, combo box or list view of that name other items. False when the page has none.
bool CNInstallWizard::bFillList(const char* szControl, const CNCharArray& texts) {
  static const ItemWord ITEM = {"ITEM"};
  BaseControl* pControl = GetBaseControl(szControl);
  CNCharArray shown;
  CNArray<CNItem> old;  // the window still points to them until it has the new ones
  if (!pControl) return false;
  if (pControl->pItemControl()) {
    CNItemControl& list = const_cast<CNItemControl&>(*pControl->pItemControl());
    CNArray<CNItem> kept;
    for (int i = 0; i < list.m_Items.Size(); i++)
      list.m_Items[i]->bIs("ITEM") ? old.Add(list.m_Items[i], 1) : kept.Add(list.m_Items[i], 0);
    // Empties the list without deleting: the last Add decides for all.
    const std::unique_ptr<CNItem> pNone(new CNItem(ITEM));
    list.m_Items.Add(pNone.get(), 0);
    list.m_Items.RemoveAll();
    for (int i = 0; i < kept.Size(); i++) list.m_Items.Add(kept[i], 1);
    for (int i = 0; i < texts.Size(); i++) {
      list.m_Items.Add(new CNItem(ITEM), 1);
      list.m_Items[list.m_Items.Size() - 1]->SetText(0, texts[i]);
    }
    list.CountTexts();
  } else if (pControl->Kind() == ControlKind::ListBox || pControl->Kind() == ControlKind::SimulatedListBox) {
    CNCharArray& items = static_cast<CNTextList*>(pControl)->m_Items;
    items.RemoveAll();
    for (int i = 0; i < texts.Size(); i++) items.Add(texts[i], 1);
  } else {
    return false;
  }
  pControl->bItemTexts(shown);
  m_View.bSetItems(*pControl, shown);
  return true;
}

void CNInstallWizard::EnableControl(const char* szControl, bool bEnabled) {
  int iResult = COMMAND_FAILED;
  COrbitWizard::iExecuteFunction(bEnabled ? "EnableControl" : "DisableControl", szControl, 0, &iResult, nullptr);
}

// ---- dictionaries ----

int CNInstallWizard::iGetDictionaries(const char* /*szParam*/, int* pCommandResult) {
  CNString csSource;
  CNStringArray folders;
  CNCharArray names;
  csSource = szValue("dict_source");
  if (csSource.bEmpty() && CNSystem::GetCurrentApplicationDir(csSource) == EVERYTHING_IS_OK) csSource.Concat("dicts");
  CNSystem::ListFolders(csSource.Text(), &folders);
  for (int i = 0; i < folders.Size(); i++) names.Add(folders[i]->Text(), 1);
  bFillList("dictionaries", names);
  if (names.Size()) return iAnswer(pCommandResult, COMMAND_DONE);
  iAnswer(pCommandResult, COMMAND_NEGATIVE);
  return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iGetDictionaries -> !dict_source(%s) -> COMMAND_NEGATIVE",
                    csSource.Text());
}

int CNInstallWizard::iDictionariesChanged(const char* /*szParam*/, int* pCommandResult) {
  CNString csChosen;
  csGetField("dictionaries", csChosen);
  if (GetBaseControl("b_next")) EnableControl("b_next", !csChosen.bEmpty());
  return iAnswer(pCommandResult, COMMAND_DONE);
}

void CNInstallWizard::GetProductKey(CNString& csKey) {
  csKey = szValue("registry_key");
  if (csKey.bEmpty()) csKey = Joined("Software\\", szValue("program_name"));
}

bool CNInstallWizard::bWriteProductValue(const char* szName, const char* szText) {
  CNString csKey;
  GetProductKey(csKey);
  AddUndo("registry_key", csKey.Text());
  return iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text(), szName, szText, nullptr) == EVERYTHING_IS_OK;
}

int CNInstallWizard::iSetAllowedDict(const char* /*szParam*/, int* pCommandResult) {
  if (!*szValue("program_name") || !*szValue("allowed_dict"))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iSetAllowedDict -> !allowed_dict -> COMMAND_NEGATIVE");
  return bWriteProductValue("Mode", szValue("allowed_dict")) ? iAnswer(pCommandResult, COMMAND_DONE) : FUNCTION_ERROR;
}

// ---- languages ----

static const struct {
  const char* szName;
  LGRPID group;
} LANGUAGES[] = {{"Japanese", 7}, {"Korean", 8}, {"Traditional Chinese", 9}, {"Simplified Chinese", 10}};

// The parameter chooses among the languages; without one all are looked at.
int CNInstallWizard::iGetLangSupport(const char* szParam, int* pCommandResult) {
  const TextList wanted(szParam);
  CNCharArray missing;
  for (const auto& language : LANGUAGES)
    if ((!wanted.Size() || wanted.bHas(language.szName)) && !IsValidLanguageGroup(language.group, LGRPID_INSTALLED))
      missing.Add(language.szName, 1);
  bFillList("lang_supp", missing);
  return iAnswer(pCommandResult, missing.Size() ? COMMAND_DONE : COMMAND_NEGATIVE);
}

// The file of answers for the system's regional settings, which ask for their own disks.
bool CNInstallWizard::bRequestLanguages(const char* szGroups) {
  static const char ANSWERS[] = "lang_support.txt";
  CNString csFolder, csText;
  wchar_t szSystem[MAX_PATH] = L"";
  GetDestination(csFolder);
  const CNString csFile = Joined(csFolder.Text(), "\\", ANSWERS);
  csText.Printf("bRequestLanguages", "csText", "[RegionalSettings]\r\nLanguageGroup=%s\r\n", szGroups);
  if (!bWriteListed(csFolder.Text(), ANSWERS, csText)) return false;
  const UINT uLength = GetSystemDirectoryW(szSystem, MAX_PATH);
  CNString csProgram;
  if (!uLength || uLength >= MAX_PATH || !bNarrow(szSystem, csProgram)) return false;
  csProgram.Concat("\\rundll32.exe");
  return bStartProgram(csProgram.Text(),
                       Joined("shell32.dll,Control_RunDLL intl.cpl,,/f:\"", csFile.Text(), "\"").Text());
}

int CNInstallWizard::iInstallLangSupport(const char* /*szParam*/, int* pCommandResult) {
  CNString csFirst, csSecond, csGroups, csGroup;
  csGetField("lang_supp", csFirst);
  csGetField("lang_supp1", csSecond);
  csGroups = "";
  const TextList chosen(Joined(csFirst.Text(), "\n", csSecond.Text()).Text(), ";\r\n");
  for (const auto& language : LANGUAGES) {
    if (!chosen.bHas(language.szName)) continue;
    csGroup.Printf("iInstallLangSupport", "csGroup", "%s%u", csGroups.bEmpty() ? "" : ",", unsigned(language.group));
    csGroups.Concat(csGroup.Text());
  }
  if (csGroups.bEmpty())
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iInstallLangSupport -> !lang_supp -> COMMAND_NEGATIVE");
  if (!bRequestLanguages(csGroups.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iInstallLangSupport -> !bRequestLanguages -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}
