// Runs the scenarios on a machine where nothing can be lost.
#include "platform/process_rights.h"
#include "platform/system.h"
#include "tests/windows/trial_machine.h"
#include "tests/workstation.h"

#include <gtest/gtest.h>
#include <wx/msw/registry.h>
#include <wx/utils.h>

#include <cstdio>

namespace fs = std::filesystem;

namespace
{

constexpr int NotHere = 3; // the exit status; 0 and 1 are those of the tests

// What the tool uses, and the scenarios remove: no key or folder of an installed client.
std::vector<wxString> Keys()
{
    std::vector<wxString> keys;
    for (const wxString hive : {"HKEY_LOCAL_MACHINE", "HKEY_CURRENT_USER"})
    {
        for (const char* key : {"Vantorix", "HF", "Wow6432Node\\Vantorix", "Wow6432Node\\HF"})
            keys.push_back(hive + "\\SOFTWARE\\" + key);
    }
    return keys;
}

std::vector<fs::path> Folders()
{
    return {MachineDataDir({}) / "hotfolder", UserDataDir({}) / "ORX",
            UserDataDir({}) / "ORX_Installers"};
}

// Why the scenarios do not run; empty if they do.
Text WhyNot(int argc, char** argv)
{
    if (!IsElevated())
        return "The scenarios need administrator's rights.\n";
    if (argc != 2 || argv[1] != Text("--this-machine-is-disposable"))
        return "The scenarios change the registry and the application data of this account. If\n"
               "nothing on this machine matters, add --this-machine-is-disposable.\n";
    if (fs::exists(TrialDir()))
        return "";
    const Text there = "The hot folder client may be installed: there is ";
    Text reasons;
    for (const wxString& key : Keys())
        reasons += wxRegKey(key).Exists() ? there + key.utf8_string() + "\n" : "";
    for (const fs::path& folder : Folders())
        reasons += GetFileAttributesW(folder.c_str()) != INVALID_FILE_ATTRIBUTES
                       ? there + folder.u8string() + "\n"
                       : "";
    return reasons;
}

void RemoveTrial()
{
    RemoveKeys();
    for (const fs::path& folder : Folders())
        RemoveTree(folder);
    RemoveTree(TrialDir()); // last, because it is the mark of a trial
}

} // namespace

fs::path TrialDir()
{
    return MachineDataDir({}) / "FolderUpgrade trial";
}

void RemoveKeys()
{
    for (const wxString& key : Keys())
        wxRegKey(key).DeleteSelf();
}

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    std::setvbuf(stdout, nullptr, _IONBF, 0);
    std::printf("%s\nAccount %s, %s\nRedirection policy: %s\n\n",
                wxGetOsDescription().utf8_str().data(), AccountName().utf8_str().data(),
                IsElevated() ? "elevated" : "not elevated",
                RefusesLinksOfOthers() ? "links of others are refused"
                                       : "unknown to this system, or not in force");
    const Text whyNot = WhyNot(argc, argv);
    if (!whyNot.empty())
    {
        std::printf("%sNothing was changed.\n", whyNot.c_str());
        return NotHere;
    }
    RemoveTrial();
    fs::create_directory(TrialDir());
    const int status = RUN_ALL_TESTS();
    RemoveTrial();
    const testing::UnitTest& all = *testing::UnitTest::GetInstance();
    std::printf("%d passed, %d failed, %d skipped\n", all.successful_test_count(),
                all.failed_test_count(), all.skipped_test_count());
    return status;
}
