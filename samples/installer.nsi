; An installer that ships FolderUpgrade, as a sample and for trials; it stands for the client's own.
;
;     makensis -DPACKAGE=<folder of the unpacked zip> -DOUTPUT=<setup>.exe samples/installer.nsi
;     <setup>.exe [/S] [/D=<folder>]     upgrades
;     <folder>\uninstall.exe [/S]        downgrades
;
; Both append the switch and the exit status to <folder>\FolderUpgrade.txt, and keep the run log
; beside it, since the next run empties it. The previous version's folder has to be in the registry.
Unicode true
Target amd64-unicode
Name "Hot folder client"
OutFile "${OUTPUT}"
InstallDir "$PROGRAMFILES64\Vantorix\QZA"
; The machine's registry asks for it. Where the elevation prompt takes another account, that account's
; presets are the ones that the tool sees.
RequestExecutionLevel admin
Page instfiles
UninstPage instfiles

; milliseconds; what still runs then is a message box that waits, and the 64-bit engine leaves it there
!define TIME_LIMIT 600000

!macro DEFINE_RUN_TOOL prefix
Function ${prefix}RunTool ; the switch is on the stack
    Pop $0
    CreateDirectory "$APPDATA\ORX_Installers" ; without it there is no log
    nsExec::Exec /TIMEOUT=${TIME_LIMIT} '"$INSTDIR\FolderUpgrade.exe" $0'
    Pop $1 ; -1 (some engines: 4294967295) says nothing; "timeout" and "error" do
    FileOpen $2 "$INSTDIR\FolderUpgrade.txt" a
    FileSeek $2 0 END
    FileWrite $2 "$0 $1$\r$\n"
    FileClose $2
    CopyFiles /SILENT "$APPDATA\ORX_Installers\UpgradeDowngrade.log" "$INSTDIR\FolderUpgrade-$0.log"
FunctionEnd
!macroend
!insertmacro DEFINE_RUN_TOOL ""
!insertmacro DEFINE_RUN_TOOL "un."

Section
    SetRegView 64
    SetOutPath "$INSTDIR"
    File /r "${PACKAGE}/*"
    WriteRegStr HKLM "SOFTWARE\Vantorix\QZA" "InstallPath" "$INSTDIR"
    WriteUninstaller "$INSTDIR\uninstall.exe"
    Push I
    Call RunTool
SectionEnd

Section Uninstall
    SetRegView 64
    Push U
    Call un.RunTool ; before the folder that it moves from is forgotten
    DeleteRegKey HKLM "SOFTWARE\Vantorix\QZA"
SectionEnd
