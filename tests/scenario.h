// The end-to-end scenarios: a workstation before, the command line, the workstation after. What a
// scenario does not mention has its usual value. Those of each subject are in tests/scenarios/.
#pragma once

#include "tests/workstation.h"

#include <gtest/gtest.h>

#include <optional>
#include <vector>

/// In Before: the usual file does not exist.
inline const char* const Removed = "(not there)";

inline const Text ListPlace = "machine/hotfolder/HotFolderList.cfg";
inline const Text CfgPlace = "hot/A/[P]/Folder.cfg";
inline const Text PresetPlace = "user/ORX/JPData/.P/Presets/presets.xml";

#define SETTER(name, field, ...)                                                                   \
    Scenario& name(const decltype(field)& value __VA_ARGS__)                                       \
    {                                                                                              \
        field = value;                                                                             \
        return *this;                                                                              \
    }

struct FolderLog // of a hot folder
{
    Text name;
    Text impose;             // the lines about its template, as if its name were A
    Text icon = "hf_folder"; // the name of its icon, or the lines about that
};

struct Scenario
{
    Text name;
    Files before;
    std::vector<Text> arguments = {"I"};
    Files after;
    Text log; // empty for that of the earlier run
    long libraryReports = 0;
    bool asOtherUser = false;
    Text notOnWindows;
    Text notUnderWine;
    Text shellVersion;
    Text shellCalls;
    std::optional<Text> report;

    friend void PrintTo(const Scenario& /*scenario*/, std::ostream* /*stream*/)
    {
    } // its test has its name
    /// Files in addition to the usual ones, or in place of them. The usual ones are the log of an
    /// earlier run, the hives, a template in both template folders, an empty directory for presets,
    /// and HotFolderList.cfg, which lists every NAME of the places hot/NAME/... in order.
    explicit Scenario(const Text& whatHappens, const Files& files = {})
        : name(whatHappens), before(files)
    {
    }
    Scenario& Before(const Files& files)
    {
        for (const auto& [place, text] : files)
            before[place] = text;
        return *this;
    }
    /// Files that change. Every other file and attribute has to stay as it is.
    Scenario& After(const Files& files)
    {
        for (const auto& [place, text] : files)
            after[place] = text;
        return *this;
    }
    /// One file, before and after; without the second text, it stays.
    Scenario& File(const Text& place, const Text& text, const Text& becomes = "")
    {
        return Before({{place, text}}).After(becomes.empty() ? Files() : Files{{place, becomes}});
    }
    SETTER(Run, arguments, )
    /// For tests of refusals: root is refused nothing.
    SETTER(AsOtherUser, asOtherUser, = true)
    /// The reason why the scenario is skipped there, or only under Wine.
    SETTER(NotOnWindows, notOnWindows, )
    SETTER(NotUnderWine, notUnderWine, )

    /// The whole log, with LF instead of CR LF; if no log is given, that of the earlier run stays.
    SETTER(WholeLog, log, )
    /// After Before and Run: the log of a run with these hot folders and these lines about the
    /// presets.
    Scenario& Log(const std::vector<FolderLog>& folders = {}, const Text& presets = "");
    /// The library itself reports so many errors, on Windows in a message box.
    SETTER(LibraryReports, libraryReports, = 1)

    /// After Before: what FolderUpgradeCheck reports before the run, each line after its title;
    /// only {hot}{/} of a hot folder's title is left out. An * is the account or the system's own
    /// words. Notes that say what is not there may be left out. Without a log or files that change,
    /// there is no run.
    Scenario& IsReported(const Text& lines);
};

/// Everything on the workstation before the run, the usual files included.
Files WorkstationBefore(const Scenario& scenario);

/// The reason why the scenario is skipped on this system, empty if it is not.
inline Text WhySkipped(const Scenario& scenario)
{
    const Text onWindows = IsWindows ? scenario.notOnWindows : "";
    return IsWine() && onWindows.empty() ? scenario.notUnderWine : onWindows;
}

/// The name of its test; see tests/windows/CMakeLists.txt.
inline Text TestName(const Scenario& scenario)
{
    return scenario.name + (scenario.asOtherUser ? "_AsOtherUser" : "");
}

/// The places that differ in two snapshots, with both texts, or Removed.
std::map<Text, std::pair<Text, Text>> Differences(const Files& left, const Files& right);

class Workstations : public testing::TestWithParam<Scenario>
{
};

/// The head of a function that returns scenarios, which become a group of tests of that name.
#define SCENARIOS(group)                                                                           \
    std::vector<Scenario> group();                                                                 \
    INSTANTIATE_TEST_SUITE_P(group, Workstations, testing::ValuesIn(group()),                      \
                             [](const auto& scenario) { return TestName(scenario.param); });       \
    std::vector<Scenario> group()
