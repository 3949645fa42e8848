// The installer's vocabulary, one row for each command, in the order in which names are compared. NOW(name, second
// name or nullptr, takes its parameter, handler) names a handler method of CNInstallWizard; LATER has the same columns,
// and its handler is not written yet.
#pragma once

// clang-format off
#define ORBIT_INSTALL_COMMANDS(NOW, LATER) \
  NOW  ("SetQuitInstall",            nullptr,                  true,  iSetQuitInstall)            \
  LATER("InstallWizard",             "install_wizard_OnClick", true,  iInstallWizard)             \
  NOW  ("SetVersion",                nullptr,                  false, iSetVersion)                \
  NOW  ("btn_no_cro_supp_a_OnClick", nullptr,                  false, iRequestSetupA)             \
  NOW  ("btn_no_cro_supp_b_OnClick", nullptr,                  false, iRequestSetupB)             \
  LATER("BackupOldHalvex",           nullptr,                  false, iBackupOldHalvex)           \
  LATER("SearchNet",                 nullptr,                  false, iSearchNet)                 \
  LATER("FillNetListView",           nullptr,                  false, iFillNetListView)           \
  LATER("CreateNetShortCut",         nullptr,                  false, iCreateNetShortCut)         \
  NOW  ("CheckForMabFon",            nullptr,                  false, iCheckForMabFon)            \
  NOW  ("SetUnzipVar",               nullptr,                  true,  iSetUnzipVar)               \
  LATER("CheckForOldVersion",        nullptr,                  true,  iCheckForOldVersion)        \
  LATER("RemoveOldLinks",            nullptr,                  false, iRemoveOldLinks)            \
  LATER("CheckForCDInstallation",    nullptr,                  false, iCheckForCDInstallation)    \
  LATER("CopyKVIniFile",             nullptr,                  false, iCopyKVIniFile)             \
  LATER("CopySpeechFile",            nullptr,                  false, iCopySpeechFile)            \
  LATER("SetInterfaceLang",          nullptr,                  true,  iSetInterfaceLang)          \
  LATER("CreateSizeFile",            nullptr,                  false, iCreateSizeFile)            \
  LATER("AddToContextMenu",          nullptr,                  true,  iAddToContextMenu)          \
  NOW  ("UpdateRegistry",            nullptr,                  true,  iUpdateRegistry)            \
  NOW  ("CheckForFolder",            "btn_next_folder_OnClick", true, iCheckForFolder)            \
  NOW  ("FinalizeInstallation",      nullptr,                  true,  iFinalizeInstallation)      \
  NOW  ("Unzip",                     nullptr,                  false, iUnzip)                     \
  NOW  ("Reboot",                    nullptr,                  false, iReboot)                    \
  NOW  ("End",                       nullptr,                  false, iEnd)                       \
  NOW  ("InitDefaultPath",           nullptr,                  false, iInitDefaultPath)           \
  LATER("GetUsers",                  nullptr,                  false, iGetUsers)                  \
  LATER("InstallTessor",             nullptr,                  true,  iInstallTessor)             \
  LATER("GetDictionaries",           nullptr,                  false, iGetDictionaries)           \
  LATER("GetLangSupport",            nullptr,                  true,  iGetLangSupport)            \
  LATER("InstallLangSupport",        nullptr,                  false, iInstallLangSupport)        \
  LATER("WriteUserProfile",          nullptr,                  false, iWriteUserProfile)          \
  LATER("dictionaries_OnClick",      "dictionaries_OnSelChange", false, iDictionariesChanged)     \
  NOW  ("b_browse_OnClick",          nullptr,                  true,  b_browse_OnClick)           \
  LATER("SetAllowedDict",            nullptr,                  false, iSetAllowedDict)            \
  LATER("SetExpansionCardTotalSize", nullptr,                  false, iSetExpansionCardTotalSize) \
  LATER("CheckIfHotSyncInit",        nullptr,                  false, iCheckIfHotSyncInit)        \
  LATER("CheckIfHotSyncIsFinished",  nullptr,                  false, iCheckIfHotSyncIsFinished)  \
  LATER("CheckIfAllIsInstalled",     nullptr,                  false, iCheckIfAllIsInstalled)     \
  LATER("RemoveNotInstalledFiles",   nullptr,                  false, iRemoveNotInstalledFiles)   \
  NOW  ("web_OnClick",               nullptr,                  true,  iOpenAddress)               \
  NOW  ("mail_OnClick",              nullptr,                  true,  iOpenAddress)               \
  LATER("RunHalvex",                 nullptr,                  true,  iRunHalvex)                 \
  LATER("StopHalvex",                nullptr,                  true,  iStopHalvex)                \
  LATER("DeinstallToolbar",          nullptr,                  true,  iDeinstallToolbar)          \
  LATER("CheckIfSoftwareIsRuning",   nullptr,                  true,  iCheckIfSoftwareIsRuning)   \
  LATER("CheckForIEVersion",         nullptr,                  false, iCheckForIEVersion)         \
  LATER("InstallIE",                 nullptr,                  false, iInstallIE)                 \
  LATER("CheckForInstalledSoftware", nullptr,                  false, iCheckForInstalledSoftware) \
  LATER("AddColvaneToOldInstallation", nullptr,                false, iAddColvaneToOldInstallation) \
  LATER("StartDorvik",               "btn_end_OnClick",        true,  iStartDorvik)               \
  NOW  ("ParseDefaultPath",          nullptr,                  false, iParseDefaultPath)          \
  NOW  ("CheckForProxy",             nullptr,                  false, iCheckForProxy)             \
  LATER("CheckActiveSync",           nullptr,                  false, iCheckActiveSync)           \
  LATER("InstallMirab",              "b_next_Mab_OnClick",     true,  iInstallMirab)              \
  NOW  ("btn_next_OnClick",          nullptr,                  false, iNextPage)                  \
  NOW  ("btn_back_OnClick",          nullptr,                  false, iBackPage)                  \
  LATER("AddScheduledTask",          nullptr,                  false, iAddScheduledTask)          \
  LATER("CheckRegistryEntry",        nullptr,                  true,  iCheckRegistryEntry)        \
  LATER("StartHalvexMsg",            nullptr,                  false, iStartHalvexMsg)            \
  LATER("CheckFreeSpace",            nullptr,                  false, iCheckFreeSpace)            \
  LATER("GetFreeMemSize",            nullptr,                  true,  iGetFreeMemSize)            \
  NOW  ("run_app_OnClick",           nullptr,                  false, iRunApp)
// clang-format on
