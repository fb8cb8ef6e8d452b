#include "platform/standard_folders.h"

#include "platform/path_normal_form.h"

#include <wx/utils.h>

#include <cstdlib>

namespace
{

wxString FromEnvironment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? wxString::FromUTF8(value) : wxString();
}

// The XDG base directory convention requires an absolute path, and says to ignore others.
bool IsUsable(const wxString& folder)
{
    return folder.StartsWith("/");
}

} // namespace

wxString GetUserDataFolder()
{
    const wxString folder = FromEnvironment("XDG_CONFIG_HOME");
    return IsUsable(folder) ? WithoutFinalSeparators(folder) : wxGetHomeDir() + "/.config";
}

wxString GetMachineDataFolder()
{
    const wxString folder = FromEnvironment("XDG_CONFIG_DIRS").BeforeFirst(':');
    return IsUsable(folder) ? WithoutFinalSeparators(folder) : wxString("/etc/xdg");
}
