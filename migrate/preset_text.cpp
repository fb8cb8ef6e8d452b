#include "migrate/preset_text.h"

#include "migrate/install_locations.h"
#include "store/xml_tree.h"

#include <wx/filename.h>

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

} // namespace

size_t MovePresetPaths(wxString& text, wxString from, wxString to)
{
    TrimSeparators(from);
    TrimSeparators(to);
    if (from.empty() || to.empty() || !IsXmlText(to))
        return 0;

    const wxString introduction = wxString(ImposeTemplateKey) + PathIntroduction;
    const wxString searched = introduction + from;
    wxString moved;
    size_t copied = 0; // the characters of the text that stand in moved
    size_t count = 0;
    for (size_t found = text.find(searched); found != wxString::npos;
         found = text.find(searched, found + introduction.length()))
    {
        const size_t end = found + searched.length();
        if (!EndsFolder(text, end))
            continue;
        if (count++ == 0)
            moved.reserve(text.length() + to.length());
        moved.append(text, copied, found + introduction.length() - copied).append(to);
        copied = end;
    }
    if (count > 0)
    {
        moved.append(text, copied, wxString::npos);
        text.swap(moved);
    }
    return count;
}
