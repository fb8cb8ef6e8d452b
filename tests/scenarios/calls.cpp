// FolderUpgradeRun: how it ends and what it leaves, and that it waits for nobody.
#include "tests/scenarios/texts.h"

#include <chrono>
#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace
{

const Text Logs = "user/ORX_Installers/";
const Text Folder = "tool/results/";
const Text Old = "{tool}{/}previous{/}Booklet.tpl";
const Text New = "{tool}{/}template{/}Booklet.tpl";
const Text Refused = "  problem  Folder.cfg: cannot be opened for writing";
const Text Reset = "\nLost or reset by the run\n  problem  {hot}{/}A: Folder.cfg: ";
const Text Ended =
    "\n  problem  crashed, or was ended before it had finished\n  problem  the time is over, ";

struct Call
{
    Scenario scenario;
    int status;
    Text said = "";                 // a part of the second report
    Text results = Logs;            // the place of what is left, if there is one
    Text program = "FolderUpgrade"; // what is in its place, if anything is
};

// A path of a Folder.cfg and one of a preset move, and both templates exist.
Scenario Moving(const Text& name)
{
    return Scenario(name)
        .Before({{MachineHive, MachineValue("\"InstallPath\"=\"{TOOL}\"")},
                 {UserHive, UserValue("\"Path\"=\"{TOOL}{/2}previous\"")}})
        .Before({{"tool/previous/Booklet.tpl", ""}, {"tool/template/Booklet.tpl", ""}})
        .Before({{CfgPlace, Written(Old)}})
        .Preset(Stored(Old), Stored(New));
}

Scenario Staying(const Text& name)
{
    return Moving(name).Preset(Stored(Old), Stored(Old));
}

Scenario Into(const Text& name, const Files& files)
{
    return Moving(name).Before(files).Run({"I", "{tool}{/}results"});
}

std::vector<Call> Calls()
{
    const Text after = "FolderUpgrade-upgrade-after.txt";
    const Text reset = Replaced(Written(Old), " description=\"\"", "");
    const Text manyFolders = "<l>" + Times(200000, "<HotFolder path='/missing/#'/>") + "</l>";
    return {
        {Moving("AllIsDoneAndTheLogFolderIsMade").Before({{LogPlace, Removed}}), 0},
        {Moving("TheWayBack")
             .Before({{CfgPlace, Written(New)}})
             .Preset(Stored(New), Stored(Old))
             .Run({"u", "--limit", "600"}),
         0},
        {Into("EarlierResultsAreReplaced", {{Folder + after, Text(9999, '.')}}), 0, "", Folder},
        {Into("TheFolderIsMissing", {}), 2, "", ""},
        {Into("TheFolderIsALink", {{Folder, "{link:elsewhere/d}"}, {"elsewhere/d/", ""}}), 2, "",
         ""},
        {Into("TheFolderCannotBeWrittenTo", {{Folder, ""}, {"tool/results#", "X"}}).AsOtherUser(),
         2, "", ""},
        {Into("AReportIsALink", {{Folder + after, "{link:elsewhere/a}"}, {"elsewhere/a", "stays"}})
             .After({{"elsewhere/a", "stays"}})
             .NotUnderWine("Wine does not show links to files as links"),
         2, "", ""},
        {Moving("ABoxIsClosed").Before({{CfgPlace + "#", "R"}}).AsOtherUser(), 2, Refused},
        {Moving("ABoxWithAListIsClosed")
             .Before({{CfgPlace + "#", "R"}, {"hot/B/[P]/Folder.cfg", ""}})
             .AsOtherUser(),
         2, Refused},
        {Moving("WhatWasResetIsSaid").Before({{CfgPlace, reset}}), 2, Reset},
        {Staying("AnAccountWithoutAPath").Before({{UserHive, Removed}}), 2, "; nothing moves"},
        {Staying("TheProgramIsMissing"), 4,
         "\nFolderUpgrade\n  problem  could not be started (error 2: ", Logs, ""},
        {Staying("TheProgramDoesNotEnd").Run({"I", "--limit", "3"}), 4, Ended, Logs, "endless"},
        {Staying("ACheckDoesNotEnd").Before({{ListPlace, manyFolders}}).Run({"I", "--limit", "1"}),
         4, "The time is over. A check was not finished.\n"},
    };
}

class CallsOfAnInstaller : public testing::TestWithParam<Call>
{
};

void PrintTo(const Call& call, std::ostream* stream)
{
    *stream << call.scenario.name;
}

TEST_P(CallsOfAnInstaller, LeaveTheirResults)
{
    const Call& call = GetParam();
    if (!WhySkipped(call.scenario).empty())
        GTEST_SKIP() << WhySkipped(call.scenario);
    Workstation workstation(call.scenario.asOtherUser);
    workstation.LayOut(WorkstationBefore(call.scenario));
    const fs::path program = workstation.HostPath(Text("tool/FolderUpgrade") + ProgramSuffix);
    if (call.program != "FolderUpgrade")
        fs::remove(program);
    if (call.program == "endless")
        fs::copy_file(ProgramDir() / (Text("endless") + ProgramSuffix), program);
    std::vector<Text> arguments;
    for (const Text& argument : call.scenario.arguments)
        arguments.push_back(workstation.Expand(argument));
    const auto begin = std::chrono::steady_clock::now();
    const RunResult run = workstation.Start("FolderUpgradeRun", arguments);
    EXPECT_EQ(call.status, run.status) << run.libraryLog;
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(30));
    // The system refuses to write to a program that is still running.
    EXPECT_TRUE(call.program != "endless" || std::ofstream(program, std::ios::app));
    Files files = workstation.Snapshot();
    for (const auto& [place, text] : call.scenario.after)
        EXPECT_EQ(workstation.Expand(text), files[place]) << place;
    EXPECT_EQ(0U, files.count("elsewhere/d/FolderUpgrade-upgrade.log"));
    if (call.results.empty())
        return;
    const Text results =
        call.results + (arguments[0] == "I" ? "FolderUpgrade-upgrade" : "FolderUpgrade-downgrade");
    const Text report = Replaced(files[results + "-after.txt"], "\r\n", "\n");
    EXPECT_NE(Text::npos, report.find(workstation.Expand(call.said))) << report;
    const Text last = "\nExit status of FolderUpgradeRun: " + std::to_string(call.status) + "\n";
    EXPECT_EQ(report.size() - last.size(), report.find(last)) << report;
    EXPECT_TRUE(StartsWith(files[results + "-before.txt"], "FolderUpgradeCheck "));
    const bool isStarted = call.status != 4 || call.program == "endless";
    EXPECT_EQ(isStarted ? files[LogPlace] : "", files[results + ".log"]);
}

INSTANTIATE_TEST_SUITE_P(Calls, CallsOfAnInstaller, testing::ValuesIn(Calls()),
                         [](const auto& call) { return TestName(call.param.scenario); });

TEST(CallOfAnInstaller, PrintsItsUsage)
{
    const std::vector<std::vector<Text>> wrong = {{},
                                                  {"V"},
                                                  {"I", "--limit"},
                                                  {"I", "--limit", "0"},
                                                  {"I", "--limit", "1h"},
                                                  {"I", "-x"},
                                                  {"I", "a", "b"}};
    const Workstation workstation;
    for (const std::vector<Text>& arguments : wrong)
    {
        const RunResult run = workstation.Start("FolderUpgradeRun", arguments);
        EXPECT_EQ(3, run.status);
        EXPECT_TRUE(
            StartsWith(run.libraryLog, "Usage: FolderUpgradeRun I|U [--limit SECONDS] [FOLDER]\n"));
    }
}

} // namespace
