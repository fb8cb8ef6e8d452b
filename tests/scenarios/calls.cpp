// FolderUpgradeRun: how it ends and what it leaves, and that it waits for nobody. The usage of the
// programs that have one.
#include "tests/scenarios/texts.h"

#include <regex>

namespace
{

const Text Logs = "user/ORX_Installers/";
const Text Folder = "tool/results/";
const Text Reset = "\nLost or reset by the run\n  problem  {hot}{/}A: Folder.cfg: ";
const Text Ended =
    "\n  problem  crashed, or was ended before it had finished\n  problem  the time is over, ";

struct Call
{
    Scenario scenario;
    int status;
    Text said = "";                 // a part of the second report
    Text results = Logs;            // the place of what is left, if there is one
    Text program = "FolderUpgrade"; // what is in its place, if anything
};

// A path of a Folder.cfg and one of a preset move, and both templates exist.
Scenario Moving(const Text& name, const Files& files = {})
{
    return Scenario(name, {{CfgPlace, Written(MovedFrom)}})
        .File(PresetPlace, Stored(MovedFrom), Stored(MovedTo))
        .Before(files);
}

Scenario Into(const Text& name, const Files& files)
{
    return Moving(name, files).Run({"I", "{tool}{/}results"});
}

std::vector<Call> Calls()
{
    const Text after = "FolderUpgrade-upgrade-after.txt";
    const Text reset = Replaced(Written(MovedFrom), " description=\"\"", "");
    const Files stays = {{PresetPlace, Stored(MovedFrom)}};
    const Text manyFolders = "<l>" + Times(200000, "<HotFolder path='/missing/#'/>") + "</l>";
    return {
        {Moving("AllIsDoneAndTheLogFolderIsMade", {{LogPlace, Removed}}), 0, "s, 1 note\n"},
        {Moving("TheWayBack", {{CfgPlace, Written(MovedTo)}})
             .File(PresetPlace, Stored(MovedTo), Stored(MovedFrom))
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
             .NotUnderWine(NoLinks),
         2, "", ""},
        {Moving("ABoxWithAListIsClosed", {{CfgPlace + "#", "R"}, {"hot/B/[P]/Folder.cfg", ""}})
             .AsOtherUser(),
         2, "  problem  Folder.cfg: cannot be opened for writing"},
        {Moving("WhatWasResetIsSaid", {{CfgPlace, reset}}), 2, Reset},
        {Moving("AnAccountWithoutAPath", {{UserHive, Removed}}).After(stays), 2, "; nothing moves"},
        {Moving("TheProgramIsMissing").After(stays), 4,
         "\nFolderUpgrade\n  problem  could not be started (error 2: ", Logs, ""},
        {Moving("TheProgramDoesNotEnd").After(stays).Run({"I", "--limit", "6"}), 4, Ended, Logs,
         "endless"},
        {Moving("ACheckDoesNotEnd", {{ListPlace, manyFolders}})
             .After(stays)
             .Run({"I", "--limit", "1"}),
         4, "The time is over. A check was not finished.\n"},
    };
}

class CallsOfAnInstaller : public testing::TestWithParam<Call>
{
};

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
    const RunResult run = workstation.Start("FolderUpgradeRun", call.scenario.arguments);
    EXPECT_EQ(call.status, run.status) << run.libraryLog;
    // The system refuses to write to a program that is still running.
    EXPECT_TRUE(call.program != "endless" || std::ofstream(program, std::ios::app));
    Files files = workstation.Snapshot();
    for (const auto& [place, text] : call.scenario.after)
        EXPECT_EQ(workstation.Expand(text), files[place]) << place;
    EXPECT_EQ(0U, files.count("elsewhere/d/FolderUpgrade-upgrade.log"));
    if (call.results.empty())
        return;
    const bool isUpgrade = call.scenario.arguments[0] == "I";
    const Text results = call.results + "FolderUpgrade-" + (isUpgrade ? "upgrade" : "downgrade");
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

TEST(Check, WritesToAFile)
{
    const Text check = "FolderUpgradeCheck";
    const Text place = "hot/A/Bericht ä 版.txt";
    Workstation workstation;
    workstation.LayOut(WorkstationBefore(
        Scenario("", DoneFolder("A", Written(MovedTo)))
            .Before({{PresetPlace, Stored(MovedTo)}, {place, Text(10000, '.')}})));
    EXPECT_EQ(0, workstation.Start(check, {"i", workstation.HostPath(place).u8string()}).status);
    const Text report = Replaced(ReadFile(workstation.HostPath(place)), "\r", "");
    const Text rest =
        workstation.Expand("\nFrom {previous} to {default}\n\n0 changes, 0 problems, 0 notes\n");
    EXPECT_TRUE(std::regex_match(
        Replaced(report, rest, ";"),
        std::regex("FolderUpgradeCheck [0-9]+\\.[0-9]+\\.[0-9]+, upgrade, 20[0-9-]+ "
                   "[0-9]+:[0-9]+, [^,]+, (not )?elevated;")))
        << report;
    const RunResult refused = workstation.Start(check, {"i", "{hot}{/}none{/}a.txt"});
    EXPECT_EQ(2, refused.status);
    EXPECT_EQ("", refused.output);
    EXPECT_EQ(workstation.Expand(
                  "FolderUpgradeCheck: the report cannot be written to {hot}{/}none{/}a.txt\n"),
              refused.libraryLog);
}

TEST(Usage, IsPrinted)
{
    const Workstation workstation;
    const Text check = "FolderUpgradeCheck";
    const Files usages = {
        {check, workstation.Start(check, {"--help"}).output},
        {"FolderUpgradeRun", "Usage: FolderUpgradeRun I|U [--limit SECONDS] [FOLDER]\n"}};
    EXPECT_TRUE(StartsWith(usages.at(check),
                           "Usage: FolderUpgradeCheck I|U [--from FOLDER] [--to FOLDER] [FILE]"));
    for (const char* wrong :
         {"Check", "Check|V", "Check|/I", "Check|I|report|V", "Check|I|--to", "Check|I||", "Run",
          "Run|V", "Run|I|--limit", "Run|I|--limit|0", "Run|I|--limit|1h", "Run|I|-x", "Run|I|a|b"})
    {
        std::istringstream text(Text("FolderUpgrade") + wrong);
        std::vector<Text> words;
        for (Text word; std::getline(text, word, '|');)
            words.push_back(word);
        const RunResult run = workstation.Start(words[0], {words.begin() + 1, words.end()});
        EXPECT_EQ(3, run.status) << wrong;
        EXPECT_EQ("", run.output);
        EXPECT_TRUE(StartsWith(run.libraryLog, usages.at(words[0]))) << wrong;
    }
    EXPECT_TRUE(std::regex_match(workstation.Start(check, {"--version"}).output,
                                 std::regex("FolderUpgradeCheck [0-9.]+\r?\n")));
}

} // namespace
