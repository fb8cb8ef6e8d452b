#include "tests/scenario.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <sstream>

namespace
{

class Workstations : public testing::TestWithParam<Scenario>
{
};

std::string Lower(std::string text)
{
    for (char& character : text)
        character = static_cast<char>(std::tolower(static_cast<unsigned char>(character)));
    return text;
}

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
    for (auto entry = expected.begin(); entry != expected.end();)
        entry = entry->first.back() == '#' && entry->second.empty() ? expected.erase(entry) : std::next(entry);
    if (scenario.log != OldLog)
        expected[LogPlace] = workstation.Expand(WithLineEnds(scenario.log));
    return expected;
}

// The sections, keys and values of a profile file, which Wine rewrites whole; it also adds a key of
// its own to Desktop.ini.
std::string Meaning(const std::string& profile)
{
    std::map<std::string, std::string> values;
    const bool isUtf16 = profile.compare(0, 2, "\xFF\xFE") == 0;
    std::string text = profile.substr(isUtf16 ? 2 : 0);
    text.erase(std::remove(text.begin(), text.end(), '\0'), text.end()); // what is UTF-16 here is of ASCII
    std::istringstream lines(text);
    std::string section;
    for (std::string line; std::getline(lines, line);)
    {
        line.erase(line.find_last_not_of(" \t\r") + 1);
        const size_t sign = line.find('=');
        if (line.empty() || line[0] == ';')
            continue;
        if (line[0] == '[')
            section = Lower(line);
        else if (sign != std::string::npos && Lower(line.substr(0, sign)) != "iconresource")
            values.emplace(section + Lower(line.substr(0, line.find_last_not_of(' ', sign - 1) + 1)), line.substr(sign + 1));
    }
    std::string meaning = isUtf16 ? "in UTF-16\n" : "";
    for (const auto& [key, value] : values)
        meaning += key + "=" + value + "\n";
    return meaning;
}

void ExpectText(const std::string& expected, const std::string& actual, const std::string& place, const char* when)
{
    if (IsWindowsProgram() && place.find("Desktop.ini") != std::string::npos && place.back() != '#')
        EXPECT_EQ(Meaning(expected), Meaning(actual)) << when << ": " << place;
    else
        EXPECT_EQ(expected, actual) << when << ": " << place;
}

void Compare(const Files& expected, const Files& actual, const char* when)
{
    for (const auto& [place, text] : expected)
    {
        if (actual.count(place) == 0)
            ADD_FAILURE() << when << ": " << place << " is missing";
        else
            ExpectText(text, actual.at(place), place, when);
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
    Workstation workstation(scenario.asOtherUser);
    workstation.LayOut(scenario.before);
    const Files before = workstation.Snapshot();

    const RunResult run = workstation.Start(scenario.arguments);
    EXPECT_EQ(255, run.exitStatus) << run.libraryLog;
    EXPECT_EQ(scenario.libraryLogs, !run.libraryLog.empty()) << run.libraryLog;
    const Files after = workstation.Snapshot();
    if (IsWindowsProgram() && scenario.libraryLogs)
    {
        // One box, after everything was done.
        EXPECT_EQ("A message box, with the run log\n" + after.at(LogPlace), run.libraryLog);
    }
    Compare(Expected(workstation, before, scenario), after, "after the run");

    if (IsWindowsProgram())
        return;
    EXPECT_EQ(255, workstation.Start(scenario.arguments).exitStatus);
    CompareFolderCfgs(after, workstation.Snapshot());
}

INSTANTIATE_TEST_SUITE_P(All, Workstations, testing::ValuesIn(Scenarios()), NameOf);
