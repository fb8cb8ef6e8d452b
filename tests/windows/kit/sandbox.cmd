@echo off
rem Starts a Windows Sandbox that runs trial.cmd and writes trial.txt into this folder: see README.txt.
cd /d "%~dp0"
if exist trial.txt del trial.txt
chcp 65001 > nul
set "folder=%CD%"
set "folder=%folder:&=&amp;%"
setlocal EnableDelayedExpansion
> trial.wsb echo ^<Configuration^>
>> trial.wsb echo ^<MappedFolders^>^<MappedFolder^>
>> trial.wsb echo ^<HostFolder^>!folder!^</HostFolder^>
>> trial.wsb echo ^<SandboxFolder^>C:\trial^</SandboxFolder^>
>> trial.wsb echo ^<ReadOnly^>false^</ReadOnly^>
>> trial.wsb echo ^</MappedFolder^>^</MappedFolders^>
>> trial.wsb echo ^<Networking^>Disable^</Networking^>
>> trial.wsb echo ^<LogonCommand^>
>> trial.wsb echo ^<Command^>powershell -NoProfile -Command "Start-Process C:\trial\trial.cmd -Verb RunAs"^</Command^>
>> trial.wsb echo ^</LogonCommand^>
>> trial.wsb echo ^</Configuration^>
if not exist trial.cmd (
    echo Unpack the whole kit first.
    pause
) else if not exist "%SystemRoot%\System32\WindowsSandbox.exe" (
    echo Windows Sandbox is not turned on: see README.txt.
    pause
) else start "" trial.wsb
