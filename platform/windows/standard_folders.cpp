#include "platform/standard_folders.h"

#include <wx/filename.h>
#include <wx/stdpaths.h>

wxString GetUserDataFolder()
{
    return wxStandardPaths::Get().GetUserConfigDir();
}

wxString GetMachineDataFolder()
{
    // Taken as a file's path, so that the application's name, whatever it is, falls away.
    return wxFileName(wxStandardPaths::Get().GetConfigDir()).GetPath(wxPATH_GET_VOLUME);
}
