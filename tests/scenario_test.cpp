#include "tests/check_report.h"
#include "tests/scenario.h"
#include "tests/text_files.h"

#include <algorithm>
#include <optional>
#include <set>

namespace
{

std::string WithLineEnds(std::string text)
{
    for (size_t at = text.find('\n'); at != std::string::npos; at = text.find('\n', at + 2))
        text.insert(at, 1, '\r');
    return text;
}

// The lines of a text with their line ends; long lines are cut into pieces.
std::vector<std::string> Lines(const std::string& text)
{
    constexpr size_t Longest = 200;
    std::vector<std::string> lines;
    for (size_t at = 0; at < text.size(); at += lines.back().size())
        lines.push_back(text.substr(at, std::min(text.find('\n', at), at + Longest - 1) - at + 1));
    return lines;
}

// The lines from the first to the last that differ, and one more on each side.
std::string Difference(const std::string& expected, const std::string& actual)
{
    testing::GTEST_FLAG(print_utf8) = false; // escapes alone, on one line
    const std::vector<std::string> left = Lines(expected);
    const std::vector<std::string> right = Lines(actual);
    const auto [leftBegin, rightBegin] =
        std::mismatch(left.begin(), left.end(), right.begin(), right.end());
    const auto [leftEnd, rightEnd] =
        std::mismatch(left.rbegin(), std::make_reverse_iterator(leftBegin), right.rbegin(),
                      std::make_reverse_iterator(rightBegin));
    const auto number =
        1 + std::count_if(left.begin(), leftBegin,
                          [](const std::string& line) { return line.back() == '\n'; });
    std::string text = "--- expected\n+++ actual\n@@ line " + std::to_string(number) + " @@\n";
    const auto add = [&](char sign, auto from, auto to)
    {
        constexpr int Most = 10;
        for (int count = 0; from != to && count < Most; ++from, ++count)
            text += sign + testing::PrintToString(*from) + "\n";
    };
    add(' ', leftBegin - (leftBegin == left.begin() ? 0 : 1), leftBegin);
    add('-', leftBegin, leftEnd.base());
    add('+', rightBegin, rightEnd.base());
    add(' ', leftEnd.base(), leftEnd.base() + (leftEnd == left.rbegin() ? 0 : 1));
    return text;
}

Files Expected(const Workstation& workstation, const Files& before, const Scenario& scenario)
{
    Files expected = before;
    for (const auto& [place, text] : scenario.after)
        expected[place] = place.back() == '#' ? text : workstation.Expand(text);
    if (!scenario.log.empty())
        expected[LogPlace] = workstation.Expand(WithLineEnds(LogAfter(scenario)));
    for (auto entry = expected.begin(); entry != expected.end();)
    {
        workstation.HostPath(entry->first);
        const std::string owner = entry->first.substr(0, entry->first.size() - 1);
        const bool isAttributes = entry->first.back() == '#';
        if (isAttributes && expected.count(owner) + expected.count(owner + "/") == 0)
            ADD_FAILURE() << entry->first << " has attributes, but does not exist";
        entry = isAttributes && entry->second.empty() ? expected.erase(entry) : std::next(entry);
    }
    return expected;
}

void Compare(const Files& expected, const Files& actual, const std::string& when)
{
    for (const auto& [place, text] : expected)
    {
        const auto found = actual.find(place);
        if (found == actual.end())
        {
            ADD_FAILURE() << place << " is missing " << when;
            continue;
        }
        const bool isMeaning = IsWindowsProgram() &&
                               place.find("Desktop.ini") != std::string::npos &&
                               place.back() != '#';
        const std::string& wanted = isMeaning ? ProfileMeaning(text) : text;
        const std::string& got = isMeaning ? ProfileMeaning(found->second) : found->second;
        if (wanted != got)
            ADD_FAILURE() << place << " " << when << ":\n" << Difference(wanted, got);
    }
    for (const auto& [place, text] : actual)
    {
        if (expected.count(place) == 0)
            ADD_FAILURE() << place << " is new " << when << ":\n" << Difference("", text);
    }
}

Files FolderCfgsOf(Files files)
{
    for (auto file = files.begin(); file != files.end();)
        file = file->first.find("Folder.cfg") == std::string::npos ? files.erase(file)
                                                                   : std::next(file);
    return files;
}

#ifdef __SANITIZE_ADDRESS__
constexpr bool HasSanitizer = true;
#else
constexpr bool HasSanitizer = false;
#endif

// What the check reports for a run in that direction. Fails if the check changes anything.
CheckReport Check(Workstation& workstation, const Scenario& scenario)
{
    const Files before = workstation.Snapshot();
    CheckReport report(workstation,
                       workstation.Start({scenario.arguments[0]}, "FolderUpgradeCheck"));
    Compare(before, workstation.Snapshot(), "after a check");
    return report;
}

bool IsRun(const Scenario& scenario)
{
    static const std::set<std::string> switches = {"I", "i", "U", "u"};
    return !scenario.arguments.empty() && switches.count(scenario.arguments[0]) != 0;
}

// The check has to name before the run what the run then changes, and nothing after it. If it names
// problems, the run may change less.
void CompareChecks(const CheckReport& first, const CheckReport& second,
                   const std::set<std::string>& changed)
{
    if (first.problems == 0)
    {
        EXPECT_EQ(changed, first.changes) << first.text;
    }
    for (const std::string& place : changed)
        EXPECT_TRUE(first.problems == 0 || first.changes.count(place) != 0)
            << place << " is not in\n"
            << first.text;
    EXPECT_TRUE(second.changes.empty() || first.problems + second.problems > 0) << second.text;
}

void RunAndCompare(Workstation& workstation, const Scenario& scenario)
{
    const Files before = workstation.Snapshot();
    std::optional<CheckReport> check;
    if (IsRun(scenario))
        check = Check(workstation, scenario);

    const RunResult run = workstation.Start(scenario.arguments);
    EXPECT_EQ(255, run.process.exitStatus) << run.libraryLog;
    EXPECT_EQ(scenario.libraryReports, !run.libraryLog.empty()) << run.libraryLog;
    if (scenario.seconds > 0 && !HasSanitizer)
    {
        EXPECT_LE(run.process.seconds, scenario.seconds);
        EXPECT_TRUE(IsWindowsProgram() || run.process.megabytes <= scenario.megabytes)
            << run.process.megabytes << " megabytes";
    }
    const Files after = workstation.Snapshot();
    if (IsWindowsProgram() && scenario.libraryReports)
    {
        // One box, after everything was done.
        EXPECT_EQ("A message box, with the run log\n" + after.at(LogPlace), run.libraryLog);
    }
    Compare(Expected(workstation, before, scenario), after, "after the run");

    if (check)
        CompareChecks(*check, Check(workstation, scenario), ChangedPlaces(before, after));

    // A second run in the same direction must find nothing to move.
    if (IsWindowsProgram())
        return;
    EXPECT_EQ(255, workstation.Start(scenario.arguments).process.exitStatus);
    Compare(FolderCfgsOf(after), FolderCfgsOf(workstation.Snapshot()), "after a second run");
}

} // namespace

std::string NameOf(const testing::TestParamInfo<Scenario>& scenario)
{
    return scenario.param.name.what;
}

void PrintTo(const Scenario& scenario, std::ostream* stream)
{
    *stream << scenario.name.what;
}

TEST_P(Workstations, IsAsExpectedAfterTheRun)
{
    TestOn(GetParam(), "FolderUpgrade",
           [](Workstation& workstation) { RunAndCompare(workstation, GetParam()); });
}
