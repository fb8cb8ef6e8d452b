// Runs the scenarios. Before and after a run, FolderUpgradeCheck has to say what the run changes.
#include "tests/scenario.h"

#include <algorithm>
#include <cctype>
#include <regex>
#include <set>

namespace
{

// The text as far as it is the tool's: of a profile file on Windows, the lines that matter. Wine
// rewrites all of it, and the shell adds its own key and may hide the file.
Text Meaning(const Text& place, Text text)
{
    if (!IsWindows || place.find("Desktop.ini") == Text::npos)
        return text;
    if (place.back() == '#')
        return IsWine() ? text : Replaced(text, "H", "");
    text.erase(std::remove(text.begin(), text.end(), '\0'), text.end()); // of UTF-16
    std::set<Text> meaning;
    std::istringstream lines(text);
    for (Text line; std::getline(lines, line);)
    {
        line.erase(line.find_last_not_of(" \t\r") + 1);
        const auto end = std::find(line.begin(), line.end(), '=');
        std::transform(line.begin(), end, line.begin(), ::tolower);
        if (!line.empty() && line[0] != ';' && !StartsWith(line, "iconresource"))
            meaning.insert(line);
    }
    return testing::PrintToString(meaning);
}

void ExpectEqual(const Files& expected, const Files& actual, const Text& when)
{
    for (const auto& [place, difference] : Differences(expected, actual))
    {
        const auto& [wanted, got] = difference;
        const auto at = std::mismatch(wanted.begin(), wanted.end(), got.begin(), got.end()).first;
        const auto from =
            static_cast<size_t>(std::max<std::ptrdiff_t>(at - wanted.begin() - 200, 0));
        EXPECT_EQ(wanted.substr(from, 2000), got.substr(from, 2000)) << place << when;
    }
}

struct Report
{
    Text lines;             // as IsReported describes them, each after a line feed
    std::set<Text> changed; // files and folders, those whose attributes change with '#'
    size_t problems = 0;
};

// What the check reports. Fails if the check changes anything.
Report Check(const Workstation& workstation, const std::vector<Text>& arguments)
{
    const Files before = workstation.Snapshot();
    const RunResult run = workstation.Start("FolderUpgradeCheck", arguments);
    ExpectEqual(before, workstation.Snapshot(), " after a check");
    EXPECT_EQ("", run.libraryLog);
    Report report;
    std::regex system("(for the account |can't open file(?!.*error 0:)|\\(error (?!0:))[^;\n]*");
    std::istringstream text(std::regex_replace(Replaced(run.output, "\r", ""), system, "$1*"));
    Text title; // the head and the sum are titles without lines
    for (Text line; std::getline(text, line);)
    {
        const Text name = Replaced(title, workstation.Expand("{hot}{/}"), "");
        if (StartsWith(line, "  change"))
            report.changed.insert(title + line.substr(0, line.find(": ")) +
                                  (line.find(": attributes ") == Text::npos ? "" : "#"));
        report.problems += StartsWith(line, "  problem") ? 1 : 0;
        if (StartsWith(line, "  "))
            report.lines += "\n" + name + ":" + line.substr(1);
        else
            title = line;
    }
    EXPECT_EQ(report.problems > 0 ? 2 : report.changed.empty() ? 0 : 1, run.status) << run.output;
    return report;
}

// As the report counts them: the attributes of a new Desktop.ini and of an icon go with the file.
std::set<Text> ChangedPlaces(const Files& before, const Files& after)
{
    std::set<Text> changed;
    for (const auto& [place, texts] : Differences(before, after))
    {
        const Text file = place.substr(0, place.find('#'));
        const bool isNew = before.count(file) + before.count(file + "/") == 0;
        if (place != LogPlace)
            changed.insert(isNew || file.find(".ico") != Text::npos ? file : place);
    }
    return changed;
}

} // namespace

std::map<Text, std::pair<Text, Text>> Differences(const Files& left, const Files& right)
{
    std::map<Text, std::pair<Text, Text>> texts;
    for (const auto& [place, text] : left)
        texts[place] = {Meaning(place, text), Removed};
    for (const auto& [place, text] : right)
        texts.emplace(place, std::pair(Removed, "")).first->second.second = Meaning(place, text);
    for (auto each = texts.begin(); each != texts.end();)
        each = each->second.first == each->second.second ? texts.erase(each) : std::next(each);
    return texts;
}

TEST_P(Workstations, IsAsExpectedAfterTheRun)
{
    const Scenario& scenario = GetParam();
    if (!WhySkipped(scenario).empty())
        GTEST_SKIP() << WhySkipped(scenario);
    Workstation workstation(scenario.asOtherUser);
    workstation.LayOut(WorkstationBefore(scenario));
    const Files before = workstation.Snapshot();
    const Text mode = scenario.arguments.empty() ? "" : scenario.arguments[0];
    const bool isRun = std::regex_match(mode, std::regex("[IiUu]"));
    const bool isOnlyReport = scenario.report && scenario.log.empty() && scenario.after.empty();
    const Report check =
        isRun ? Check(workstation, isOnlyReport ? scenario.arguments : std::vector<Text>{mode})
              : Report();
    if (scenario.report)
    {
        Text lines = check.lines;
        const Text there = testing::PrintToString(scenario.before);
        for (const auto& [part, note] : Files{{"\"hot/", "lists no hot folder"},
                                              {".ico", "no copy of the icon"},
                                              {"presets.xml", "are no presets"}})
        {
            if (there.find(part) == Text::npos && scenario.report->find(note) == Text::npos)
                lines = std::regex_replace(lines, std::regex("\n[^\n]*" + note + "[^\n]*"), "");
        }
        EXPECT_EQ(workstation.Expand(*scenario.report), lines);
    }
    if (isOnlyReport)
        return;
    const bool isRecorded = !scenario.shellVersion.empty();
    const RunResult run =
        workstation.Start(isRecorded ? "FolderUpgradeRecorded" : "FolderUpgrade",
                          scenario.arguments, {{"SHELL_VERSION", scenario.shellVersion}});
    EXPECT_EQ(255, run.status);
    EXPECT_EQ(workstation.Expand(scenario.shellCalls), run.output);
    const Files after = workstation.Snapshot();
    const Text& errors = run.libraryLog;
    if (IsWindows && scenario.libraryReports > 0) // one box, after everything was done
        EXPECT_EQ("A message box, with the run log\n" + after.at(LogPlace), errors);
    else
        EXPECT_EQ(scenario.libraryReports, std::count(errors.begin(), errors.end(), '\n'))
            << errors;
    Files expected = before;
    for (const auto& [place, text] : scenario.after)
        expected[place] = workstation.Expand(text);
    if (!scenario.log.empty())
        expected[LogPlace] = workstation.Expand(Replaced(scenario.log, "\n", "\r\n"));
    ExpectEqual(expected, after, " after the run");
    if (!isRun || isRecorded)
        return;
    // If there are problems, a run may change less; on Windows HIDDEN is not compared.
    const Report second = Check(workstation, {mode});
    const size_t changes = ChangedPlaces(before, after).size();
    EXPECT_TRUE(
        changes == check.changed.size() ||
        (changes < check.changed.size() && (check.problems > 0 || (IsWindows && !IsWine()))))
        << changes << " changes, but " << check.lines;
    EXPECT_TRUE(second.changed.empty() || check.problems + second.problems > 0) << second.lines;
}
