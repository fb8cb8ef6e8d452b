// Runs the scenarios on a machine where nothing can be lost.
#include "migrate/template_folders.h"
#include "platform/process_rights.h"
#include "platform/system.h"
#include "tests/workstation.h"

#include <gtest/gtest.h>
#include <wx/utils.h>

#include <cstdio>

namespace
{

// Exit statuses beside 0 and 1, which are those of the tests.
constexpr int BrokenOff = 2;
constexpr int NotHere = 3;
// In TrialDir, a file with the account whose trial is running, or was interrupted.
const char* const MarkName = "account";

// Those of the scenarios; the last has the mark.
std::vector<fs::path> Folders()
{
    return {DataDir("machine", {}) / "hotfolder", DataDir("user", {}) / "ORX",
            DataDir("user", {}) / "ORX_Installers", TrialDir() / "work station", TrialDir()};
}

// Why the scenarios do not run; empty if they do.
Text WhyNot(int argc, char** argv)
{
    if (!IsElevated())
        return "The scenarios need administrator's rights.\n";
    if (argc != 2 || argv[1] != Text("--this-machine-is-disposable"))
        return "The scenarios change the registry and the application data of this account. If\n"
               "nothing on this machine matters, add --this-machine-is-disposable.\n";
    const Text there = "The hot folder client may be installed: there is ";
    Text reasons;
    const bool isOurs =
        !AccountName().empty() && ReadFile(TrialDir() / MarkName) == AccountName().utf8_string();
    if (isOurs)
        RemoveKeys();
    TemplateFolders values(true);
    for (const TemplateFolder& value : {values.Default(), values.Previous()})
        reasons += value.isKnown ? there + value.source.name.utf8_string() + "\n" : "";
    for (const fs::path& folder : Folders())
        reasons += fs::exists(folder) && !isOurs ? there + folder.u8string() + "\n" : "";
    return reasons;
}

void RemoveTrial()
{
    RemoveKeys();
    for (const fs::path& folder : Folders())
    {
        AllowAll(folder);
        RemoveTree(folder);
    }
}

// Whatever ends this process also ends the programs that it has started, and they do not keep its
// output open.
void HoldPrograms()
{
    JOBOBJECT_EXTENDED_LIMIT_INFORMATION limits = {};
    limits.BasicLimitInformation.LimitFlags = JOB_OBJECT_LIMIT_KILL_ON_JOB_CLOSE;
    const HANDLE job = CreateJobObjectW(nullptr, nullptr);
    SetInformationJobObject(job, JobObjectExtendedLimitInformation, &limits, sizeof limits);
    AssignProcessToJobObject(job, GetCurrentProcess());
    for (const DWORD stream : {STD_OUTPUT_HANDLE, STD_ERROR_HANDLE})
        SetHandleInformation(GetStdHandle(stream), HANDLE_FLAG_INHERIT, 0);
}

} // namespace

fs::path TrialDir()
{
    return fs::path(_wgetenv(L"ProgramFiles")) / "FolderUpgrade trial";
}

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    std::setvbuf(stdout, nullptr, _IONBF, 0);
    std::printf("%s\nAccount %s\nLinks of others are%s refused\n\n",
                wxGetOsDescription().utf8_str().data(), AccountName().utf8_str().data(),
                RefusesLinksOfOthers() ? "" : " not");
    const Text whyNot = WhyNot(argc, argv);
    if (!whyNot.empty())
    {
        std::printf("%sNothing was changed.\n", whyNot.c_str());
        return NotHere;
    }
    try
    {
        HoldPrograms();
        RemoveTrial();
        WriteFile(TrialDir() / MarkName, AccountName().utf8_string());
        const int status = RUN_ALL_TESTS();
        RemoveTrial();
        const testing::UnitTest& all = *testing::UnitTest::GetInstance();
        std::printf("%d passed, %d failed, %d skipped\n", all.successful_test_count(),
                    all.failed_test_count(), all.skipped_test_count());
        return status;
    }
    catch (const std::exception& error)
    {
        std::printf("%s\nThe trial was broken off. Start it once more.\n", error.what());
        return BrokenOff;
    }
}
