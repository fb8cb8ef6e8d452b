#include "appearance/icon_copy.h"

#include "appearance/folder_icon_state.h"
#include "platform/path_normal_form.h"

#include <wx/stdpaths.h>

namespace
{

wxString SourceIconPath(const wxString& iconName, bool isUpgrade, const wxString& bundleIconsDir)
{
    wxFileName source(wxStandardPaths::Get().GetExecutablePath());
    if (!isUpgrade)
        source.AppendDir(bundleIconsDir);
    source.SetFullName(iconName);
    source.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return source.GetFullPath();
}

} // namespace

IconCopy DecideIconCopy(HotFolder& folder, bool isUpgrade, const wxString& bundleIconsDir)
{
    using Outcome = IconCopy::Outcome;
    IconCopy copy;
    GetFolderIconName(folder, copy.name);
    copy.source = SourceIconPath(copy.name, isUpgrade, bundleIconsDir);
    const wxString destination = folder.privateDir.Reach(copy.name);
    if (IsLink(destination))
        copy.outcome = Outcome::Linked;
    else if (!wxFileExists(destination))
        copy.outcome = Outcome::NoCopy;
    else
        copy.outcome = wxFileExists(copy.source) ? Outcome::Replaces : Outcome::NoSource;
    return copy;
}
