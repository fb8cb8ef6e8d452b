; A setup that ships FolderUpgrade, as a sample and for testing. It takes the place of the client's own setup, without
; the client's files, and has no dialog except the progress.
;
;     makensis -DPACKAGE=<folder of the unpacked zip> -DVERSION=<version> -DOUTPUT=<setup>.exe samples/installer.nsi
;     <setup>.exe [/S] [/D=<folder>]     upgrades
;     <folder>\uninstall.exe [/S]        downgrades
;
; A first installation and another version over it run I once; the same version again runs nothing; removal runs U once.
; It was built with Debian's makensis and run under Wine, as one user with all rights. Real Windows was not tried.
;
; Without a plug-in, an elevated setup cannot start a program as the user. If another account confirms the elevation, the
; tool sees that account's registry, presets and log folder; the reports' first line names the account.
!include LogicLib.nsh
!define KEY "SOFTWARE\Vantorix\QZA"
!define UNINSTALL_KEY "SOFTWARE\Microsoft\Windows\CurrentVersion\Uninstall\QZA"

Unicode true
Target amd64-unicode
Name "Hot folder client"
OutFile "${OUTPUT}"
InstallDir "$PROGRAMFILES64\Vantorix\QZA"
InstallDirRegKey HKLM "${KEY}" "InstallPath"
RequestExecutionLevel admin ; for Program Files and the machine's registry
Page instfiles
UninstPage instfiles

Section
    SetRegView 64 ; the tool reads the 32-bit view first: a client that once wrote there has to remove its key
    ReadRegStr $1 HKLM "${KEY}" "Version" ; before it is overwritten
    SetOutPath "$INSTDIR\BundleIcons"
    File "${PACKAGE}/BundleIcons/hf_*.ico" ; the previous version's, which a downgrade copies
    SetOutPath "$INSTDIR"
    File "${PACKAGE}/FolderUpgrade*.exe"
    File "${PACKAGE}/THIRD-PARTY-NOTICES.txt"
    File "${PACKAGE}/hf_*.ico" ; this version's, which an upgrade copies
    WriteUninstaller "$INSTDIR\uninstall.exe"
    WriteRegStr HKLM "${KEY}" "InstallPath" "$INSTDIR" ; NSIS has removed a final separator; the tool adds "\template"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "DisplayName" "Hot folder client"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "DisplayVersion" "${VERSION}"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "UninstallString" '"$INSTDIR\uninstall.exe"'

    ; A migration that fails for a single folder is no reason not to install the client.
    ${If} $1 != "${VERSION}"
        ExecWait '"$INSTDIR\FolderUpgradeRun.exe" I' $0
        DetailPrint "Hot folders: $0"
    ${EndIf}
    WriteRegStr HKLM "${KEY}" "Version" "${VERSION}" ; last: a setup that was ended before this migrates when started again
SectionEnd

Section Uninstall
    SetRegView 64
    ; While the files and the registry value that it needs are there.
    ExecWait '"$INSTDIR\FolderUpgradeRun.exe" U' $0
    DetailPrint "Hot folders: $0"
    DeleteRegKey HKLM "${UNINSTALL_KEY}"
    DeleteRegKey HKLM "${KEY}"
    ; File by file: the user may have chosen a folder that has other files.
    Delete "$INSTDIR\BundleIcons\hf_*.ico"
    RMDir "$INSTDIR\BundleIcons"
    Delete "$INSTDIR\hf_*.ico"
    Delete "$INSTDIR\THIRD-PARTY-NOTICES.txt"
    Delete "$INSTDIR\FolderUpgrade*.exe"
    Delete "$INSTDIR\uninstall.exe"
    RMDir "$INSTDIR"
SectionEnd
