#include "migrate/preset_text.h"

#include "platform/memory.h"
#include "platform/path_normal_form.h"
#include "platform/regular_file.h"
#include "platform/unicode_text.h"
#include "store/folder_cfg_format.h"
#include "store/xml_document.h"

#include <wx/convauto.h>
#include <wx/textbuf.h>

#include <new>

namespace
{

const wxString Introduction = wxString(FolderCfg::ImposeTemplateKey) + "\">\"";

// A character as it is and in the new text, wide, and twice in the new bytes.
constexpr std::uint64_t MemoryForEachCharacter = 2 * sizeof(wchar_t) + 2;

bool EndsFolder(const wxString& text, size_t position)
{
    return position < text.length() &&
           (text[position] == '"' || wxFileName::IsPathSeparator(text[position]));
}

// The positions of the folder in the template paths of the text, in ascending order.
std::vector<size_t> FindFolders(const wxString& text, const wxString& folder)
{
    const wxString searched = Introduction + folder;
    std::vector<size_t> folders;
    for (size_t found = text.find(searched); found != wxString::npos;)
    {
        const size_t begin = found + Introduction.length();
        const size_t end = begin + folder.length();
        const bool isPath = EndsFolder(text, end);
        if (isPath)
            folders.push_back(begin);
        // Continues after the path: if the folder's own text holds the introduction, hits could
        // overlap.
        found = text.find(searched, isPath ? end : begin);
    }
    return folders;
}

// Whether the bytes are empty or only a byte-order mark.
bool IsEmptyText(const std::string& bytes)
{
    size_t markLength = 0;
    const wxBOM mark = wxConvAuto::DetectBOM(bytes.data(), bytes.length());
    if (mark != wxBOM_None && mark != wxBOM_Unknown)
        wxConvAuto::GetBOMChars(mark, &markLength);
    // Two bytes alone may be the beginning of a longer mark, but then there is no text either.
    return bytes.length() == markLength || (mark == wxBOM_Unknown && bytes == "\xFF\xFE");
}

} // namespace

std::optional<size_t> MovePresetPaths(wxString& text, const wxString& oldFolder,
                                      const wxString& newFolder)
{
    const wxString from = WithoutFinalSeparators(oldFolder);
    const wxString to = WithoutFinalSeparators(newFolder);
    if (from.empty() || to.empty() || !IsXmlText(to))
        return 0;
    const std::vector<size_t> folders = FindFolders(text, from);
    if (folders.empty())
        return 0;

    const size_t length =
        text.length() + folders.size() * to.length() - folders.size() * from.length();
    if (length > static_cast<size_t>(LongestFile))
        return {};
    RequireMemory(length * MemoryForEachCharacter);
    // A text that grows piece by piece would be in memory three times at worst.
    wxString moved;
    moved.reserve(length);
    size_t copied = 0; // the number of characters of the text that are in moved
    for (const size_t folder : folders)
    {
        moved.append(text, copied, folder - copied).append(to);
        copied = folder + from.length();
    }
    moved.append(text, copied, wxString::npos);
    text.swap(moved);
    return folders.size();
}

// Decodes the bytes unchanged, then converts line ends as the system's text mode would, if it has
// one. Text mode itself would end the file at the first Ctrl-Z, and find line ends inside UTF-16
// characters.
const wchar_t* DecodePreset(const std::string& bytes, wxString& text)
{
    if (IsEmptyText(bytes))
        return nullptr;
    wxString(bytes.data(), wxConvAuto(), bytes.length()).swap(text); // assigning would copy it
    if (text.empty())
        return L"cannot be decoded";
    if (wxTextBuffer::typeDefault == wxTextFileType_Dos)
        text.Replace("\r\n", "\n");
    return IsUnicodeText(text) ? nullptr : L"cannot be encoded again";
}

wxString MovedPresetPath(const wxString& path, const wxString& from, const wxString& to)
{
    wxString text = Introduction + path + "\"";
    MovePresetPaths(text, from, to);
    return text.Mid(Introduction.length()).BeforeLast('"');
}

std::vector<PresetPath> FindPresetPaths(const wxString& text, const wxString& from,
                                        const wxString& to)
{
    std::vector<PresetPath> paths;
    for (size_t found = text.find(Introduction); found != wxString::npos;)
    {
        const size_t begin = found + Introduction.length();
        const size_t end = text.find('"', begin);
        const wxString stored = text.Mid(begin, end - begin);
        paths.push_back({stored, MovedPresetPath(stored, from, to), end == wxString::npos});
        found = text.find(Introduction, begin);
    }
    return paths;
}

RewrittenPreset RewritePreset(const std::string& before, const wxString& from, const wxString& to)
{
    RewrittenPreset preset;
    wxString text;
    preset.reasonToStay = DecodePreset(before, text);
    if (preset.reasonToStay)
        return preset;
    const std::optional<size_t> moved = MovePresetPaths(text, from, to);
    if (wxTextBuffer::typeDefault == wxTextFileType_Dos)
        text.Replace("\n", "\r\n");
    preset.bytes = text.utf8_string();
    if (preset.bytes.empty() && !text.empty())
        throw std::bad_alloc(); // the library gives an empty text then
    if (!moved || preset.bytes.size() > static_cast<size_t>(LongestFile))
        preset.reasonToStay = NewContentTooLarge;
    return preset;
}
