#include "tests/workstation.h"

#include "tests/text_files.h"
#include "tests/wine.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cstdlib>
#include <sstream>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

const char* const AttributeName = "user.DOSATTRIB";
const std::string Link = "{link:";
const std::string Fifo = "{fifo}";

// The attribute letters of a file or directory, and its mode if requested.
std::string Attributes(const fs::path& path, bool withMode)
{
    struct stat status = {};
    stat(path.c_str(), &status);
    std::array<char, 16> text{};
    getxattr(path.c_str(), AttributeName, text.data(), text.size() - 1);
    const unsigned long stored = std::strtoul(text.data(), nullptr, 16);
    const bool isReadOnly =
        S_ISDIR(status.st_mode) ? (stored & 1) != 0 : (status.st_mode & 0222) == 0;
    std::ostringstream attributes;
    attributes << (isReadOnly ? "R" : "") << ((stored & 2) != 0 ? "H" : "")
               << ((stored & 4) != 0 ? "S" : "");
    if (withMode)
        attributes << " mode " << std::oct << (status.st_mode & 07777U);
    return attributes.str();
}

// Whether a path in an application data folder, which other programs also use, belongs to a
// scenario.
bool IsOurs(const std::string& path)
{
    const std::string top = path.substr(0, path.find('/'));
    return top == "ORX" || top == "ORX_Installers" || top == "hotfolder" || top == "registry";
}

std::string ProgramFile(const std::string& program)
{
    return IsWindowsProgram() ? program + ".exe" : program;
}

void GiveAway(const fs::path& path)
{
    if (lchown(path.c_str(), OtherUser, OtherUser) != 0 && fs::exists(path))
        throw std::runtime_error("only root can give files away");
}

std::string Repeat(const std::string& text)
{
    const std::string start = "{repeat:";
    std::string result;
    size_t done = 0;
    for (size_t at = text.find(start); at != std::string::npos; at = text.find(start, done))
    {
        result.append(text, done, at - done);
        const size_t colon = text.find(':', at + start.size());
        done = text.find('}', colon) + 1;
        std::string piece = text.substr(colon + 1, done - colon - 2);
        const size_t number = piece.find('#');
        const int count = std::stoi(text.substr(at + start.size()));
        for (int i = 0; i < count; ++i)
        {
            if (number != std::string::npos)
                piece.replace(number, i == 0 ? 1 : 6, std::to_string(1000000 + i).substr(1));
            result += piece;
        }
    }
    return result.append(text, done);
}

} // namespace

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
                  {"tool", m_root / "Tool Größe"},
                  {"elsewhere", m_root / "elsewhere"}};
    if (IsWindowsProgram())
    {
        m_wine = std::make_unique<Wine>(asOtherUser, m_root);
        m_hostDirs["user"] = m_wine->UserDataDir();
        m_hostDirs["machine"] = m_wine->MachineDataDir();
    }
    const std::string separator = IsWindowsProgram() ? "\\" : "/";
    const std::string root = (IsWindowsProgram() ? "H:" : m_root.string()) + separator;
    m_tokens = {
        {"{hot}", root + "Hot Folders"},
        {"{tool}", root + "Tool Größe"},
        {"{app}", root + "Apps ä"},
        {"{previous}", root + "Vorige 版"},
        {"{user}", IsWindowsProgram() ? m_wine->UserDataPath() : m_hostDirs["user"].string()},
        {"{/}", separator}};
    m_tokens["{default}"] = m_tokens["{app}"] + separator + "template";
    // In capitals, in the form of the registry editor's text.
    for (const auto& [token, value] : Files(m_tokens))
    {
        std::string capitals = token == "{/}" ? "{/2}" : token;
        std::transform(capitals.begin(), capitals.end(), capitals.begin(), ::toupper);
        ReplaceAll(m_tokens[capitals] = value, "\\", "\\\\");
    }

    const fs::path built = TOOL_DIR;
    const fs::path programs = IsWindowsProgram() ? WindowsProgram().parent_path() : built;
    fs::create_directories(m_hostDirs["tool"]);
    fs::create_directories(m_root / "Vorige 版");
    for (const char* program : {"FolderUpgrade", "FolderUpgradeCheck"})
        fs::copy(programs / ProgramFile(program), m_hostDirs["tool"]);
    fs::copy(built / "BundleIcons", m_hostDirs["tool"] / "BundleIcons");
    for (const auto& icon : fs::directory_iterator(built / "BundleIcons"))
        fs::copy(icon, m_hostDirs["tool"]);
}

Workstation::~Workstation()
{
    std::error_code ignored;
    fs::remove_all(m_root, ignored);
}

fs::path Workstation::HostPath(const std::string& place) const
{
    const size_t slash = place.find('/');
    const auto top = m_hostDirs.find(place.substr(0, slash));
    if (slash == std::string::npos || slash + 1 == place.size() || top == m_hostDirs.end())
        throw std::runtime_error("\"" + place + "\" is not a place on the workstation");
    std::string rest = place.substr(slash + 1);
    ReplaceAll(rest, "[P]", "[_ORX_HotFolder_]");
    return top->second / rest;
}

// The place of a path, or the path itself if it has none.
std::string Workstation::PlaceOf(const fs::path& path) const
{
    for (const auto& [name, directory] : m_hostDirs)
    {
        if (!StartsWith(path.string(), directory.string() + "/"))
            continue;
        std::string place = name + path.string().substr(directory.string().size());
        ReplaceAll(place, "[_ORX_HotFolder_]", "[P]");
        return place;
    }
    return path.string();
}

std::string Workstation::Expand(std::string text) const
{
    for (const auto& [token, value] : m_tokens)
        ReplaceAll(text, token, value);
    const std::string utf16 = "{utf16}";
    if (StartsWith(text, utf16))
        return ToUtf16(text.substr(utf16.size()));
    const size_t icon = text.find("{icon:");
    if (icon != std::string::npos)
        return ReadFile(fs::path(TOOL_DIR) / (text.substr(icon + 6, text.find('}') - icon - 6)));
    return Repeat(text);
}

void Workstation::SetAttributes(const std::string& place, const std::string& letters) const
{
    const fs::path path = HostPath(place);
    const bool isDirectory = fs::is_directory(path);
    const auto has = [&](char letter)
    {
        return letters.find(letter) != std::string::npos;
    };
    const unsigned stored =
        (has('H') ? 2U : 0U) | (has('S') ? 4U : 0U) | (has('R') && isDirectory ? 1U : 0U);
    const std::string text = "0x" + std::to_string(stored);
    if (stored != 0 && setxattr(path.c_str(), AttributeName, text.data(), text.size(), 0) != 0)
        throw std::runtime_error("no extended attributes in " + m_root.string());
    if (has('X') && chown(path.c_str(), 0, 0) != 0)
        throw std::runtime_error("only root can give files away");
    if (has('R') && !isDirectory)
        fs::permissions(path, fs::perms(0444));
    if (has('0') || has('L'))
        fs::permissions(path, has('0') ? fs::perms::none : fs::perms::owner_exec);
}

template <typename Visit>
void Workstation::ForEachEntry(Visit visit) const
{
    for (const auto& [name, directory] : m_hostDirs)
    {
        if (!fs::exists(directory))
            continue;
        const bool isShared = name == "user" || name == "machine";
        for (const auto& entry : fs::recursive_directory_iterator(directory))
        {
            if (!isShared || IsOurs(entry.path().lexically_relative(directory).string()))
                visit(PlaceOf(entry.path()), entry);
        }
    }
}

void Workstation::Put(const std::string& place, const std::string& text) const
{
    const bool isDirectory = place.back() == '/';
    const fs::path path = HostPath(isDirectory ? place.substr(0, place.size() - 1) : place);
    fs::create_directories(path.parent_path());
    if (StartsWith(text, Link))
    {
        const std::string target = Expand(text.substr(Link.size(), text.rfind('}') - Link.size()));
        fs::create_symlink(target[0] == '/' ? fs::path(target) : HostPath(target), path);
    }
    else if (isDirectory)
        fs::create_directories(path);
    else if (text != Fifo)
        WriteFile(path, Expand(text));
    else if (mkfifo(path.c_str(), 0644) != 0)
        throw std::runtime_error("no FIFO at " + place);
}

void Workstation::LayOut(const Files& files)
{
    for (const auto& [place, text] : files)
    {
        if (place.back() != '#')
            Put(place, text);
    }
    if (geteuid() == 0 && m_asOtherUser)
    {
        for (const auto& [name, directory] : m_hostDirs)
            GiveAway(directory);
        ForEachEntry([](const std::string&, const fs::directory_entry& entry)
                     { GiveAway(entry.path()); });
    }
    Files hives = files;
    if (m_wine)
        m_wine->ImportHives(Expand(hives[MachineHive]), Expand(hives[UserHive]));
    for (const auto& [place, text] : files)
    {
        if (place.back() == '#')
            SetAttributes(place.substr(0, place.size() - 1), text);
    }
}

RunResult Workstation::Start(const std::vector<std::string>& arguments, const std::string& program)
{
    RunResult run;
    const fs::path output = m_root / "output";
    std::vector<std::string> commandLine = {
        (m_wine ? m_tokens["{tool}"] + "\\" : m_hostDirs["tool"].string() + "/") +
        ProgramFile(program)};
    commandLine.insert(commandLine.end(), arguments.begin(), arguments.end());
    if (m_wine)
    {
        std::vector<std::string> boxes;
        run.process = m_wine->Start(commandLine, output, HostPath(LogPlace), boxes);
        for (const std::string& logAtBox : boxes)
            run.libraryLog += "A message box, with the run log\n" + logAtBox;
    }
    else
    {
        const fs::path errors = m_root / "errors";
        run.process =
            RunToTheEnd({commandLine,
                         {{"XDG_CONFIG_HOME", m_hostDirs["user"].string()},
                          {"XDG_CONFIG_DIRS", m_hostDirs["machine"].string() + ":/nowhere"},
                          {"LC_ALL", "C"}},
                         m_asOtherUser,
                         output,
                         errors});
        run.libraryLog = ReadFile(errors);
    }
    run.output = ReadFile(output);
    return run;
}

Files Workstation::Snapshot() const
{
    Files files;
    ForEachEntry(
        [&](const std::string& place, const fs::directory_entry& entry)
        {
            const fs::path& path = entry.path();
            const std::string end = entry.is_directory() ? "/" : "";
            if (entry.is_symlink())
            {
                files[place + end] = Link + PlaceOf(fs::read_symlink(path)) + "}";
                return;
            }
            const std::string attributes = Attributes(path, StartsWith(place, "elsewhere/"));
            if (!attributes.empty())
                files[place + "#"] = attributes;
            if (entry.is_fifo())
                files[place] = Fifo;
            else if (entry.is_directory() || access(path.c_str(), R_OK) != 0)
                files[place + end];
            else
                files[place] = ReadFile(path);
        });
    return files;
}
