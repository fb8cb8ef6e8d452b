#include "appearance/icon_source.h"

#include "platform/path_normal_form.h"

#include <wx/stdpaths.h>

wxString SourceIconPath(const wxString& iconName, bool isUpgrade, const wxString& bundleIconsDir)
{
    wxFileName source(wxStandardPaths::Get().GetExecutablePath());
    if (!isUpgrade)
        source.AppendDir(bundleIconsDir);
    source.SetFullName(iconName);
    source.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return source.GetFullPath();
}
