#include "tests/scenario.h"

#include <gtest/gtest.h>

namespace
{

class Workstations : public testing::TestWithParam<Scenario>
{
};

std::string WithLineEnds(const std::string& text)
{
    std::string result;
    for (const char character : text)
        result += character == '\n' ? std::string("\r\n") : std::string(1, character);
    return result;
}

Files Expected(const Workstation& workstation, const Files& before, const Scenario& scenario)
{
    Files expected = before;
    for (const auto& [place, text] : scenario.after)
        expected[place] = place.back() == '#' ? text : workstation.Expand(text);
    if (scenario.log != OldLog)
        expected[LogPlace] = workstation.Expand(WithLineEnds(scenario.log));
    return expected;
}

void Compare(const Files& expected, const Files& actual, const char* when)
{
    for (const auto& [place, text] : expected)
    {
        if (actual.count(place) == 0)
            ADD_FAILURE() << when << ": " << place << " is missing";
        else
            EXPECT_EQ(text, actual.at(place)) << when << ": " << place;
    }
    for (const auto& [place, text] : actual)
    {
        EXPECT_EQ(1U, expected.count(place)) << when << ": " << place << " is new:\n" << text;
    }
}

// A second run in the same direction finds nothing to move.
void CompareFolderCfgs(const Files& first, const Files& second)
{
    for (const auto& [place, text] : first)
    {
        if (place.find("Folder.cfg") != std::string::npos)
        {
            EXPECT_EQ(text, second.at(place)) << "after a second run: " << place;
        }
    }
}

std::string NameOf(const testing::TestParamInfo<Scenario>& info)
{
    return info.param.name;
}

} // namespace

TEST_P(Workstations, IsAsExpectedAfterTheRun)
{
    const Scenario& scenario = GetParam();
    if (IsWindowsProgram() && scenario.notUnderWine)
        GTEST_SKIP() << scenario.notUnderWine;
    Workstation workstation;
    workstation.LayOut(scenario.before);
    const Files before = workstation.Snapshot();

    const RunResult run = workstation.Start(scenario.arguments, scenario.asOtherUser);
    EXPECT_EQ(255, run.exitStatus) << run.libraryLog;
    EXPECT_EQ(scenario.libraryLogs, !run.libraryLog.empty()) << run.libraryLog;
    const Files after = workstation.Snapshot();
    Compare(Expected(workstation, before, scenario), after, "after the run");

    EXPECT_EQ(255, workstation.Start(scenario.arguments, scenario.asOtherUser).exitStatus);
    CompareFolderCfgs(after, workstation.Snapshot());
}

INSTANTIATE_TEST_SUITE_P(All, Workstations, testing::ValuesIn(Scenarios()), NameOf);
