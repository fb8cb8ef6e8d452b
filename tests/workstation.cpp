#include "tests/workstation.h"

#include "platform/pinned_directory.h"
#include "platform/system.h"

#include <gtest/gtest.h>
#include <wx/string.h>

#include <algorithm>
#include <cstdlib>

namespace
{

const Text Link = "{link:";
const Text Fifo = "{fifo}";
const Text PrivateDir = "[_ORX_HotFolder_]";
// What scenarios lay out; on Windows, the application data folders also hold what is not theirs.
// Links lead elsewhere, so that comes last.
const auto TopsOnWindows = {
    "hot",      "default", "previous", "machine/hotfolder", "user/ORX", "user/ORX_Installers",
    "elsewhere"};
const auto TopsOnLinux = {"hot", "default", "previous", "machine", "user", "elsewhere"};
const auto& Tops = IsWindows ? TopsOnWindows : TopsOnLinux;

// In the order in which Wine can set them.
const auto Attributes = {std::pair('S', FILE_ATTRIBUTE_SYSTEM),
                         {'N', FILE_ATTRIBUTE_NOT_CONTENT_INDEXED},
                         {'H', FILE_ATTRIBUTE_HIDDEN},
                         {'R', FILE_ATTRIBUTE_READONLY}};

// path::wstring depends on the locale.
wxString WideName(const fs::path& path)
{
    return wxString::FromUTF8(path.u8string());
}

// Adds the file or directory, and everything in it, except for the programs.
void Look(const Text& place, const fs::path& path, Files& files)
{
    const bool isDirectory = fs::is_directory(path);
    Text& text = files[place + (isDirectory ? "/" : "")];
    if (IsLink(WideName(path)))
    {
        text = Link;
        return;
    }
    DWORD attributes = GetFileAttributesW(WideName(path).wc_str());
    if (IsWine() && isDirectory) // where it says whether it can be written to
        attributes &= ~FILE_ATTRIBUTE_READONLY;
    Text letters;
    for (const auto& [letter, attribute] : Attributes)
        letters.insert(0, (attributes & attribute) != 0, letter);
    if (!letters.empty())
        files[place + "#"] = letters;
    if (!isDirectory)
        text = fs::is_fifo(path) ? Fifo : ReadFile(path);
    std::error_code ignored; // of a directory that cannot be listed, or a file
    for (const auto& entry : fs::directory_iterator(path, ignored))
    {
        const Text name = entry.path().filename().u8string();
        if (place != "tool" || !StartsWith(name, "FolderUpgrade"))
            Look(place + "/" + (name == PrivateDir ? "[P]" : name), entry.path(), files);
    }
}

} // namespace

Workstation::Workstation(bool asOtherUser) : m_asOtherUser(asOtherUser), m_root(NewRoot())
{
    m_dirs = {{"hot", m_root / "Hot Folders"},
              {"user", DataDir("user", m_root)},
              {"machine", DataDir("machine", m_root)},
              {"tool", m_root / fs::u8path("Tool Größe")},
              {"app", m_root / fs::u8path("Apps ä")},
              {"default", m_root / fs::u8path("Apps ä") / "template"},
              {"previous", m_root / fs::u8path("Vorige 版")},
              {"elsewhere", m_root / "elsewhere"}};
    for (const char* folder : {"", "BundleIcons"})
        fs::copy(ProgramDir() / "BundleIcons", m_dirs["tool"] / folder);
    for (const Text name : {"", "Check", "Run", "Recorded"})
    {
        const fs::path program = "FolderUpgrade" + name + ProgramSuffix;
        std::error_code ignored; // the last one is not on Windows
        fs::copy_file(ProgramDir() / program, m_dirs["tool"] / program, ignored);
    }
}

Workstation::~Workstation()
{
    try
    {
        LayOut({});
        RemoveTree(m_root);
    }
    catch (const std::exception& error)
    {
        ADD_FAILURE() << error.what();
    }
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
    for (const auto& [name, folder] : m_dirs)
        text = Replaced(text, "{" + name + "}", folder.u8string());
    text = Replaced(text, "{/}", Separator);
    if (StartsWith(text, "{utf16}"))
    {
        const std::u16string units = u"\uFEFF" + fs::u8path(text.substr(7)).u16string();
        return Text(reinterpret_cast<const char*>(units.data()), 2 * units.size());
    }
    if (StartsWith(text, "{icon:"))
        return ReadFile(ProgramDir() / "BundleIcons" / text.substr(6, text.size() - 7));
    return text;
}

void Workstation::SetAttributes(const Text& place, const Text& letters) const
{
    const fs::path path = HostPath(place);
    DWORD attributes = 0;
    for (const auto& [letter, attribute] : Attributes)
    {
        if (letters.find(letter) != Text::npos &&
            SetFileAttributesW(WideName(path).wc_str(), attributes |= attribute) == 0)
            throw std::runtime_error("cannot set " + letters + " of " + place);
    }
    const size_t refused = letters.find_first_of("X0L");
    if (refused != Text::npos)
        Refuse(path, letters[refused]);
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
    else if (text != Fifo)
        WriteFile(path, Expand(text));
    else if (std::system(("mkfifo '" + path.string() + "'").c_str()) != 0)
        throw std::runtime_error("no FIFO at " + place);
}

void Workstation::LayOut(const Files& files)
{
    for (const Text top : Tops)
        RemoveTree(HostPath(top));
    Text hives;
    for (const auto& [place, text] : files)
    {
        if (IsWindows && (place == MachineHive || place == UserHive))
            hives += Expand(text);
        else if (place.back() != '#')
            Put(place, text);
    }
    if constexpr (IsWindows)
        SetRegistry(hives);
    else if (m_asOtherUser)
        GiveAway(m_root);
    // In this order, files come before their directory, which may not be accessible afterwards.
    for (auto file = files.rbegin(); file != files.rend(); ++file)
    {
        if (file->first.back() == '#')
            SetAttributes(file->first.substr(0, file->first.size() - 1), file->second);
    }
}

Files Workstation::Snapshot() const
{
    Files files;
    for (const Text top : Tops)
    {
        if (fs::exists(HostPath(top)))
            Look(top, HostPath(top), files);
    }
    Look("tool", HostPath("tool"), files);
    return files;
}
