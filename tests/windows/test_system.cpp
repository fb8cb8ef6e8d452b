#include "platform/pinned_directory.h"
#include "platform/started_process.h"
#include "platform/system.h"
#include "tests/workstation.h"

#include <wx/msw/registry.h>

#include <algorithm>
#include <regex>
#include <share.h>

namespace
{

constexpr DWORD TimeLimit = 120 * 1000; // ms, of a run

// Calls it until it succeeds, since a scanner, or Wine, may refuse it for a moment. Throws if it
// still fails after the limit, in ms.
template <class Attempt>
void Repeat(const Attempt& attempt, const Text& failure, DWORD limit = 10 * 1000)
{
    for (DWORD waited = 0; !attempt(); waited += 10)
    {
        if (waited > limit)
            throw std::runtime_error(failure + ", error " + std::to_string(GetLastError()));
        Sleep(10);
    }
}

// A new file that the program inherits, and a program that it has started can keep open.
HANDLE Inherited(const fs::path& path)
{
    SECURITY_ATTRIBUTES inherited = {sizeof inherited, nullptr, TRUE};
    return CreateFileW(path.c_str(), GENERIC_WRITE,
                       FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, &inherited,
                       CREATE_ALWAYS, 0, nullptr);
}

// Closes the program's message boxes; whether there was one.
bool CloseBoxes(DWORD process)
{
    bool isFound = false;
    for (HWND box = nullptr; (box = FindWindowExW(nullptr, box, nullptr, nullptr)) != nullptr;)
    {
        DWORD owner = 0;
        GetWindowThreadProcessId(box, &owner);
        if (owner == process && IsWindowVisible(box))
            isFound = PostMessageW(box, WM_CLOSE, 0, 0) != 0 || isFound;
    }
    return isFound;
}

// Runs a command of the system, not a program of that name from the kit's folder.
int RunCommand(const Text& command)
{
    return _wsystem(
        fs::u8path("cd /d %SystemRoot%\\System32 & " + command + " >nul 2>nul").c_str());
}

Text Quoted(const fs::path& path)
{
    return " \"" + path.u8string() + "\"";
}

// Under Wine, a path for the system that Wine runs on.
Text UnixPath(const fs::path& path)
{
    const Text onDrive = path.relative_path().generic_u8string();
    return Text(" '") + std::getenv("WINEPREFIX") + "/drive_c/" + onDrive + "'";
}

// Under Wine, runs a shell command of the system that Wine runs on. There is no process to wait
// for, and it goes on if this one is ended: so each command makes a file of its own name.
void RunUnix(const Text& command)
{
    const fs::path done = TrialDir() / ("done " + std::to_string(GetTickCount64()));
    const wxString line = wxString::FromUTF8("-c \"" + command + "; :>" + UnixPath(done) + "\"");
    Repeat([&]() { return !RunProgram(L"Z:\\bin\\sh", line, {}).whyNotStarted; }, command);
    Repeat([&]() { return DeleteFileW(done.c_str()) != 0; }, command, TimeLimit);
}

// The names of the keys that the trial makes, one a line.
fs::path KeyFile()
{
    return TrialDir() / "keys";
}

// What Refuse has done.
std::vector<fs::path> refusedPaths;
std::vector<std::shared_ptr<FILE>> usedAlone;

} // namespace

bool IsWine()
{
    return GetProcAddress(GetModuleHandleW(L"ntdll.dll"), "wine_get_version") != nullptr;
}

fs::path ProgramDir()
{
    wchar_t path[MAX_PATH] = {};
    GetModuleFileNameW(nullptr, path, MAX_PATH);
    return fs::path(path).parent_path();
}

fs::path NewRoot()
{
    const fs::path root = TrialDir() / "work station";
    RemoveTree(root); // of a scenario that ended early
    fs::create_directories(root);
    return root;
}

fs::path DataDir(const Text& name, const fs::path& /*root*/)
{
    return _wgetenv(name == "user" ? L"APPDATA" : L"ProgramData");
}

void RemoveKeys()
{
    std::istringstream keys(ReadFile(KeyFile()));
    for (Text key; std::getline(keys, key);)
        wxRegKey(key).DeleteSelf();
    fs::remove(KeyFile());
}

void SetRegistry(const Text& hives)
{
    const std::regex form(R"(^\[(\w+\\SOFTWARE\\(Wow6432Node\\)?\w+))", std::regex::icase);
    RemoveKeys();
    Text keys;
    Text text = "Windows Registry Editor Version 5.00\r\n";
    std::istringstream lines(hives);
    for (Text line; std::getline(lines, line); text += "\n")
    {
        std::smatch key;
        const bool isKey = std::regex_search(line, key, form);
        if (isKey && wxRegKey(key.str(1)).Exists())
            throw std::runtime_error("not the trial's: " + line);
        keys += isKey ? key.str(1) + "\n" : "";
        if (!StartsWith(line, "Windows"))
            text += isKey ? line : Replaced(line, "\\", "\\\\");
    }
    WriteFile(KeyFile(), keys);
    const fs::path file = TrialDir() / "hives.reg";
    const std::wstring units = L"\uFEFF" + fs::u8path(text).wstring();
    WriteFile(file, Text(reinterpret_cast<const char*>(units.data()), 2 * units.size()));
    const Text command = "reg import" + Quoted(file);
    Repeat([&]() { return keys.empty() || RunCommand(command) == 0; }, command + " of " + text);
}

RunResult Workstation::Start(const Text& program, const std::vector<Text>& arguments,
                             const Files& /*variables*/, int killAfter) const
{
    // No argument has a quotation mark or ends in a backslash.
    Text line = Quoted(HostPath("tool/" + program + ".exe")).substr(1);
    for (const Text& argument : arguments)
        line += Quoted(fs::u8path(Expand(argument)));
    STARTUPINFOW startUp = {};
    startUp.cb = sizeof startUp;
    startUp.dwFlags = STARTF_USESTDHANDLES;
    startUp.hStdOutput = Inherited(m_root / "output");
    startUp.hStdError = Inherited(m_root / "errors");
    PROCESS_INFORMATION process = {};
    const auto start = [&]()
    {
        return CreateProcessW(nullptr, fs::u8path(line).wstring().data(), nullptr, nullptr, TRUE,
                              CREATE_NO_WINDOW, nullptr, nullptr, &startUp, &process) != 0;
    };
    Repeat(start, "cannot start " + line);
    CloseHandle(startUp.hStdOutput);
    CloseHandle(startUp.hStdError);
    Text boxes;
    Text last;
    const DWORD limit = killAfter > 0 ? static_cast<DWORD>(killAfter) : TimeLimit;
    for (DWORD waited = 0, step = 50; waited < limit; waited += step)
    {
        step = std::min(step, limit - waited);
        if (WaitForSingleObject(process.hProcess, step) == WAIT_OBJECT_0)
            break;
        // FolderUpgradeRun has to do without a person.
        const bool isClosed = program != "FolderUpgradeRun" && CloseBoxes(process.dwProcessId);
        const Text text = ReadFile(HostPath(LogPlace));
        if (isClosed && last != text) // a box may need a moment to close
            boxes += "A message box, with the run log\n" + (last = text);
    }
    TerminateProcess(process.hProcess, 1); // which fails if it has ended
    WaitForSingleObject(process.hProcess, TimeLimit);
    DWORD status = 0;
    GetExitCodeProcess(process.hProcess, &status);
    CloseHandle(process.hThread);
    CloseHandle(process.hProcess);
    return {static_cast<int>(status & 0xFF), ReadFile(m_root / "output"),
            ReadFile(m_root / "errors") + boxes};
}

void MakeLink(const fs::path& target, const fs::path& link)
{
    if (IsWine())
        RunUnix("ln -s" + UnixPath(target) + UnixPath(link));
    else
        RunCommand((fs::is_directory(target) ? "mklink /J" : "mklink") + Quoted(link) +
                   Quoted(target));
}

void AllowAll(const fs::path& folder)
{
    if (!fs::exists(folder))
        return;
    IsWine() ? RunUnix("chmod -R u+rwX" + UnixPath(folder))
             : static_cast<void>(RunCommand("icacls" + Quoted(folder) + " /reset /T /C /Q"));
}

void RemoveTree(const fs::path& path)
{
    usedAlone.clear();
    for (const fs::path& refused : std::exchange(refusedPaths, {}))
        AllowAll(refused);
    const DWORD attributes = GetFileAttributesW(path.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return;
    SetFileAttributesW(path.c_str(), FILE_ATTRIBUTE_NORMAL);
    const bool isDirectory = (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
    if (isDirectory && !IsLink(path.wstring()))
    {
        for (const auto& entry : fs::directory_iterator(path))
            RemoveTree(entry.path());
    }
    const auto remove = isDirectory ? RemoveDirectoryW : DeleteFileW;
    if (!IsWine())
        Repeat([&]() { return remove(path.c_str()) != 0; }, "cannot remove " + path.u8string());
    else if (remove(path.c_str()) == 0) // of a link to a directory, or a dangling one
        RunUnix("rm -rf" + UnixPath(path));
}

void Refuse(const fs::path& path, char letter)
{
    static const Files rights = {{"X", "(WD,AD,WEA,WA,DC,DE)"},
                                 {"L", "(RD)"},
                                 {"0", "(OI)(CI)(RD,REA,RA,X,WD,AD,WEA,WA,DC,DE)"}};
    if (letter == '0' && fs::is_regular_file(path))
    {
        usedAlone.emplace_back(_wfsopen(path.c_str(), L"rb", _SH_DENYRW), fclose);
        return;
    }
    if (IsWine()) // where an access control list refuses nobody
        RunUnix((letter == 'X' ? "chmod a-w" : "chmod 0") + UnixPath(path));
    else
        RunCommand("icacls" + Quoted(path) + " /deny *S-1-1-0:" + rights.at(Text(1, letter)));
    refusedPaths.push_back(path);
}
