// FolderUpgradeRun: how it ends and what it leaves, and that it waits for nobody.
#include "tests/scenarios/texts.h"
#include "tests/wine.h"

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
const Text Ended = "\n  problem  crashed, or was ended before it had finished\n  problem  the time is over, ";

struct Call
{
    Scenario scenario;
    int status;
    Text said = "";                 // a part of the second report
    Text results = Logs;            // the place of what is left, if there is one
    Text program = "FolderUpgrade"; // what is in its place, if anything is
};

// A path of a Folder.cfg and one of a preset move, and both templates exist.
Scenario Moving(const Name& name)
{
    return Scenario(name)
        .Before({{MachineHive, MachineValue("\"InstallPath\"=\"{TOOL}\"")}, {UserHive, UserValue("\"Path\"=\"{TOOL}{/2}previous\"")}})
        .Before({{"tool/previous/Booklet.tpl", ""}, {"tool/template/Booklet.tpl", ""}})
        .FolderCfg(Written(Old))
        .Preset(Stored(Old), Stored(New));
}

Scenario Staying(const Name& name) { return Moving(name).Preset(Stored(Old), Stored(Old)); }

Scenario Into(const Name& name, const Files& files) { return Moving(name).Before(files).Run({"I", "{tool}{/}results"}); }

std::vector<Call> Calls()
{
    const Text after = "FolderUpgrade-upgrade-after.txt";
    Text reset = Written(Old);
    ReplaceAll(reset, " description=\"\"", "");
    const Text manyFolders = "<l>{repeat:200000:<HotFolder path='{hot}{/}#'/>}</l>";
    return {
        {Moving("AllIsDoneAndTheLogFolderIsMade").Before({{LogPlace, Removed}}), 0},
        {Moving("TheWayBack").FolderCfg(Written(New)).Preset(Stored(New), Stored(Old)).Run({"u", "--limit", "600"}), 0},
        {Into("EarlierResultsAreReplaced", {{Folder + after, Text(9999, '.')}}), 0, "", Folder},
        {Into("TheFolderIsMissing", {}), 2, "", ""},
        {Into("TheFolderIsALink", {{Folder, "{link:elsewhere/d}"}, {"elsewhere/d/", ""}}), 2, "", ""},
        {Into("TheFolderCannotBeWrittenTo", {{Folder, ""}, {"tool/results#", "X"}}).AsOtherUser(), 2, "", ""},
        {Into("AReportIsALink", {{Folder + after, "{link:elsewhere/a}"}, {"elsewhere/a", "stays"}})
             .After({{"elsewhere/a", "stays"}})
             .NotUnderWine("Wine does not show links to files as links"),
         2, "", ""},
        {Moving("ABoxIsClosed").Before({{CfgPlace + "#", "R"}}).AsOtherUser(), 2, Refused},
        {Moving("ABoxWithAListIsClosed").Before({{CfgPlace + "#", "R"}, {"hot/B/[P]/Folder.cfg", ""}}).AsOtherUser(), 2, Refused},
        {Moving("WhatWasResetIsSaid").FolderCfg(reset), 2, Reset},
        {Staying("AnAccountWithoutAPath").Before({{UserHive, Removed}}), 2, "; nothing moves"},
        {Staying("TheProgramIsMissing"), 4, "\nFolderUpgrade\n  problem  could not be started (error 2: ", Logs, ""},
        {Staying("TheProgramDoesNotEnd").Run({"I", "--limit", "3"}), 4, Ended, Logs, "endless"},
        {Staying("ACheckDoesNotEnd").Before({{ListPlace, manyFolders}}).Run({"I", "--limit", "1"}), 4,
         "The time is over. A check was not finished.\n"},
    };
}

class CallsOfAnInstaller : public testing::TestWithParam<Call>
{
};

void PrintTo(const Call& call, std::ostream* stream) { *stream << call.scenario.name.what; }

void TryCall(Workstation& workstation, const Call& call)
{
    const Text suffix = IsWindowsProgram() ? ".exe" : "";
    const fs::path program = workstation.HostPath("tool/FolderUpgrade" + suffix);
    if (call.program != "FolderUpgrade")
        fs::remove(program);
    if (call.program == "endless")
        fs::copy((IsWindowsProgram() ? WindowsProgram().parent_path() : TOOL_DIR) / "tests" / ("endless" + suffix), program);
    std::vector<Text> arguments;
    for (const Text& argument : call.scenario.arguments)
        arguments.push_back(workstation.Expand(argument));
    const RunResult run = workstation.Start(arguments, "FolderUpgradeRun");
    EXPECT_EQ(call.status, run.process.exitStatus) << run.libraryLog;
    EXPECT_LT(run.process.seconds, 30);
    // The system refuses to write to a program that is still running.
    EXPECT_TRUE(call.program != "endless" || std::ofstream(program, std::ios::app));
    Files files = workstation.Snapshot();
    for (const auto& [place, text] : call.scenario.after)
        EXPECT_EQ(workstation.Expand(text), files[place]) << place;
    EXPECT_EQ(0U, files.count("elsewhere/d/FolderUpgrade-upgrade.log"));
    if (call.results.empty())
        return;
    const Text begin = call.results + (arguments[0] == "I" ? "FolderUpgrade-upgrade" : "FolderUpgrade-downgrade");
    Text report = files[begin + "-after.txt"];
    ReplaceAll(report, "\r\n", "\n");
    EXPECT_NE(Text::npos, report.find(workstation.Expand(call.said))) << report;
    const Text last = "\nExit status of FolderUpgradeRun: " + std::to_string(call.status) + "\n";
    EXPECT_EQ(report.size() - last.size(), report.find(last)) << report;
    EXPECT_TRUE(StartsWith(files[begin + "-before.txt"], "FolderUpgradeCheck "));
    const bool isStarted = call.status != 4 || call.program == "endless";
    EXPECT_EQ(isStarted ? files[LogPlace] : "", files[begin + ".log"]);
}

TEST_P(CallsOfAnInstaller, LeaveTheirResults)
{
    TestOn(GetParam().scenario, "FolderUpgradeRun", [](Workstation& workstation) { TryCall(workstation, GetParam()); });
}

INSTANTIATE_TEST_SUITE_P(Calls, CallsOfAnInstaller, testing::ValuesIn(Calls()),
                         [](const auto& call) { return call.param.scenario.name.what; });

TEST(CallOfAnInstaller, PrintsItsUsage)
{
    const std::vector<std::vector<Text>> wrong = {
        {}, {"V"}, {"I", "--limit"}, {"I", "--limit", "0"}, {"I", "--limit", "1h"}, {"I", "-x"}, {"I", "a", "b"}};
    Workstation workstation(false);
    for (const std::vector<Text>& arguments : wrong)
    {
        const RunResult run = workstation.Start(arguments, "FolderUpgradeRun");
        EXPECT_EQ(3, run.process.exitStatus);
        EXPECT_TRUE(IsWindowsProgram() || StartsWith(run.libraryLog, "Usage: FolderUpgradeRun I|U [--limit SECONDS] [FOLDER]\n"));
    }
}

} // namespace
