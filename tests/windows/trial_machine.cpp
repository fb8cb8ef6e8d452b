#include "tests/windows/trial_machine.h"

#include "platform/system.h"
#include "tests/test_system.h"

namespace fs = std::filesystem;

namespace
{

const auto Hives = {std::pair("HKEY_LOCAL_MACHINE\\", HKEY_LOCAL_MACHINE),
                    {"HKEY_CURRENT_USER\\", HKEY_CURRENT_USER}};
const auto Keys = {"SOFTWARE\\Vantorix", "SOFTWARE\\HF", "SOFTWARE\\Wow6432Node\\Vantorix",
                   "SOFTWARE\\Wow6432Node\\HF"};

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
    for (const auto& [name, hive] : Hives)
    {
        for (const char* key : Keys)
        {
            HKEY opened = nullptr;
            if (RegOpenKeyExA(hive, key, 0, KEY_READ, &opened) != ERROR_FILE_NOT_FOUND)
                found.push_back(Text(name) + key);
            RegCloseKey(opened);
        }
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
    for (const auto& [name, hive] : Hives)
    {
        for (const char* key : Keys)
            RegDeleteTreeA(hive, key);
    }
}

void RemoveTrial()
{
    RemoveKeys();
    for (const fs::path& folder : Folders())
        RemoveTree(folder);
    RemoveTree(TrialDir()); // last, because it is the mark of a trial
}
