#include "platform/standard_folders.h"

#include <wx/filename.h>
#include <wx/utils.h>

#include <clocale>
#include <cstdlib>

namespace
{

// File names are UTF-8 whatever the environment says. The library never sets a locale for a console
// application, and in the "C" locale it loses names that are not ASCII: those of the standard
// folders, of the executable and of the command line, so this has to happen before main().
const struct FileNamesAreUtf8
{
    FileNamesAreUtf8()
    {
        std::setlocale(LC_CTYPE, "C.UTF-8");
    }
} fileNamesAreUtf8;

wxString FromEnvironment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? wxString::FromUTF8(value) : wxString();
}

// A folder that the base directory convention names has to be absolute; others are to be ignored.
bool IsUsable(const wxString& folder)
{
    return folder.StartsWith("/");
}

wxString WithoutFinalSeparator(const wxString& folder)
{
    return folder.length() > 1 && folder.EndsWith("/") ? folder.BeforeLast('/') : folder;
}

} // namespace

wxString GetUserDataFolder()
{
    const wxString folder = FromEnvironment("XDG_CONFIG_HOME");
    return IsUsable(folder) ? WithoutFinalSeparator(folder) : wxGetHomeDir() + "/.config";
}

wxString GetMachineDataFolder()
{
    const wxString folder = FromEnvironment("XDG_CONFIG_DIRS").BeforeFirst(':');
    return IsUsable(folder) ? WithoutFinalSeparator(folder) : wxString("/etc/xdg");
}
