// Runs the scenarios on a machine where nothing can be lost.
#include "platform/process_rights.h"
#include "platform/system.h"
#include "tests/test_system.h"
#include "tests/windows/trial_machine.h"

#include <gtest/gtest.h>

#include <cstdio>

namespace
{

constexpr int NotHere = 3; // the exit status; 0 and 1 are those of the tests

Text Version()
{
    using Get = LONG(WINAPI*)(OSVERSIONINFOW*); // GetVersionEx says what the manifest lets it
    OSVERSIONINFOW version = {};
    version.dwOSVersionInfoSize = sizeof version;
    const auto get = reinterpret_cast<Get>(
        reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"ntdll.dll"), "RtlGetVersion")));
    get(&version);
    return std::to_string(version.dwMajorVersion) + "." + std::to_string(version.dwMinorVersion) +
           "." + std::to_string(version.dwBuildNumber) + (IsWine() ? " (Wine)" : "");
}

// Why the scenarios do not run; empty if they do.
Text WhyNot(int argc, char** argv)
{
    if (!IsElevated())
        return "The scenarios need administrator's rights.\n";
    if (argc != 2 || argv[1] != Text("--this-machine-is-disposable"))
        return "The scenarios change the registry and the application data of this account. If\n"
               "nothing on this machine matters, add --this-machine-is-disposable.\n";
    Text reasons;
    for (const Text& found :
         std::filesystem::exists(TrialDir()) ? std::vector<Text>() : FindInstallation())
        reasons += "The hot folder client may be installed: there is " + found + "\n";
    return reasons;
}

} // namespace

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    std::setvbuf(stdout, nullptr, _IONBF, 0);
    std::printf("Windows %s\nAccount %s, %s\nRedirection policy: %s\n\n", Version().c_str(),
                AccountName().utf8_str().data(), IsElevated() ? "elevated" : "not elevated",
                RefusesLinksOfOthers() ? "links of others are refused"
                                       : "unknown to this system, or not in force");
    const Text whyNot = WhyNot(argc, argv);
    if (!whyNot.empty())
    {
        std::printf("%sNothing was changed.\n", whyNot.c_str());
        return NotHere;
    }
    RemoveTrial();
    std::filesystem::create_directory(TrialDir());
    const int status = RUN_ALL_TESTS();
    RemoveTrial();
    const testing::UnitTest& all = *testing::UnitTest::GetInstance();
    std::printf("%d passed, %d failed, %d skipped\n", all.successful_test_count(),
                all.failed_test_count(), all.skipped_test_count());
    return status;
}
