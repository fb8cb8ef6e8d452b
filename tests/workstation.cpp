#include "tests/workstation.h"

#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <array>
#include <cctype>
#include <cstdlib>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

const Text Link = "{link:";
const Text Fifo = "{fifo}";
const Text PrivateDir = "[_ORX_HotFolder_]";
// The application data folders also hold what is not the scenarios'.
const auto Tops = {"hot",
                   "default",
                   "previous",
                   "elsewhere",
                   "tool",
                   "user/ORX",
                   "user/ORX_Installers",
                   "machine/hotfolder",
                   "user/registry",
                   "machine/registry"};
const auto Attributes = {std::pair('R', FILE_ATTRIBUTE_READONLY),
                         {'H', FILE_ATTRIBUTE_HIDDEN},
                         {'S', FILE_ATTRIBUTE_SYSTEM}};

// The limits of a run, as the beginning of its command. A program with sanitizers needs more.
const Text& Limits()
{
    static const Text program = ReadFile(ProgramDir() / "FolderUpgrade");
    static const Text limits = program.find("__asan_init") == Text::npos
                                   ? "ulimit -v 700000; exec timeout 10 "
                                   : "exec timeout 120 ";
    return limits;
}

Text Repeated(int count, const Text& text)
{
    Text result;
    for (int i = 0; i < count; ++i)
    {
        result += text;
        const size_t number = text.find('#');
        if (number != Text::npos)
            result.replace(result.size() - text.size() + number, 1,
                           std::to_string(1000000 + i).substr(1));
    }
    return result;
}

} // namespace

Workstation::Workstation(bool asOtherUser) : m_asOtherUser(asOtherUser && geteuid() == 0)
{
    Text pattern = (fs::temp_directory_path() / "work station XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("no temporary folder");
    m_root = pattern;
    fs::permissions(m_root, fs::perms(0755));
    m_dirs = {{"hot", m_root / "Hot Folders"},
              {"user", m_root / "user data"},
              {"machine", m_root / "machine data"},
              {"tool", m_root / "Tool Größe"},
              {"default", m_root / "Apps ä" / "template"},
              {"previous", m_root / "Vorige 版"},
              {"elsewhere", m_root / "elsewhere"}};
    if (IsWindowsProgram())
    {
        m_wine = std::make_unique<Wine>(m_asOtherUser, m_root);
        m_dirs["user"] = m_wine->UserDataDir();
        m_dirs["machine"] = m_wine->MachineDataDir();
    }
    const Text separator = m_wine ? "\\" : "/";
    const Text root = (m_wine ? "H:" : m_root.string()) + separator;
    m_tokens = {{"{hot}", root + "Hot Folders"},
                {"{tool}", root + "Tool Größe"},
                {"{app}", root + "Apps ä"},
                {"{default}", root + "Apps ä" + separator + "template"},
                {"{previous}", root + "Vorige 版"},
                {"{machine}", m_wine ? "C:\\ProgramData" : m_dirs["machine"].string()},
                {"{user}", m_wine ? m_wine->UserDataPath() : m_dirs["user"].string()},
                {"{/}", separator}};
    for (const auto& [token, value] : Files(m_tokens))
    {
        Text capitals = token == "{/}" ? "{/2}" : token;
        std::transform(capitals.begin(), capitals.end(), capitals.begin(), ::toupper);
        m_tokens[capitals] = Replaced(value, "\\", "\\\\");
    }
    const fs::path icons = ProgramDir() / "BundleIcons";
    fs::copy(icons, m_dirs["tool"]);
    fs::copy(icons, m_dirs["tool"] / "BundleIcons");
    for (const char* program :
         {"FolderUpgrade", "FolderUpgradeCheck", "FolderUpgradeRun", "FolderUpgradeRecorded"})
    {
        const fs::path file = ProgramDir() / (program + Text(m_wine ? ".exe" : ""));
        if (fs::exists(file))
            fs::copy(file, m_dirs["tool"]);
    }
}

Workstation::~Workstation()
{
    std::error_code ignored;
    fs::remove_all(m_root, ignored);
}

fs::path Workstation::HostPath(const Text& place) const
{
    const size_t end = std::min(place.find('/'), place.size());
    const Text rest = Replaced(place.substr(end), "[P]", PrivateDir);
    return m_dirs.at(place.substr(0, end)).string() +
           rest.substr(0, rest.find_last_not_of('/') + 1);
}

Text Workstation::Expand(Text text) const
{
    for (const auto& [token, value] : m_tokens)
        text = Replaced(text, token, value);
    const Text times = "{times:";
    for (size_t at = text.find(times); at != Text::npos; at = text.find(times, at))
    {
        const size_t colon = text.find(':', at + times.size());
        const size_t end = text.find('}', colon);
        const int count = std::stoi(text.substr(at + times.size(), colon));
        text.replace(at, end + 1 - at, Repeated(count, text.substr(colon + 1, end - colon - 1)));
    }
    if (StartsWith(text, "{utf16}"))
        return ToUtf16(text.substr(7));
    if (StartsWith(text, "{icon:"))
        return ReadFile(ProgramDir() / text.substr(6, text.size() - 7));
    return text;
}

void Workstation::SetAttributes(const Text& place, const Text& letters) const
{
    const fs::path path = HostPath(place);
    const auto has = [&](char letter)
    {
        return letters.find(letter) != Text::npos;
    };
    DWORD attributes = 0;
    for (const auto& [letter, attribute] : Attributes)
        attributes |= has(letter) ? attribute : 0;
    if ((attributes != 0 &&
         SetFileAttributesW(wxString::FromUTF8(path.string()).wc_str(), attributes) == 0) ||
        (has('X') && chown(path.c_str(), 0, 0) != 0))
        throw std::runtime_error("cannot set " + letters + " of " + place);
    if (has('0') || has('L'))
        fs::permissions(path, has('0') ? fs::perms::none : fs::perms::owner_exec);
}

void Workstation::Put(const Text& place, const Text& text) const
{
    const fs::path path = HostPath(place);
    fs::create_directories(path.parent_path());
    if (StartsWith(text, Link))
    {
        const Text target = Expand(text.substr(Link.size(), text.rfind('}') - Link.size()));
        fs::create_symlink(target[0] == '/' ? fs::path(target) : HostPath(target), path);
    }
    else if (place.back() == '/')
        fs::create_directories(path);
    else if (text != Fifo)
        WriteFile(path, Expand(text));
    else if (mkfifo(path.c_str(), 0644) != 0)
        throw std::runtime_error("no FIFO at " + place);
}

void Workstation::LayOut(const Files& files)
{
    for (const Text top : Tops)
    {
        if (top != "tool")
            fs::remove_all(HostPath(top));
    }
    for (const auto& [place, text] : files)
    {
        if (place.back() != '#')
            Put(place, text);
    }
    if (m_asOtherUser)
    {
        Text command = "chown -Rh nobody:nogroup " + Quoted(m_root);
        for (const Text top : Tops)
            command += fs::exists(HostPath(top)) ? Quoted(HostPath(top)) : "";
        if (std::system(command.c_str()) != 0)
            throw std::runtime_error("cannot give files away");
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

RunResult Workstation::Start(const Text& program, const std::vector<Text>& arguments,
                             const Files& environment) const
{
    Text command =
        m_asOtherUser ? "setpriv --reuid=nobody --regid=nogroup --clear-groups env " : "env ";
    for (const auto& [name, value] : environment)
        command += name + "=" + Quoted(value);
    if (m_wine)
        command += m_wine->Command() + Quoted(Expand("{tool}{/}") + program + ".exe");
    else
        command += "LC_ALL=C XDG_CONFIG_HOME=" + Quoted(m_dirs.at("user")) +
                   "XDG_CONFIG_DIRS=" + Quoted(m_dirs.at("machine").string() + ":/nowhere") +
                   Quoted(m_dirs.at("tool") / program);
    for (const Text& argument : arguments)
        command += Quoted(argument);
    const fs::path output = m_root / "output";
    const fs::path errors = m_root / "errors";
    command += ">" + Quoted(output) + "2>" + Quoted(errors);
    Text boxes;
    const int status = m_wine ? m_wine->Run(command, HostPath(LogPlace), boxes)
                              : std::system((Limits() + command).c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status), ReadFile(output),
            m_wine ? boxes : ReadFile(errors)};
}

Files Workstation::Snapshot() const
{
    Files files;
    const auto add = [&](const Text& place, const fs::directory_entry& entry)
    {
        const fs::path& path = entry.path();
        const Text end = entry.is_directory() ? "/" : "";
        if (entry.is_symlink())
        {
            files[place + end] = Link + fs::read_symlink(path).string() + "}";
            return;
        }
        const DWORD attributes = GetFileAttributesW(wxString::FromUTF8(path.string()).wc_str());
        for (const auto& [letter, attribute] : Attributes)
        {
            if ((attributes & attribute) != 0)
                files[place + "#"] += letter;
        }
        const bool isProgram = StartsWith(place, "tool/FolderUpgrade");
        files[place + end] = entry.is_fifo()                     ? Fifo
                             : entry.is_directory() || isProgram ? ""
                                                                 : ReadFile(path);
    };
    for (const Text top : Tops)
    {
        const fs::directory_entry directory(HostPath(top));
        if (!directory.exists())
            continue;
        add(top, directory);
        if (directory.is_symlink())
            continue;
        for (const auto& entry : fs::recursive_directory_iterator(directory.path()))
        {
            const Text rest = entry.path().lexically_relative(directory.path()).string();
            if (top != Text("tool") || !StartsWith(rest, "FolderUpgrade"))
                add(top + "/" + Replaced(rest, PrivateDir, "[P]"), entry);
        }
    }
    return files;
}
