#include "platform/standard_folders.h"

#include <wx/filename.h>
#include <wx/stdpaths.h>

wxString GetUserDataFolder()
{
    return wxStandardPaths::Get().GetUserConfigDir();
}

wxString GetMachineDataFolder()
{
    // Parsed as a file's path, which removes the application's name, whatever it is.
    return wxFileName(wxStandardPaths::Get().GetConfigDir()).GetPath(wxPATH_GET_VOLUME);
}
