#include "run/run_log_place.h"

#include "platform/path_normal_form.h"
#include "platform/standard_folders.h"

wxString RunLogDirPath()
{
    wxFileName directory(GetUserDataFolder() + wxFileName::GetPathSeparator());
    directory.AppendDir(L"ORX_Installers");
    directory.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return directory.GetPath(wxPATH_GET_VOLUME) + wxFileName::GetPathSeparator();
}
