; A setup that ships FolderUpgrade, as a sample and for testing. It takes the place of the client's own setup, without
; the client's files, and has no dialog except the progress.
;
;     makensis -DPACKAGE=<folder of the unpacked zip> -DVERSION=1.1.0 -DOUTPUT=<setup>.exe samples/installer.nsi
;     <setup>.exe [/S] [/D=<folder>]     upgrades
;     <folder>\uninstall.exe [/S]        downgrades
;
; It was built with Debian's makensis and run under Wine, as one user with all rights. Real Windows was not tried.
;
; What runs when:
;
;     first installation               I, once
;     another version over it          I of that version; the installed uninstaller is replaced, not run
;     the same version again           nothing; the files are put back
;     removal                          U, once
;
; Beside the run log, in %APPDATA%\ORX_Installers, a support engineer finds after an upgrade
;
;     FolderUpgrade-upgrade-before.txt   what FolderUpgradeCheck said before the run: its changes and problems
;     FolderUpgrade-upgrade-after.txt    the same after it: what is left to do, and why
;     FolderUpgrade-upgrade.log          a copy of the run log, which the next run empties
;
; and after a downgrade the same three with "downgrade" in their names. The uninstaller leaves them.
;
; What NSIS cannot do:
;
;   - An elevated setup cannot start a program as the user without a plug-in. If another account confirms the
;     elevation, the tool sees that account's registry, presets and log folder. The reports' first line names the account.
;     An MSI does better there (installer.wxs).
;   - nsExec has a time limit but leaves a program that exceeds it running. After ten minutes, all that still runs is the
;     library's message box, which waits for its button: the run is over by then, and its log complete. The report
;     "before" names each cause of a box as a problem.
!include LogicLib.nsh
!define KEY "SOFTWARE\Vantorix\QZA"
!define UNINSTALL_KEY "SOFTWARE\Microsoft\Windows\CurrentVersion\Uninstall\QZA"
!define TIME_LIMIT 600000 ; milliseconds

Unicode true
Target amd64-unicode
Name "Hot folder client"
OutFile "${OUTPUT}"
InstallDir "$PROGRAMFILES64\Vantorix\QZA"
InstallDirRegKey HKLM "${KEY}" "InstallPath"
RequestExecutionLevel admin ; for Program Files and the machine's registry
Page instfiles
UninstPage instfiles

; Starts a program. Its status is written to the details and otherwise ignored: the tool's is always -1 (in some engines
; 4294967295), the check's follows from its report, and a migration that fails for a single folder is no reason not to
; install the client.
!macro START program arguments
    nsExec::Exec /TIMEOUT=${TIME_LIMIT} '"$INSTDIR\${program}" ${arguments}'
    Pop $0 ; or "timeout" or "error"
    DetailPrint "${program}: $0"
!macroend

; The tool, between two reports. It does not create the log's folder.
!macro MIGRATE switch direction
    !define REPORTS "$APPDATA\ORX_Installers\FolderUpgrade-${direction}"
    CreateDirectory "$APPDATA\ORX_Installers"
    !insertmacro START FolderUpgradeCheck.exe '${switch} "${REPORTS}-before.txt"'
    !insertmacro START FolderUpgrade.exe ${switch}
    !insertmacro START FolderUpgradeCheck.exe '${switch} "${REPORTS}-after.txt"'
    ; An elevated setup writes to a folder in which the user may have planted links; the check and CopyFiles follow them.
    CopyFiles /SILENT "$APPDATA\ORX_Installers\UpgradeDowngrade.log" "${REPORTS}.log"
    !undef REPORTS
!macroend

Section
    SetRegView 64 ; the tool reads the 32-bit view first: a client that once wrote there has to remove its key
    ReadRegStr $1 HKLM "${KEY}" "Version" ; before it is overwritten

    SetOutPath "$INSTDIR\BundleIcons"
    File "${PACKAGE}/BundleIcons/hf_*.ico" ; the previous version's, which a downgrade copies
    SetOutPath "$INSTDIR" ; last: the programs start there
    File "${PACKAGE}/FolderUpgrade.exe"
    File "${PACKAGE}/FolderUpgradeCheck.exe"
    File "${PACKAGE}/THIRD-PARTY-NOTICES.txt"
    File "${PACKAGE}/hf_*.ico" ; this version's, which an upgrade copies

    WriteRegStr HKLM "${KEY}" "InstallPath" "$INSTDIR" ; NSIS has removed a final separator; the tool adds "\template"
    WriteUninstaller "$INSTDIR\uninstall.exe"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "DisplayName" "Hot folder client"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "DisplayVersion" "${VERSION}"
    WriteRegStr HKLM "${UNINSTALL_KEY}" "UninstallString" '"$INSTDIR\uninstall.exe"'

    ${If} $1 != "${VERSION}"
        !insertmacro MIGRATE I upgrade
    ${EndIf}
    WriteRegStr HKLM "${KEY}" "Version" "${VERSION}" ; last: if the setup is ended before this, it migrates when it is started again
SectionEnd

Section Uninstall
    SetRegView 64
    !insertmacro MIGRATE U downgrade ; while the files and the registry value that it needs are there

    DeleteRegKey HKLM "${UNINSTALL_KEY}"
    DeleteRegKey HKLM "${KEY}"
    ; File by file: the user may have chosen a folder that has other files.
    Delete "$INSTDIR\BundleIcons\hf_*.ico"
    RMDir "$INSTDIR\BundleIcons"
    Delete "$INSTDIR\hf_*.ico"
    Delete "$INSTDIR\THIRD-PARTY-NOTICES.txt"
    Delete "$INSTDIR\FolderUpgradeCheck.exe"
    Delete /REBOOTOK "$INSTDIR\FolderUpgrade.exe" ; a message box may still hold it
    Delete "$INSTDIR\uninstall.exe"
    RMDir "$INSTDIR"
SectionEnd
