#include "migrate/preset_text.h"

#include "migrate/install_locations.h"
#include "store/xml_tree.h"

#include <wx/filename.h>

#include <vector>

namespace
{

const char* const PathIntroduction = "\">\"";

void TrimSeparators(wxString& folder)
{
    while (!folder.empty() && wxFileName::IsPathSeparator(folder.Last()))
        folder.RemoveLast();
}

bool EndsFolder(const wxString& text, size_t position)
{
    return position < text.length() &&
           (text[position] == '"' || wxFileName::IsPathSeparator(text[position]));
}

// Where the folder's text stands in the text's template paths, in ascending order.
std::vector<size_t> FindFolders(const wxString& text, const wxString& folder)
{
    const wxString introduction = wxString(ImposeTemplateKey) + PathIntroduction;
    const wxString searched = introduction + folder;
    std::vector<size_t> folders;
    for (size_t found = text.find(searched); found != wxString::npos;)
    {
        const size_t begin = found + introduction.length();
        const size_t end = begin + folder.length();
        const bool isPath = EndsFolder(text, end);
        if (isPath)
            folders.push_back(begin);
        // Behind a path, for a folder's text that holds the introduction would overlap itself.
        found = text.find(searched, isPath ? end : begin);
    }
    return folders;
}

} // namespace

size_t MovePresetPaths(wxString& text, wxString from, wxString to)
{
    TrimSeparators(from);
    TrimSeparators(to);
    if (from.empty() || to.empty() || !IsXmlText(to))
        return 0;
    const std::vector<size_t> folders = FindFolders(text, from);
    if (folders.empty())
        return 0;

    // A text that grew as it is put together would stand in memory three times at the worst.
    wxString moved;
    moved.reserve(text.length() + folders.size() * to.length() - folders.size() * from.length());
    size_t copied = 0; // the characters of the text that stand in moved
    for (const size_t folder : folders)
    {
        moved.append(text, copied, folder - copied).append(to);
        copied = folder + from.length();
    }
    moved.append(text, copied, wxString::npos);
    text.swap(moved);
    return folders.size();
}
