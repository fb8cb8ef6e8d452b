#include "tests/workstation.h"

#include "tests/process.h"
#include "tests/text_files.h"
#include "tests/wine.h"

#include <array>
#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/wait.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

const char* const AttributeName = "user.DOSATTRIB";

std::string WithDoubled(const std::string& text, char character)
{
    std::string result;
    for (const char each : text)
        result += std::string(each == character ? 2 : 1, each);
    return result;
}

unsigned long StoredAttributes(const fs::path& path)
{
    std::array<char, 16> text{};
    getxattr(path.c_str(), AttributeName, text.data(), text.size() - 1);
    return std::strtoul(text.data(), nullptr, 16);
}

std::string Letters(const fs::path& path)
{
    struct stat status = {};
    stat(path.c_str(), &status);
    const unsigned long stored = StoredAttributes(path);
    const bool isDirectory = S_ISDIR(status.st_mode);
    const bool isReadOnly = isDirectory ? (stored & 1) != 0 : (status.st_mode & 0222) == 0;
    return std::string(isReadOnly ? "R" : "") + ((stored & 2) != 0 ? "H" : "") + ((stored & 4) != 0 ? "S" : "");
}

// Whether a path in an application data folder, which others use too, belongs to a scenario.
bool IsOurs(const std::string& path)
{
    const std::string top = path.substr(0, path.find('/'));
    return top == "ORX" || top == "ORX_Installers" || top == "hotfolder" || top == "registry";
}

void GiveAway(const fs::path& path)
{
    if (lchown(path.c_str(), OtherUser, OtherUser) != 0 && fs::exists(path))
        throw std::runtime_error("only root can give files away");
}

std::string ExpandedAt(const Workstation& workstation, const Files& files, const char* place)
{
    const auto found = files.find(place);
    return found == files.end() ? std::string() : workstation.Expand(found->second);
}

} // namespace

const char* const LogPlace = "user/ORX_Installers/UpgradeDowngrade.log";
const char* const MachineHive = "machine/registry/HKEY_LOCAL_MACHINE.reg";
const char* const UserHive = "user/registry/HKEY_CURRENT_USER.reg";

bool IsWindowsProgram()
{
    return !WindowsProgram().empty();
}

Workstation::Workstation(bool asOtherUser) : m_asOtherUser(asOtherUser)
{
    std::string pattern = (fs::temp_directory_path() / "work station XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("no temporary folder");
    m_root = pattern;
    fs::permissions(m_root, fs::perms(0755));
    m_hostDirs = {{"hot", m_root / "Hot Folders"},
                  {"user", m_root / "user data"},
                  {"machine", m_root / "machine data"},
                  {"tool", m_root / "Tool Größe"}};
    if (IsWindowsProgram())
    {
        m_wine = std::make_unique<Wine>(asOtherUser, m_root);
        m_hostDirs["user"] = m_wine->UserDataDir();
        m_hostDirs["machine"] = m_wine->MachineDataDir();
    }
    const std::string separator = IsWindowsProgram() ? "\\" : "/";
    const std::string root = (IsWindowsProgram() ? "H:" : m_root.string()) + separator;
    m_tokens = {{"{hot}", root + "Hot Folders"},
                {"{tool}", root + "Tool Größe"},
                {"{app}", root + "Apps ä"},
                {"{previous}", root + "Vorige 版"},
                {"{user}", IsWindowsProgram() ? m_wine->UserDataPath() : m_hostDirs["user"].string()},
                {"{/}", separator}};
    m_tokens["{default}"] = m_tokens["{app}"] + separator + "template";
    // In capitals as the registry editor's text has them.
    for (const auto& [token, value] : Files(m_tokens))
    {
        std::string capitals = token;
        for (char& character : capitals)
            character = static_cast<char>(std::toupper(static_cast<unsigned char>(character)));
        m_tokens[token == "{/}" ? "{/2}" : capitals] = WithDoubled(value, '\\');
    }

    const fs::path built = TOOL_DIR;
    fs::create_directories(m_hostDirs["tool"]);
    fs::create_directories(m_root / "Vorige 版");
    fs::copy(IsWindowsProgram() ? WindowsProgram() : built / "FolderUpgrade", m_hostDirs["tool"]);
    fs::copy(built / "BundleIcons", m_hostDirs["tool"] / "BundleIcons");
    for (const auto& icon : fs::directory_iterator(built / "BundleIcons"))
        fs::copy(icon, m_hostDirs["tool"]);
}

Workstation::~Workstation()
{
    std::error_code ignored;
    for (auto entry = fs::recursive_directory_iterator(m_root, ignored); entry != fs::recursive_directory_iterator();
         entry.increment(ignored))
    {
        if (entry->is_directory(ignored))
            fs::permissions(entry->path(), fs::perms::owner_all, fs::perm_options::add, ignored);
    }
    fs::remove_all(m_root, ignored);
}

fs::path Workstation::HostPath(const std::string& place) const
{
    const size_t slash = place.find('/');
    std::string rest = place.substr(slash + 1);
    ReplaceAll(rest, "[P]", "[_ORX_HotFolder_]");
    return m_hostDirs.at(place.substr(0, slash)) / rest;
}

std::string Workstation::Expand(std::string text) const
{
    for (const auto& [token, value] : m_tokens)
        ReplaceAll(text, token, value);
    const std::string utf16 = "{utf16}";
    if (text.compare(0, utf16.size(), utf16) == 0)
        return ToUtf16(text.substr(utf16.size()));
    const size_t icon = text.find("{icon:");
    if (icon != std::string::npos)
        return ReadFile(fs::path(TOOL_DIR) / (text.substr(icon + 6, text.find('}') - icon - 6)));
    return text;
}

void Workstation::SetAttributes(const std::string& place, const std::string& letters) const
{
    const fs::path path = HostPath(place);
    const bool isDirectory = fs::is_directory(path);
    const auto has = [&](char letter)
    {
        return letters.find(letter) != std::string::npos;
    };
    const unsigned stored = (has('H') ? 2U : 0U) | (has('S') ? 4U : 0U) | (has('R') && isDirectory ? 1U : 0U);
    const std::string text = "0x" + std::to_string(stored);
    if (stored != 0 && setxattr(path.c_str(), AttributeName, text.data(), text.size(), 0) != 0)
        throw std::runtime_error("no extended attributes in " + m_root.string());
    if (has('X') && chown(path.c_str(), 0, 0) != 0)
        throw std::runtime_error("only root can give files away");
    if (has('R') && !isDirectory)
        fs::permissions(path, fs::perms(0444));
    if (has('0'))
        fs::permissions(path, fs::perms::none);
}

template <typename Visit>
void Workstation::ForEachEntry(Visit visit) const
{
    for (const auto& [name, directory] : m_hostDirs)
    {
        if (!fs::exists(directory))
            continue;
        for (const auto& entry : fs::recursive_directory_iterator(directory))
        {
            const std::string path = fs::relative(entry.path(), directory).string();
            std::string place = name + "/" + path;
            ReplaceAll(place, "[_ORX_HotFolder_]", "[P]");
            if (name == "hot" || name == "tool" || IsOurs(path))
                visit(place, entry);
        }
    }
}

void Workstation::LayOut(const Files& files)
{
    for (const auto& [place, text] : files)
    {
        if (place.back() == '/')
            fs::create_directories(HostPath(place));
        else if (place.back() != '#')
            WriteFile(HostPath(place), Expand(text));
    }
    if (geteuid() == 0 && m_asOtherUser)
    {
        for (const auto& [name, directory] : m_hostDirs)
            GiveAway(directory);
        ForEachEntry([](const std::string&, const fs::directory_entry& entry) { GiveAway(entry.path()); });
    }
    if (m_wine)
        m_wine->ImportHives(ExpandedAt(*this, files, MachineHive), ExpandedAt(*this, files, UserHive));
    for (const auto& [place, text] : files)
    {
        if (place.back() == '#')
            SetAttributes(place.substr(0, place.size() - 1), text);
    }
}

RunResult Workstation::Start(const std::vector<std::string>& arguments)
{
    RunResult run;
    if (m_wine)
    {
        std::vector<std::string> commandLine = {m_tokens["{tool}"] + "\\FolderUpgrade.exe"};
        commandLine.insert(commandLine.end(), arguments.begin(), arguments.end());
        std::vector<std::string> boxes;
        run.exitStatus = m_wine->Start(commandLine, HostPath(LogPlace), boxes);
        for (const std::string& logAtBox : boxes)
            run.libraryLog += "A message box, with the run log\n" + logAtBox;
        return run;
    }
    const fs::path errors = m_root / "errors";
    std::vector<std::string> commandLine = {m_hostDirs["tool"] / "FolderUpgrade"};
    commandLine.insert(commandLine.end(), arguments.begin(), arguments.end());
    const pid_t child = fork();
    if (child == 0)
    {
        setenv("XDG_CONFIG_HOME", m_hostDirs["user"].c_str(), 1);
        setenv("XDG_CONFIG_DIRS", (m_hostDirs["machine"].string() + ":/nowhere").c_str(), 1);
        setenv("LC_ALL", "C", 1);
        if (!std::freopen(errors.c_str(), "w", stderr))
            _exit(125);
        Become(commandLine, m_asOtherUser);
    }
    int status = 0;
    waitpid(child, &status, 0);
    run.exitStatus = WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
    run.libraryLog = ReadFile(errors);
    return run;
}

Files Workstation::Snapshot() const
{
    Files files;
    ForEachEntry(
        [&](const std::string& place, const fs::directory_entry& entry)
        {
            const std::string letters = Letters(entry.path());
            if (!letters.empty())
                files[place + "#"] = letters;
            if (entry.is_directory())
                files[place + "/"];
            else
                files[place] = ReadFile(entry.path());
        });
    return files;
}
