#include "tests/test_system.h"

#include "platform/pinned_directory.h"
#include "platform/system.h"
#include "tests/windows/trial_machine.h"

#include <algorithm>
#include <regex>
#include <sstream>
#include <stdexcept>

namespace fs = std::filesystem;

namespace
{

constexpr DWORD TimeLimit = 120 * 1000; // ms, of a run

std::wstring Wide(const Text& text)
{
    return fs::u8path(text).wstring();
}

fs::path KnownFolder(int number)
{
    wchar_t path[MAX_PATH] = {};
    if (SHGetFolderPathW(nullptr, number, nullptr, SHGFP_TYPE_CURRENT, path) != S_OK)
        throw std::runtime_error("no application data folder");
    return path;
}

// A file that the program inherits.
HANDLE Inherited(const fs::path& path)
{
    SECURITY_ATTRIBUTES inherited = {sizeof inherited, nullptr, TRUE};
    return CreateFileW(path.c_str(), GENERIC_WRITE, FILE_SHARE_READ, &inherited, CREATE_ALWAYS, 0,
                       nullptr);
}

// A program with its limits, and with the standard streams in files.
class Process
{
  public:
    Process(std::wstring line, const fs::path& output, const fs::path& errors)
    {
        JOBOBJECT_EXTENDED_LIMIT_INFORMATION limits = {};
        limits.BasicLimitInformation.LimitFlags = JOB_OBJECT_LIMIT_PROCESS_MEMORY;
        limits.ProcessMemoryLimit = 700 * 1000 * 1000;
        SetInformationJobObject(m_job, JobObjectExtendedLimitInformation, &limits, sizeof limits);
        STARTUPINFOW startUp = {};
        startUp.cb = sizeof startUp;
        startUp.dwFlags = STARTF_USESTDHANDLES;
        startUp.hStdOutput = Inherited(output);
        startUp.hStdError = Inherited(errors);
        PROCESS_INFORMATION process = {};
        const BOOL isStarted = CreateProcessW(nullptr, line.data(), nullptr, nullptr, TRUE,
                                              CREATE_SUSPENDED | CREATE_NO_WINDOW, nullptr, nullptr,
                                              &startUp, &process);
        CloseHandle(startUp.hStdOutput);
        CloseHandle(startUp.hStdError);
        if (!isStarted)
            throw std::runtime_error("cannot start " + fs::path(line).u8string());
        AssignProcessToJobObject(m_job, process.hProcess);
        ResumeThread(process.hThread);
        CloseHandle(process.hThread);
        m_process = process.hProcess;
        m_number = process.dwProcessId;
    }

    ~Process()
    {
        TerminateJobObject(m_job, 1);
        EndsWithin(TimeLimit);
        CloseHandle(m_process);
        CloseHandle(m_job);
    }

    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;

    bool EndsWithin(DWORD milliseconds) const
    {
        return WaitForSingleObject(m_process, milliseconds) == WAIT_OBJECT_0;
    }

    int Status() const
    {
        DWORD status = 0;
        GetExitCodeProcess(m_process, &status);
        return static_cast<int>(status & 0xFF);
    }

    // Whether the program shows a box; closes it.
    bool CloseBox() const
    {
        std::pair<DWORD, bool> search = {m_number, false};
        EnumWindows(CloseIfOf, reinterpret_cast<LPARAM>(&search));
        return search.second;
    }

  private:
    static BOOL CALLBACK CloseIfOf(HWND window, LPARAM data)
    {
        auto& [process, isFound] = *reinterpret_cast<std::pair<DWORD, bool>*>(data);
        DWORD owner = 0;
        GetWindowThreadProcessId(window, &owner);
        if (owner == process && IsWindowVisible(window))
            isFound = PostMessageW(window, WM_CLOSE, 0, 0) != 0 || isFound;
        return TRUE;
    }

    HANDLE m_job = CreateJobObjectW(nullptr, nullptr);
    HANDLE m_process = nullptr;
    DWORD m_number = 0;
};

void RunSystem(const Text& line)
{
    const Process process(Wide(line), L"NUL", L"NUL");
    if (!process.EndsWithin(TimeLimit))
        throw std::runtime_error(line + " does not end");
}

// Under Wine, a path for the system that Wine runs on.
Text UnixPath(const fs::path& path)
{
    using Convert = char* (*)(const wchar_t*);
    const auto convert = reinterpret_cast<Convert>(reinterpret_cast<void*>(
        GetProcAddress(GetModuleHandleW(L"kernel32.dll"), "wine_get_unix_file_name")));
    return " '" + Text(convert(path.c_str())) + "'";
}

// Under Wine, runs a shell command of the system that Wine runs on. There is no handle to wait for.
void RunUnix(const Text& command)
{
    const fs::path done = TrialDir() / "done";
    std::wstring line = Wide("Z:\\bin\\sh -c \"" + command + "; :>" + UnixPath(done) + "\"");
    STARTUPINFOW startUp = {};
    PROCESS_INFORMATION process = {};
    CreateProcessW(nullptr, line.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr, &startUp,
                   &process);
    for (DWORD waited = 0; DeleteFileW(done.c_str()) == 0; waited += 5)
    {
        if (waited > TimeLimit)
            throw std::runtime_error(command + " does not end");
        Sleep(5);
    }
}

std::vector<fs::path>& RefusedPaths()
{
    static std::vector<fs::path> paths;
    return paths;
}

// After the equals sign: "text", dword:number, hex:bytes or hex(type):bytes.
void SetValue(HKEY key, const Text& name, const Text& stored)
{
    std::vector<BYTE> bytes;
    DWORD type = REG_BINARY;
    std::smatch parts;
    if (stored[0] == '"')
    {
        const Text text = stored.substr(1, stored.rfind('"') - 1);
        const std::wstring wide =
            Wide(std::regex_replace(text, std::regex(R"(\\(.))"), std::string("$1")));
        const BYTE* const begin = reinterpret_cast<const BYTE*>(wide.c_str());
        bytes.assign(begin, begin + 2 * (wide.size() + 1));
        type = REG_SZ;
    }
    else if (std::regex_match(stored, parts, std::regex("dword:(.*)")))
    {
        const unsigned long number = std::stoul(parts[1], nullptr, 16);
        bytes = {static_cast<BYTE>(number), static_cast<BYTE>(number >> 8),
                 static_cast<BYTE>(number >> 16), static_cast<BYTE>(number >> 24)};
        type = REG_DWORD;
    }
    else if (std::regex_match(stored, parts, std::regex(R"(hex(?:\((.)\))?:(.*))")))
    {
        type = parts[1].matched ? static_cast<DWORD>(std::stoul(parts[1])) : type;
        std::istringstream list(parts[2]);
        for (Text byte; std::getline(list, byte, ',');)
            bytes.push_back(static_cast<BYTE>(std::stoul(byte, nullptr, 16)));
    }
    RegSetValueExW(key, Wide(name).c_str(), 0, type, bytes.data(),
                   static_cast<DWORD>(bytes.size()));
}

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

fs::path UserDataDir(const fs::path& /*root*/)
{
    return KnownFolder(CSIDL_APPDATA);
}

fs::path MachineDataDir(const fs::path& /*root*/)
{
    return KnownFolder(CSIDL_COMMON_APPDATA);
}

void SetRegistry(const std::vector<Text>& hives)
{
    RemoveKeys();
    HKEY key = nullptr;
    for (const Text& hive : hives)
    {
        std::istringstream lines(hive);
        std::smatch parts;
        for (Text line; std::getline(lines, line);)
        {
            line.erase(line.find_last_not_of('\r') + 1);
            if (std::regex_match(line, parts, std::regex(R"(\[HKEY_(\w+)\\(.*)\])")))
            {
                RegCloseKey(key);
                RegCreateKeyExW(parts[1] == "CURRENT_USER" ? HKEY_CURRENT_USER : HKEY_LOCAL_MACHINE,
                                Wide(parts[2]).c_str(), 0, nullptr, 0, KEY_ALL_ACCESS, nullptr,
                                &key, nullptr);
            }
            else if (std::regex_match(line, parts, std::regex("\"(\\w+)\"=(.+)")))
                SetValue(key, parts[1], parts[2]);
        }
    }
    RegCloseKey(key);
}

RunResult RunToEnd(const Command& command, const fs::path& root, const fs::path& log)
{
    Text line = "\"" + command.program.u8string() + "\"";
    for (const Text& argument : command.arguments)
        line += " \"" + argument + "\""; // none of them has a quotation mark or ends in a backslash
    const Process process(Wide(line), root / "output", root / "errors");
    // FolderUpgradeRun has to do without a person.
    const bool isClosing = command.program.stem() != "FolderUpgradeRun";
    Text boxes;
    Text last;
    const DWORD limit = command.killAfter > 0 ? static_cast<DWORD>(command.killAfter) : TimeLimit;
    const DWORD step = std::min<DWORD>(limit, 50);
    for (DWORD waited = 0; waited < limit && !process.EndsWithin(step); waited += step)
    {
        const Text text = ReadFile(log);
        if (isClosing && process.CloseBox() && last != text) // a box may need a moment to close
            boxes += "A message box, with the run log\n" + (last = text);
    }
    return {process.Status(), ReadFile(root / "output"), boxes};
}

bool IsSymbolicLink(const fs::path& path)
{
    return IsLink(path.wstring());
}

void MakeLink(const fs::path& target, const fs::path& link)
{
    const Text both = "\"" + link.u8string() + "\" \"" + target.u8string() + "\"";
    if (IsWine())
        RunUnix("ln -s" + UnixPath(target) + UnixPath(link));
    else if (fs::is_directory(target))
        RunSystem("cmd /c mklink /J " + both);
    else
        RunSystem("cmd /c mklink " + both);
}

void MakeFifo(const fs::path& /*path*/)
{
    throw std::logic_error("Windows has no FIFOs among files");
}

void RemoveTree(const fs::path& path)
{
    for (const fs::path& refused : std::exchange(RefusedPaths(), {}))
        IsWine() ? RunUnix("chmod u+rwx" + UnixPath(refused))
                 : RunSystem("icacls \"" + refused.u8string() + "\" /reset");
    const DWORD attributes = GetFileAttributesW(path.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return;
    SetFileAttributesW(path.c_str(), FILE_ATTRIBUTE_NORMAL);
    const bool isDirectory = (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
    if (isDirectory && !IsSymbolicLink(path))
    {
        for (const auto& entry : fs::directory_iterator(path))
            RemoveTree(entry.path());
    }
    for (int i = 0; !(isDirectory ? RemoveDirectoryW(path.c_str()) : DeleteFileW(path.c_str()));
         ++i)
    {
        if (IsWine()) // which neither removes a link to a directory nor shows a dangling one
            return RunUnix("rm -rf" + UnixPath(path));
        if (i == 100)
            throw std::runtime_error("cannot remove " + path.u8string());
        Sleep(100); // a scanner may have it open for a moment
    }
}

void GiveAway(const std::vector<fs::path>& /*folders*/)
{
}

void Refuse(const fs::path& path, char letter)
{
    static const Files rights = {{"X", "(WD,AD,WEA,WA,DC,DE)"},
                                 {"L", "(RD)"},
                                 {"0", "(OI)(CI)(RD,REA,RA,X,WD,AD,WEA,WA,DC,DE)"}};
    if (IsWine()) // where an access control list refuses nobody
        RunUnix((letter == 'X' ? "chmod a-w" : "chmod 0") + UnixPath(path));
    else
        RunSystem("icacls \"" + path.u8string() +
                  "\" /deny *S-1-1-0:" + rights.at(Text(1, letter)));
    RefusedPaths().push_back(path);
}

std::shared_ptr<void> UseAlone(const fs::path& path)
{
    const HANDLE handle =
        CreateFileW(path.c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr);
    if (handle == INVALID_HANDLE_VALUE)
        throw std::runtime_error("cannot open " + path.u8string());
    return std::shared_ptr<void>(handle, CloseHandle);
}
