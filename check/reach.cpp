#include "check/reach.h"

#include "platform/process_rights.h"

#include <wx/filename.h>

namespace
{

// Whether the directory or one of those above it is a link.
bool LeadsOverLink(const wxString& directory)
{
    wxFileName name = wxFileName::DirName(directory);
    for (; name.GetDirCount() > 0; name.RemoveLastDir())
    {
        if (IsLink(name.GetPath(wxPATH_GET_VOLUME)))
            return true;
    }
    return false;
}

} // namespace

bool MayEnter(const PinnedDirectory& directory)
{
    return directory.IsOpen() && wxFileName::Exists(directory.Reach(L"."));
}

wxString WhyOutOfReach(const wxString& directory)
{
    if (MayEnter(PinnedDirectory(directory, Links::Follow)))
        return {};
    if (RefusesLinksOfOthers() && LeadsOverLink(directory))
        return "is reached over a link that an elevated run refuses to follow";
    // A directory above it may keep it from being seen.
    wxFileName above = wxFileName::DirName(directory);
    while (above.GetDirCount() > 0 && !wxDirExists(above.GetPath(wxPATH_GET_VOLUME)))
        above.RemoveLastDir();
    if (above.GetDirCount() == 0 ||
        MayEnter(PinnedDirectory(above.GetPath(wxPATH_GET_VOLUME), Links::Follow)))
        return {};
    return "cannot be entered";
}
