#include "platform/started_process.h"

#include "platform/system.h"

namespace
{

BOOL CALLBACK CloseIfOf(HWND window, LPARAM process)
{
    DWORD owner = 0;
    GetWindowThreadProcessId(window, &owner);
    if (owner == static_cast<DWORD>(process) && IsWindowVisible(window))
        PostMessageW(window, WM_CLOSE, 0, 0);
    return TRUE;
}

} // namespace

ProgramRun RunProgram(const wxString& path, const wxString& argument,
                      std::chrono::steady_clock::time_point deadline)
{
    SetErrorMode(SEM_FAILCRITICALERRORS | SEM_NOGPFAULTERRORBOX); // the program inherits it
    wxWCharBuffer commandLine = ("\"" + path + "\" " + argument).wc_str(); // the call changes it
    STARTUPINFOW startUp = {};
    startUp.cb = sizeof startUp;
    startUp.dwFlags = STARTF_USESTDHANDLES; // none
    PROCESS_INFORMATION process = {};
    if (!CreateProcessW(path.wc_str(), commandLine.data(), nullptr, nullptr, FALSE, 0, nullptr,
                        nullptr, &startUp, &process))
        return {FailedCall::Now(FailedCall::Open)};
    while (WaitForSingleObject(process.hProcess, 100 /* ms */) == WAIT_TIMEOUT)
    {
        EnumWindows(CloseIfOf, static_cast<LPARAM>(process.dwProcessId));
        if (std::chrono::steady_clock::now() < deadline)
            continue;
        TerminateProcess(process.hProcess, 0);
        WaitForSingleObject(process.hProcess, 5000);
        break;
    }
    DWORD status = 0;
    GetExitCodeProcess(process.hProcess, &status);
    CloseHandle(process.hThread);
    CloseHandle(process.hProcess);
    return {{}, static_cast<int>(status)};
}
