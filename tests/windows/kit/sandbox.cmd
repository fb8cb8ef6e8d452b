@echo off
rem Starts a Windows Sandbox that runs trial.cmd and writes trial.txt into this folder: see README.txt.
setlocal EnableDelayedExpansion
chcp 65001 > nul
set "folder=%~dp0"
set "folder=!folder:~0,-1!"
set "folder=!folder:&=&amp;!"
(
    echo ^<Configuration^>
    echo ^<MappedFolders^>^<MappedFolder^>
    echo ^<HostFolder^>!folder!^</HostFolder^>
    echo ^<SandboxFolder^>C:\trial^</SandboxFolder^>
    echo ^<ReadOnly^>false^</ReadOnly^>
    echo ^</MappedFolder^>^</MappedFolders^>
    echo ^<Networking^>Disable^</Networking^>
    echo ^<LogonCommand^>^<Command^>C:\trial\trial.cmd^</Command^>^</LogonCommand^>
    echo ^</Configuration^>
) > "%~dp0trial.wsb"
start "" "%~dp0trial.wsb"
