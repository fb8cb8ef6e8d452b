#include "appearance/icon_source.h"

#include "platform/path_normal_form.h"

#include <wx/stdpaths.h>

wxString SourceIconPath(const wxString& iconName, bool isUpgrade, const wxString& bundleIconsDir)
{
    static const wxString executable = wxStandardPaths::Get().GetExecutablePath();
    const wxString separator = wxFileName::GetPathSeparator();
    wxString path = executable + L"/../";
    if (!isUpgrade)
        path += separator + bundleIconsDir + separator;
    wxFileName source(path + iconName);
    source.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return source.GetFullPath();
}
