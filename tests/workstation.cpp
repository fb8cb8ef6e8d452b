#include "tests/workstation.h"

#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <cctype>
#include <functional>
#include <stdexcept>

namespace fs = std::filesystem;

namespace
{

const Text Link = "{link:";
const Text Fifo = "{fifo}";
const Text PrivateDir = "[_ORX_HotFolder_]";
// The application data folders also hold what is not the scenarios'. Links lead elsewhere, so that
// comes last.
std::vector<Text> Tops()
{
    std::vector<Text> tops = {"hot",
                              "default",
                              "previous",
                              "machine/hotfolder",
                              "tool",
                              "user/ORX",
                              "user/ORX_Installers",
                              "elsewhere"};
    if (!IsWindows) // where hives are files
        tops.insert(tops.end(), {"machine/registry", "user/registry"});
    return tops;
}

const auto Attributes = {std::pair('R', FILE_ATTRIBUTE_READONLY),
                         {'H', FILE_ATTRIBUTE_HIDDEN},
                         {'S', FILE_ATTRIBUTE_SYSTEM}};

// path::wstring depends on the locale.
wxString WideName(const fs::path& path)
{
    return wxString::FromUTF8(path.u8string());
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

Workstation::Workstation(bool asOtherUser) : m_asOtherUser(asOtherUser), m_root(NewRoot())
{
    m_dirs = {{"hot", m_root / "Hot Folders"},
              {"user", UserDataDir(m_root)},
              {"machine", MachineDataDir(m_root)},
              {"tool", m_root / fs::u8path("Tool Größe")},
              {"default", m_root / fs::u8path("Apps ä") / "template"},
              {"previous", m_root / fs::u8path("Vorige 版")},
              {"elsewhere", m_root / "elsewhere"}};
    for (const auto& [name, folder] : m_dirs)
        m_tokens["{" + name + "}"] = folder.u8string();
    m_tokens["{app}"] = m_dirs["default"].parent_path().u8string();
    m_tokens["{/}"] = Separator;
    for (const auto& [token, value] : Files(m_tokens))
    {
        Text capitals = token == "{/}" ? "{/2}" : token;
        std::transform(capitals.begin(), capitals.end(), capitals.begin(), ::toupper);
        m_tokens[capitals] = Replaced(value, "\\", "\\\\");
    }
    fs::create_directories(m_dirs["tool"] / "BundleIcons");
    for (const auto& icon : fs::directory_iterator(ProgramDir() / "BundleIcons"))
    {
        for (const char* folder : {"", "BundleIcons"})
            fs::copy_file(icon.path(), m_dirs["tool"] / folder / icon.path().filename());
    }
    for (const Text name :
         {"FolderUpgrade", "FolderUpgradeCheck", "FolderUpgradeRun", "FolderUpgradeRecorded"})
    {
        const fs::path program = name + ProgramSuffix;
        if (fs::exists(ProgramDir() / program))
            fs::copy_file(ProgramDir() / program, m_dirs["tool"] / program);
    }
}

Workstation::~Workstation()
{
    for (const Text& top : Tops())
        RemoveTree(HostPath(top));
    RemoveTree(m_root);
}

fs::path Workstation::HostPath(const Text& place) const
{
    const size_t end = std::min(place.find('/'), place.size());
    const Text rest = Replaced(place.substr(end), "[P]", PrivateDir);
    return fs::u8path(m_dirs.at(place.substr(0, end)).u8string() +
                      rest.substr(0, rest.find_last_not_of('/') + 1))
        .make_preferred();
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
        return ReadFile(ProgramDir() / "BundleIcons" / text.substr(6, text.size() - 7));
    return text;
}

void Workstation::SetAttributes(const Text& place, const Text& letters)
{
    const fs::path path = HostPath(place);
    const auto has = [&](char letter)
    {
        return letters.find(letter) != Text::npos;
    };
    DWORD attributes = 0;
    for (const auto& [letter, attribute] : Attributes)
        attributes |= has(letter) ? attribute : 0;
    // Wine cannot set the others on a file that is read-only already.
    for (const DWORD each : {attributes & ~FILE_ATTRIBUTE_READONLY, attributes})
    {
        if (each != 0 && SetFileAttributesW(WideName(path).wc_str(), each) == 0)
            throw std::runtime_error("cannot set " + letters + " of " + place);
    }
    for (const char letter : {'X', '0', 'L'})
    {
        if (has(letter) && IsWindows && letter == '0' && fs::is_regular_file(path))
            m_inUse.push_back(path);
        else if (has(letter))
            Refuse(path, letter);
    }
}

void Workstation::Put(const Text& place, const Text& text) const
{
    const fs::path path = HostPath(place);
    fs::create_directories(path.parent_path());
    if (StartsWith(text, Link))
    {
        const fs::path target = HostPath(text.substr(Link.size(), text.size() - Link.size() - 1));
        if (place.back() == '/')
            fs::create_directories(target);
        MakeLink(target, path);
    }
    else if (place.back() == '/')
        fs::create_directories(path);
    else if (text == Fifo)
        MakeFifo(path);
    else
        WriteFile(path, Expand(text));
}

void Workstation::LayOut(const Files& files)
{
    m_inUse.clear();
    std::vector<fs::path> folders = {m_root};
    for (const Text& top : Tops())
    {
        folders.push_back(HostPath(top));
        if (top != "tool")
            RemoveTree(folders.back());
    }
    std::vector<Text> hives;
    for (const auto& [place, text] : files)
    {
        const bool isHive = place == MachineHive || place == UserHive;
        if (isHive)
            hives.push_back(Expand(text));
        if (place.back() != '#' && !(IsWindows && isHive))
            Put(place, text);
    }
    if (m_asOtherUser)
        GiveAway(folders);
    SetRegistry(hives);
    // In this order, files come before their directory, which may not be accessible afterwards.
    for (auto file = files.rbegin(); file != files.rend(); ++file)
    {
        if (file->first.back() == '#')
            SetAttributes(file->first.substr(0, file->first.size() - 1), file->second);
    }
}

RunResult Workstation::Start(const Text& program, const std::vector<Text>& arguments,
                             const Files& environment, int killAfter) const
{
    std::vector<std::shared_ptr<void>> inUse;
    for (const fs::path& path : m_inUse)
        inUse.push_back(UseAlone(path));
    return RunToEnd({m_dirs.at("tool") / (program + ProgramSuffix), arguments, environment,
                     m_asOtherUser, killAfter},
                    m_root, HostPath(LogPlace));
}

Files Workstation::Snapshot() const
{
    Files files;
    const std::function<void(const Text&, const fs::path&)> add =
        [&](const Text& place, const fs::path& path)
    {
        const bool isDirectory = fs::is_directory(path);
        Text& text = files[place + (isDirectory ? "/" : "")];
        if (IsSymbolicLink(path))
        {
            text = Link;
            return;
        }
        DWORD attributes = GetFileAttributesW(WideName(path).wc_str());
        if (IsWine() && isDirectory) // where it says whether it can be written to
            attributes &= ~FILE_ATTRIBUTE_READONLY;
        for (const auto& [letter, attribute] : Attributes)
        {
            if ((attributes & attribute) != 0)
                files[place + "#"] += letter;
        }
        if (!isDirectory)
            text = fs::is_fifo(path) ? Fifo : ReadFile(path);
        std::error_code ignored; // of a directory that cannot be listed, or a file
        for (const auto& entry : fs::directory_iterator(path, ignored))
        {
            const Text name = entry.path().filename().u8string();
            if (place != "tool" || !StartsWith(name, "FolderUpgrade"))
                add(place + "/" + (name == PrivateDir ? "[P]" : name), entry.path());
        }
    };
    for (const Text& top : Tops())
    {
        if (fs::exists(HostPath(top)))
            add(top, HostPath(top));
    }
    return files;
}
