#include "tests/windows/trial_machine.h"

#include "platform/system.h"
#include "tests/test_system.h"

#include <wx/arrstr.h>
#include <wx/buffer.h>
#include <wx/msw/registry.h>

namespace fs = std::filesystem;

namespace
{

wxArrayString Keys()
{
    wxArrayString keys;
    for (const char* hive : {"HKEY_LOCAL_MACHINE", "HKEY_CURRENT_USER"})
    {
        for (const char* key : {"Vantorix", "HF", "Wow6432Node\\Vantorix", "Wow6432Node\\HF"})
            keys.Add(wxString(hive) + "\\SOFTWARE\\" + key);
    }
    return keys;
}

std::vector<fs::path> Folders()
{
    return {MachineDataDir({}) / "hotfolder", UserDataDir({}) / "ORX",
            UserDataDir({}) / "ORX_Installers"};
}

} // namespace

fs::path TrialDir()
{
    return MachineDataDir({}) / "FolderUpgrade trial";
}

std::vector<Text> FindInstallation()
{
    std::vector<Text> found;
    for (const wxString& key : Keys())
    {
        if (wxRegKey(key).Exists())
            found.push_back(key.utf8_string());
    }
    for (const fs::path& folder : Folders())
    {
        if (GetFileAttributesW(folder.c_str()) != INVALID_FILE_ATTRIBUTES)
            found.push_back(folder.u8string());
    }
    return found;
}

void RemoveKeys()
{
    for (const wxString& key : Keys())
    {
        if (wxRegKey(key).Exists())
            wxRegKey(key).DeleteSelf();
    }
}

void RemoveTrial()
{
    RemoveKeys();
    for (const fs::path& folder : Folders())
        RemoveTree(folder);
    RemoveTree(TrialDir()); // last, because it is the mark of a trial
}
