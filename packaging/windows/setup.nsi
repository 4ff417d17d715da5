; Installs the programs for the user who runs it; nobody's permission is needed. The user's own settings are made
; elsewhere (%APPDATA%\KDX-RDS) at the first start, and stay when the programs are removed.
; Wants VERSION, ICON, FILES (a folder with bin and share) and OUTPUT.
Unicode true
Target amd64-unicode
Name "KDX-RDS"
OutFile "${OUTPUT}"
InstallDir "$LOCALAPPDATA\Programs\KDX-RDS"
InstallDirRegKey HKCU "Software\KDX-RDS" "Folder"
RequestExecutionLevel user
SetCompressor /SOLID lzma

!include FileFunc.nsh
!include LogicLib.nsh
!include MUI2.nsh
!define MUI_ICON "${ICON}"
!define UNINSTALL "Software\Microsoft\Windows\CurrentVersion\Uninstall\KDX-RDS"
!insertmacro MUI_PAGE_LICENSE "${FILES}/LICENSE.txt"
!insertmacro MUI_PAGE_DIRECTORY
!insertmacro MUI_PAGE_INSTFILES
!insertmacro MUI_UNPAGE_CONFIRM
!insertmacro MUI_UNPAGE_INSTFILES
!insertmacro MUI_LANGUAGE "English"
!insertmacro MUI_LANGUAGE "German"

VIProductVersion "${VERSION}.0"
VIAddVersionKey /LANG=0 "ProductName" "KDX-RDS"
VIAddVersionKey /LANG=0 "ProductVersion" "${VERSION}"
VIAddVersionKey /LANG=0 "FileVersion" "${VERSION}"
VIAddVersionKey /LANG=0 "FileDescription" "KDX-RDS set-up"
VIAddVersionKey /LANG=0 "LegalCopyright" "MIT licence"

Section
    ; A folder of its own, whatever was chosen: it is removed later, and nobody else's files are to go with it.
    ${GetFileName} "$INSTDIR" $0
    ${If} $0 != "KDX-RDS"
        StrCpy $INSTDIR "$INSTDIR\KDX-RDS"
    ${EndIf}
    ; What an earlier version had and this one has not is not to stay.
    ${If} ${FileExists} "$INSTDIR\uninstall.exe"
        RMDir /r "$INSTDIR\bin"
        RMDir /r "$INSTDIR\share\kdx-rds"
        RMDir /r "$INSTDIR\licences"
    ${EndIf}
    SetOutPath "$INSTDIR"
    File /r "${FILES}/*"
    WriteUninstaller "$INSTDIR\uninstall.exe"
    CreateShortcut "$SMPROGRAMS\KDX-RDS.lnk" "$INSTDIR\bin\kdx-rds.exe"
    WriteRegStr HKCU "Software\KDX-RDS" "Folder" "$INSTDIR"
    WriteRegStr HKCU "${UNINSTALL}" "DisplayName" "KDX-RDS"
    WriteRegStr HKCU "${UNINSTALL}" "DisplayVersion" "${VERSION}"
    WriteRegStr HKCU "${UNINSTALL}" "DisplayIcon" "$INSTDIR\bin\kdx-rds.exe"
    WriteRegStr HKCU "${UNINSTALL}" "InstallLocation" "$INSTDIR"
    WriteRegStr HKCU "${UNINSTALL}" "UninstallString" '"$INSTDIR\uninstall.exe"'
    WriteRegStr HKCU "${UNINSTALL}" "QuietUninstallString" '"$INSTDIR\uninstall.exe" /S'
    WriteRegDWORD HKCU "${UNINSTALL}" "NoModify" 1
    WriteRegDWORD HKCU "${UNINSTALL}" "NoRepair" 1
SectionEnd

Section "Uninstall"
    ; Only what came with the set-up: whoever put other things beside it keeps them.
    RMDir /r "$INSTDIR\bin"
    RMDir /r "$INSTDIR\share\kdx-rds"
    RMDir "$INSTDIR\share"
    RMDir /r "$INSTDIR\licences"
    Delete "$INSTDIR\LICENSE.txt"
    Delete "$INSTDIR\uninstall.exe"
    SetOutPath "$TEMP"  ; a folder that is at work cannot be removed
    RMDir "$INSTDIR"
    Delete "$SMPROGRAMS\KDX-RDS.lnk"
    DeleteRegKey HKCU "${UNINSTALL}"
    DeleteRegKey HKCU "Software\KDX-RDS"
SectionEnd
