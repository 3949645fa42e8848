// The installer's vocabulary, one row for each command, in the order in which names are compared:
// ROW(name, second name or nullptr, takes its parameter, handler method of CNInstallWizard, what it does).
#pragma once

// clang-format off
#define ORBIT_INSTALL_COMMANDS(ROW) \
  ROW("SetQuitInstall",            nullptr,                  true,  iSetQuitInstall,            "Holds leaving the setup back, or allows it again.") \
  ROW("InstallWizard",             "install_wizard_OnClick", true,  iInstallWizard,             "Starts a separate setup from the temporary folder, when one was asked for.") \
  ROW("SetVersion",                nullptr,                  false, iSetVersion,                "Puts the version into the window's title.") \
  ROW("btn_no_cro_supp_a_OnClick", nullptr,                  false, iRequestSetupA,             "Asks for the first separate setup.") \
  ROW("btn_no_cro_supp_b_OnClick", nullptr,                  false, iRequestSetupB,             "Asks for the second separate setup.") \
  ROW("BackupOldHalvex",           nullptr,                  false, iBackupOldHalvex,           "Keeps a copy of the installed server product before it is replaced.") \
  ROW("SearchNet",                 nullptr,                  false, iSearchNet,                 "Searches the network's shares in the background, then goes on to the next page.") \
  ROW("FillNetListView",           nullptr,                  false, iFillNetListView,           "Lists the shares that the search has found.") \
  ROW("CreateNetShortCut",         nullptr,                  false, iCreateNetShortCut,         "Puts a shortcut to the installed program on the chosen share.") \
  ROW("CheckForMabFon",            nullptr,                  false, iCheckForMabFon,            "Always answers no.") \
  ROW("SetUnzipVar",               nullptr,                  true,  iSetUnzipVar,               "Sets the number that holds leaving the setup back.") \
  ROW("CheckForOldVersion",        nullptr,                  true,  iCheckForOldVersion,        "Looks for an earlier installation and proposes its folder.") \
  ROW("RemoveOldLinks",            nullptr,                  false, iRemoveOldLinks,            "Removes the shortcuts that an earlier installation left.") \
  ROW("CheckForCDInstallation",    nullptr,                  false, iCheckForCDInstallation,    "Looks for the speech files on the drives C: to J:.") \
  ROW("CopyKVIniFile",             nullptr,                  false, iCopyKVIniFile,             "Writes the folder of the speech files into kv.ini.") \
  ROW("CopySpeechFile",            nullptr,                  false, iCopySpeechFile,            "Copies the speech files in the background, then goes on to the next page.") \
  ROW("SetInterfaceLang",          nullptr,                  true,  iSetInterfaceLang,          "Writes the language of the program's windows into kv.ini.") \
  ROW("CreateSizeFile",            nullptr,                  false, iCreateSizeFile,            "Writes size.dat, the sizes of the installed files.") \
  ROW("AddToContextMenu",          nullptr,                  true,  iAddToContextMenu,          "Puts the program into the context menu of files.") \
  ROW("UpdateRegistry",            nullptr,                  true,  iUpdateRegistry,            "Enters the program among the installed ones and writes its settings.") \
  ROW("CheckForFolder",            "btn_next_folder_OnClick", true, iCheckForFolder,            "Checks the destination and its free space, and offers to make it.") \
  ROW("FinalizeInstallation",      nullptr,                  true,  iFinalizeInstallation,      "Makes shortcuts and the uninstall record, installs fonts, file types and the uninstaller.") \
  ROW("Unzip",                     nullptr,                  false, iUnzip,                     "Copies the product's files in the background, then goes on to the next page.") \
  ROW("Reboot",                    nullptr,                  false, iReboot,                    "Offers to restart the computer after an upgrade, and ends.") \
  ROW("End",                       nullptr,                  false, iEnd,                       "Ends the wizard.") \
  ROW("InitDefaultPath",           nullptr,                  false, iInitDefaultPath,           "Puts the folder for programs before the destination, once.") \
  ROW("GetUsers",                  nullptr,                  false, iGetUsers,                  "Lists the users of a handheld: none.") \
  ROW("InstallTessor",             nullptr,                  true,  iInstallTessor,             "Installs on a Palm handheld: there is none.") \
  ROW("GetDictionaries",           nullptr,                  false, iGetDictionaries,           "Lists the dictionaries that can be installed.") \
  ROW("GetLangSupport",            nullptr,                  true,  iGetLangSupport,            "Lists the East Asian languages that the system does not support yet.") \
  ROW("InstallLangSupport",        nullptr,                  false, iInstallLangSupport,        "Has the system install the chosen East Asian languages.") \
  ROW("WriteUserProfile",          nullptr,                  false, iWriteUserProfile,          "Writes what the user typed as an XML file.") \
  ROW("dictionaries_OnClick",      "dictionaries_OnSelChange", false, iDictionariesChanged,     "Enables Next while a dictionary is chosen.") \
  ROW("b_browse_OnClick",          nullptr,                  true,  b_browse_OnClick,           "Lets the user choose the destination.") \
  ROW("SetAllowedDict",            nullptr,                  false, iSetAllowedDict,            "Writes the allowed dictionaries into the registry.") \
  ROW("SetExpansionCardTotalSize", nullptr,                  false, iSetExpansionCardTotalSize, "Adds up the sizes of the chosen dictionaries.") \
  ROW("CheckIfHotSyncInit",        nullptr,                  false, iCheckIfHotSyncInit,        "Asks whether handheld synchronisation is set up: it is not.") \
  ROW("CheckIfHotSyncIsFinished",  nullptr,                  false, iCheckIfHotSyncIsFinished,  "Asks whether handheld synchronisation has finished: nothing is waiting.") \
  ROW("CheckIfAllIsInstalled",     nullptr,                  false, iCheckIfAllIsInstalled,     "Measures what is still waiting for a handheld: nothing.") \
  ROW("RemoveNotInstalledFiles",   nullptr,                  false, iRemoveNotInstalledFiles,   "Removes what is still waiting for a handheld: nothing.") \
  ROW("web_OnClick",               nullptr,                  true,  iOpenAddress,               "Opens a web address.") \
  ROW("mail_OnClick",              nullptr,                  true,  iOpenAddress,               "Opens a mail address.") \
  ROW("RunHalvex",                 nullptr,                  true,  iRunHalvex,                 "Starts another product and registers its browser toolbar.") \
  ROW("StopHalvex",                nullptr,                  true,  iStopHalvex,                "Has another product's server stop and take itself off.") \
  ROW("DeinstallToolbar",          nullptr,                  true,  iDeinstallToolbar,          "Takes a browser toolbar off, once the browser is closed.") \
  ROW("CheckIfSoftwareIsRuning",   nullptr,                  true,  iCheckIfSoftwareIsRuning,   "Stays on the page while a program runs that must not.") \
  ROW("CheckForIEVersion",         nullptr,                  false, iCheckForIEVersion,         "Tells whether the browser is version 5.5 or later.") \
  ROW("InstallIE",                 nullptr,                  false, iInstallIE,                 "Runs the browser's setup, then goes on to the next page.") \
  ROW("CheckForInstalledSoftware", nullptr,                  false, iCheckForInstalledSoftware, "Finds which of the maker's products are installed.") \
  ROW("AddColvaneToOldInstallation", nullptr,                false, iAddColvaneToOldInstallation, "Adds a shortcut to the program folder of an earlier installation.") \
  ROW("StartDorvik",               "btn_end_OnClick",        true,  iStartDorvik,               "Starts the browser, and ends.") \
  ROW("ParseDefaultPath",          nullptr,                  false, iParseDefaultPath,          "Removes one backslash from the end of the destination.") \
  ROW("CheckForProxy",             nullptr,                  false, iCheckForProxy,             "Reads the system's proxy.") \
  ROW("CheckActiveSync",           nullptr,                  false, iCheckActiveSync,           "Stays on the page, with a message, without the Pocket PC synchronisation manager.") \
  ROW("InstallMirab",              "b_next_Mab_OnClick",     true,  iInstallMirab,              "Installs on a Pocket PC: there is none.") \
  ROW("btn_next_OnClick",          nullptr,                  false, iNextPage,                  "Goes on as the button Next does.") \
  ROW("btn_back_OnClick",          nullptr,                  false, iBackPage,                  "Sets a variable for the page's flow and runs the button Next.") \
  ROW("AddScheduledTask",          nullptr,                  false, iAddScheduledTask,          "Adds a daily task in the background, then goes on to the next page.") \
  ROW("CheckRegistryEntry",        nullptr,                  true,  iCheckRegistryEntry,        "Tells whether a registry key or value is there.") \
  ROW("StartHalvexMsg",            nullptr,                  false, iStartHalvexMsg,            "Decides whether the start of the server product is to be announced.") \
  ROW("CheckFreeSpace",            nullptr,                  false, iCheckFreeSpace,            "Compares what is to be installed with the free space of a handheld's card.") \
  ROW("GetFreeMemSize",            nullptr,                  true,  iGetFreeMemSize,            "Shows the free space of a handheld: none.") \
  ROW("run_app_OnClick",           nullptr,                  false, iRunApp,                    "Starts the installed program, and ends.")
// clang-format on
