; The sample tree as NSIS packs it: a usual script, two pages, an uninstaller.
Unicode true
SetCompressor zlib
Name "Sample"
OutFile "${OUTPUT}"
InstallDir "$PROGRAMFILES\Sample"
RequestExecutionLevel admin
Page directory
Page instfiles
UninstPage uninstConfirm
UninstPage instfiles

!define ENTRY "Software\Microsoft\Windows\CurrentVersion\Uninstall\Sample"

Section
  SetOutPath "$INSTDIR"
  File /r "${TREE}/*"
  WriteUninstaller "$INSTDIR\uninstall.exe"
  CreateDirectory "$SMPROGRAMS\Sample"
  CreateShortCut "$SMPROGRAMS\Sample\Sample.lnk" "$INSTDIR\${PROGRAM}"
  CreateShortCut "$SMPROGRAMS\Sample\Uninstall.lnk" "$INSTDIR\uninstall.exe"
  WriteRegStr HKLM "${ENTRY}" "DisplayName" "Sample"
  WriteRegStr HKLM "${ENTRY}" "UninstallString" '"$INSTDIR\uninstall.exe"'
SectionEnd

Section Uninstall
  RMDir /r "$SMPROGRAMS\Sample"
  RMDir /r "$INSTDIR"
  DeleteRegKey HKLM "${ENTRY}"
SectionEnd
