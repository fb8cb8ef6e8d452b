// What FolderUpgradeCheck reports for workstations with one problem. Every scenario shows that it
// names each change and changes nothing itself.
#include "tests/check_report.h"
#include "tests/scenarios/texts.h"

#include <sstream>

namespace
{

const Text Icon = "hot/A/[P]/hf_folder.ico";
const Text Ini = "hot/A/Desktop.ini";
const Text Jobs = "user/ORX/JPData";
const Text LogFolder = "user/ORX_Installers";
const char* const NoLinks = "Wine does not show links to files as links";
const char* const CannotEnter = "Wine cannot enter a directory that it cannot list";
const char* const NoRefusal = "Wine lets every user open a directory for writing";

const Text Moves = "change   Folder.cfg: " + MovedFrom + " -> " + MovedTo + "\n";
const Text NoTarget = "note     no such file: " + MovedTo;
const Text IsElsewhere = "note     template elsewhere: ";
const Text NoIcon = "note     no copy of the icon to replace: hf_folder.ico";
const Text NoDisabledIcon = "note     no copy of the icon to replace: hf_folder_disabled.ico";
const Text NoPresets = "note     there are no presets in {user}{/}ORX{/}JPData{/}";

// A workstation, and all its report lines. A line that ends in * continues in the system's own
// words.
struct Finding
{
    Scenario workstation;
    Text lines;
};

// A run would change nothing here, and there is nothing to report.
Scenario Done(const Name& name)
{
    return Scenario(name)
        .Before({{Icon, "{icon:hf_folder.ico}"},
                 {Ini, "[.ShellClassInfo]\r\nInfoTip=This folder has been configured as an ORX hot "
                       "folder.\r\n"
                       "IconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\n"},
                 {Ini + "#", "RS"},
                 {"hot/A#", "S"}})
        .FolderCfg(Written(MovedTo))
        .Preset(Stored("elsewhere"));
}

Scenario Moving(const Name& name)
{
    return Done(name).FolderCfg(Written(MovedFrom));
}

Text Changed(Text text, const Text& from, const Text& to)
{
    ReplaceAll(text, from, to);
    return text;
}

std::vector<Finding> Lists()
{
    const auto lists = [](const Name& name, const Text& folders)
    {
        Text list = "<HotFolders>";
        for (const char folder : folders)
            list += Text("<HotFolder path=\"{hot}{/}") + folder + "\"/>";
        return Done(name).Before({{ListPlace, list + "</HotFolders>"}});
    };
    return {
        {Done("WhatIsDoneIsNotReported"), ""},
        {Scenario("AnEmptyMachine")
             .Before({{ListPlace, Removed},
                      {LogPlace, Removed},
                      {Jobs + "/", Removed},
                      {MachineHive, Removed},
                      {UserHive, Removed}}),
         "note     there is no HotFolderList.cfg\n"
         "note     there will be no run log: there is no folder {user}{/}ORX_Installers{/}\n"
         "note     there are no presets, because there is no folder {user}{/}ORX{/}JPData{/}"},
        {Done("AListIsCutOff").Before({{ListPlace, "<HotFolders>"}}),
         "problem  HotFolderList.cfg: XML parsing error: 'no element found' at line 1"},
        {Done("AListCannotBeRead").Before({{Text(ListPlace) + "#", "0"}}).AsOtherUser(),
         "problem  HotFolderList.cfg: can't open file*"},
        {Done("TheListIsADirectory").Before({{ListPlace, Removed}, {Text(ListPlace) + "/", ""}}),
         "problem  HotFolderList.cfg: is not a file"},
        {Done("TheListsFolderCannotBeEntered").Before({{"machine/hotfolder#", "0"}}).AsOtherUser(),
         "problem  HotFolderList.cfg: its folder cannot be entered"},
        {lists("NoListedFolderIsThere", "BC"),
         "problem  none of the listed hot folders exists (another account? mapped drives?)\n"
         "note     listed hot folder does not exist: {hot}{/}B\nnote     listed hot folder does "
         "not exist: {hot}{/}C"},
        {lists("AListedFolderIsMissing", "AB"),
         "note     listed hot folder does not exist: {hot}{/}B"},
        {lists("AFolderIsListedTwice", "AA"), "note     hot folder is listed twice: {hot}{/}A"},
        {lists("AListIsEmpty", ""), "note     HotFolderList.cfg lists no hot folder"},
        {Done("ADirectoryHasTwoNames").Before({{"hot/B/", "{link:hot/A}"}}),
         "note     the same directory as {hot}{/}A"},
    };
}

std::vector<Finding> Registry()
{
    const Text path =
        "problem  registry value Path in HKEY_CURRENT_USER\\SOFTWARE[\\Wow6432Node]\\HF: ";
    const Text installPath = "problem  registry value InstallPath in "
                             "HKEY_LOCAL_MACHINE\\SOFTWARE[\\Wow6432Node]\\Vantorix\\QZA: ";
    const Text unknown = "missing, longer than 257 characters, or not readable; nothing moves";
    const Text below = "problem  the folder being installed is below the one being left; every "
                       "further run moves the paths of presets again";
    const auto withPath = [](const Name& name, const Text& value, const Text& letter = "I")
    {
        return Moving(name)
            .Before({{UserHive, UserValue("\"Path\"=\"" + value + "\"")}})
            .Run({letter});
    };
    const Text stays = IsElsewhere + MovedFrom;
    const Files noPresets = {{PresetPlace, Removed}};
    return {
        {Moving("PathIsMissing")
             .Before({{UserHive, Removed}, {"hot/B/[P]/Folder.cfg", Written(MovedFrom)}}),
         path + unknown + "\n" + NoIcon},
        {Done("OnlyAPresetAsksForPath").Before({{UserHive, Removed}, {CfgPlace, Removed}}),
         "note     no Folder.cfg\n" + NoDisabledIcon + "\n" + path + unknown},
        {Moving("InstallPathIsMissing").Before({{MachineHive, Removed}}), installPath + unknown},
        {Done("NothingAsksForInstallPath").Before({{MachineHive, Removed}}).Before(noPresets),
         IsElsewhere + MovedTo + "\n" + NoPresets},
        {withPath("PathEndsInASeparator", "{PREVIOUS}{/2}"),
         path + "ends in a separator; no template of a hot folder moves\n" + stays},
        {withPath("PathEndsInASeparatorOnTheWayBack", "{PREVIOUS}{/2}", "U"),
         path + "ends in a separator; it is doubled in the paths of hot folders\n" + stays},
        {withPath("PathIsEmpty", "").Preset("\xEF\xBB\xBF<p/>"),
         path + "empty; only templates stored without a folder move\n" + stays +
             "\nchange   .P{/}Presets{/}presets.xml: loses its byte-order mark"},
        {withPath("PathIsEmptyOnTheWayBack", "", "U"),
         path + "empty; templates move to the root of the drive\n" + stays},
        {withPath("PathHoldsAnAmpersand", "{PREVIOUS}&"),
         stays + "\n" + path + "holds & or <, which presets store in another form"},
        {withPath("WithoutPresetsAnAmpersandIsHarmless", "{PREVIOUS}&").Before(noPresets),
         stays + "\n" + NoPresets},
        {withPath("TheNewFolderIsBelowTheOld", "{APP}"), stays + "\n" + below},
        {withPath("TheOldFolderIsBelowTheNew", "{APP}{/2}template{/2}old", "U"),
         stays + "\n" + below},
        {withPath("WithoutPresetsAFolderBelowIsHarmless", "{APP}").Before(noPresets),
         stays + "\n" + NoPresets},
        {withPath("BothFoldersAreTheSame", "{APP}{/2}template")
             .FolderCfg(Written(MovedTo))
             .Preset(Stored(MovedTo)),
         ""},
        {Moving("InstallPathIsANumber")
             .Before({{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}}),
         "problem  Folder.cfg: left as it is (new path holds a character that XML cannot store)\n"
         "problem  the folder being installed holds a character that XML cannot store; no path of "
         "a preset moves"},
    };
}

std::vector<Finding> FolderCfgs()
{
    const Text privateDir = "hot/A/[P]";
    const Text hidden = Changed(Written(MovedTo), " description=\"\"", "");
    const Text utf16 = "{utf16}" + Changed(Changed(Written(MovedFrom), "UTF-8", "UTF-16"), "𝄞", "");
    const Files linkedDir = {{CfgPlace, Removed},
                             {Icon, Removed},
                             {privateDir + "/", "{link:elsewhere/d}"},
                             {"elsewhere/d/Folder.cfg", Written(MovedFrom)}};
    return {
        {Done("ItIsMissing").Before({{CfgPlace, Removed}}),
         "note     no Folder.cfg\n" + NoDisabledIcon},
        {Done("ItIsMalformed").FolderCfg("<a><b></a>"),
         "problem  Folder.cfg: XML parsing error: 'mismatched tag' at line 1\n" + NoDisabledIcon},
        {Done("ItIsALink").Before({{CfgPlace, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks),
         "problem  Folder.cfg: reached over a link\n" + NoDisabledIcon},
        {Done("ItIsADirectory").Before({{CfgPlace, Removed}, {CfgPlace + "/", ""}}),
         "problem  Folder.cfg: is not a file\n" + NoDisabledIcon},
        {Done("ThePrivateDirectoryIsALink").Before(linkedDir),
         "problem  [_ORX_HotFolder_]: reached over a link"},
        {Done("ThePrivateDirectoryCannotBeEntered").Before({{privateDir + "#", "0"}}).AsOtherUser(),
         "problem  [_ORX_HotFolder_]: cannot be entered"},
        {Done("TheHotFolderCannotBeEntered").Before({{"hot/A#", "0"}}).AsOtherUser(),
         "problem  the hot folder cannot be entered"},
        {Moving("ItsEncodingIsUnknown")
             .FolderCfg(
                 Minimal(MovedFrom, "<?xml version='1.0' encoding='x-unknown'?>", "\xC3\xA4")),
         "problem  Folder.cfg: left as it is (unknown encoding)\n" + NoDisabledIcon},
        {Moving("ItIsNotInUtf8").FolderCfg(utf16),
         Moves + "note     Folder.cfg: comes out as UTF-8\n" + NoTarget},
        {Moving("NothingIsAtTheNewPath"), Moves + NoTarget},
        {Done("EnabledShowsAsDisabled").FolderCfg(hidden),
         "problem  Folder.cfg: lacks the attribute \"description\", so the enabled folder shows as "
         "disabled\n" +
             NoDisabledIcon},
        {Done("ItIsDisabledAnyway").FolderCfg(Changed(hidden, "Enable=\"1\"", "Enable=\"0\"")),
         NoDisabledIcon},
        {Done("TheTemplateIsElsewhere").FolderCfg(Written("{hot}{/}T")), IsElsewhere + "{hot}{/}T"},
        {Done("ThereIsNoIconToReplace").Before({{Icon, Removed}}), NoIcon},
    };
}

// What a Folder.cfg loses when its template moves.
std::vector<Finding> Losses()
{
    const Text start = "<HotFolder ";
    const Text end = "<PreflightSettings>\n";
    const Text entry = "<KEYVALUE Key=\"B\"";
    const Text lostEntry = "loses <KEYVALUE Key=\"B\" Value=\"2\" KeyDisplayValue=\"two\" "
                           "LocDisplayValue=\"zwei\"> in <JobSetting>";
    const Text defaults = "; the rewrite sets it and all that follow it to their defaults";
    Text alike;
    for (int i = 0; i < 2000; ++i)
        alike += "<r kind=\"alike\" number=\"" + std::to_string(i) + "\" empty=\"\"/>";
    const auto changed = [](const Name& name, const Text& from, const Text& to, const Text& loss)
    {
        return Finding{Moving(name).FolderCfg(Changed(Written(MovedFrom), from, to)),
                       (loss.empty() ? "" : "problem  Folder.cfg: " + loss + "\n") + Moves +
                           NoTarget};
    };
    const auto disabled = [](Finding finding)
    {
        finding.lines += "\n" + NoDisabledIcon;
        return finding;
    };
    return {
        disabled(changed("ADescription", " description=\"\"", "",
                         "lacks the attribute \"description\"" + defaults +
                             " (the folder comes out disabled)")),
        changed("AQuickset", " Quickset=\"q\"", "", "lacks the attribute \"Quickset\"" + defaults),
        disabled(changed("AWordForAFlag", "Enable=\"1\"", "Enable=\"true\"",
                         "Enable=\"true\" comes out as \"0\"")),
        changed("ANumberWithALetter", "server_version=\"-5\"", "server_version=\"5b\"",
                "server_version=\"5b\" comes out as \"5\""),
        changed("ASpaceIsNoLoss", "Centralized=\"1\"", "Centralized=\"1 \"", ""),
        changed("AnUnknownAttribute", start, start + "mine=\"7\" ",
                "loses the attribute mine=\"7\""),
        changed("TheNameOfTheRoot", "HotFolder", "Mine",
                "its root <Mine> comes out as <HotFolder>"),
        changed("AnUnknownElement", end, "<Mine><a/></Mine>" + end,
                "loses <Mine> in <HotFolder>\nproblem  Folder.cfg: loses <a> in <Mine>"),
        changed("AnUnknownAttributeOfAnEntry", entry, entry + " Mine=\"\"",
                "loses <KEYVALUE Key=\"B\" Mine=\"\" Value=\"2\" KeyDisplayValue=\"two\" "
                "LocDisplayValue=\"zwei\"> in <JobSetting>"),
        changed("ARepeatedKey", entry, entry + " Value=\"1\"/>" + entry, lostEntry),
        changed("ARepeatedSection", "  " + end, "  <Paths/>" + end, "loses <Paths> in <HotFolder>"),
        changed("AText", end, "Note " + end, "loses the text \"Note\" in <HotFolder>"),
        changed("AnInstruction", end, "<?mine?>" + end, "loses the instruction <?mine?>"),
        changed("AnEntity", start, "<!DOCTYPE HotFolder [<!ENTITY e \"text\">]>" + start,
                "loses its document type, and with it the entities in its texts"),
        changed("ACommentIsNoLoss", end, "<!-- c -->" + end, ""),
        changed("ManyEqualElementsAreNoLoss", "<a/>", alike, ""),
    };
}

std::vector<Finding> Icons()
{
    const Text noSource = "problem  source icon missing: {tool}{/}BundleIcons{/}";
    return {
        {Done("TheCopyIsRefused")
             .Before({{Icon, "old"}, {Icon + "#", "R"}, {"hot/A/[P]#", "X"}})
             .AsOtherUser(),
         "problem  hf_folder.ico: the copy would be refused"},
        {Done("TheSourceCannotBeRead").Before({{"tool/hf_folder.ico#", "0"}}).AsOtherUser(),
         "problem  hf_folder.ico: the copy would be refused"},
        {Done("TheSourcesAreMissing")
             .Before({{"tool/BundleIcons#", "0"},
                      {"hot/B/[P]/hf_folder_disabled.ico", ""},
                      {"hot/C/[P]/hf_folder_disabled.ico", ""}})
             .Run({"U"})
             .AsOtherUser(),
         noSource + "hf_folder.ico\nchange   Folder.cfg: " + MovedTo + " -> " + MovedFrom +
             "\nnote     no such file: " + MovedFrom + "\n" + noSource +
             "hf_folder_disabled.ico\nnote     no Folder.cfg\nnote     no Folder.cfg"},
        {Done("TheIconIsALink").Before({{Icon, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks),
         "problem  hf_folder.ico: reached over a link"},
        {Done("DesktopIniIsALink")
             .Before({{Ini, "{link:elsewhere/a}"}, {Ini + "#", Removed}})
             .NotUnderWine(NoLinks),
         "problem  Desktop.ini: left as it is (reached over a link)"},
        {Done("DesktopIniBelongsToAnotherUser")
             .Before({{Ini, "[.ShellClassInfo]"}, {Ini + "#", "X"}})
             .AsOtherUser(),
         "problem  Desktop.ini: cannot be opened for reading and writing\nproblem  Desktop.ini: "
         "its attributes cannot be changed"},
        {Done("DesktopIniCannotBeCreated")
             .Before({{Ini, Removed}, {Ini + "#", Removed}, {"hot/A#", "SX"}})
             .AsOtherUser()
             .NotUnderWine(NoRefusal),
         "problem  Desktop.ini: cannot be created, because the hot folder cannot be written to"},
        {Done("TheHotFolderBelongsToAnotherUser")
             .Before({{"hot/A#", "X"}})
             .AsOtherUser()
             .NotUnderWine(NoRefusal),
         "problem  hot folder: its attributes cannot be changed"},
        {Done("KeysAndAttributesDiffer")
             .Before(
                 {{Ini, "[.ShellClassInfo]\r\nIconFile=x\r\n"}, {Ini + "#", "H"}, {"hot/A#", "H"}}),
         "change   Desktop.ini: InfoTip, IconFile\nchange   Desktop.ini: attributes HIDDEN -> "
         "READONLY SYSTEM\n"
         "change   hot folder: attributes HIDDEN -> HIDDEN SYSTEM"},
    };
}

std::vector<Finding> PresetsAndLogs()
{
    const Text problem = "problem  .P{/}Presets{/}presets.xml: ";
    const Text change = "change   .P{/}Presets{/}presets.xml: ";
    const Text comesOut = "comes out as UTF-8";
    const Text noLog = "problem  there will be no run log: ";
    const Text jobs = "{user}{/}ORX{/}JPData{/}";
    return {
        {Done("ThereIsNoPreset").Before({{PresetPlace, Removed}}), NoPresets},
        {Moving("NothingCanBeRead")
             .Before({{PresetPlace + "#", "0"}, {CfgPlace + "#", "0"}})
             .AsOtherUser(),
         "problem  Folder.cfg: can't open file*\n" + NoDisabledIcon + "\n" + problem +
             "cannot be opened for reading (can't open file*"},
        {Moving("EverythingIsReadOnly")
             .Before({{PresetPlace + "#", "R"}, {CfgPlace + "#", "R"}, {Text(LogPlace) + "#", "R"}})
             .AsOtherUser(),
         noLog +
             "can't open file*\nproblem  Folder.cfg: cannot be opened for writing (can't open "
             "file*\n" +
             problem + "cannot be opened for writing (can't open file*"},
        {Done("WhatStaysMayBeReadOnly").Before({{CfgPlace + "#", "R"}}).AsOtherUser(), ""},
        {Done("AJobPresetDirCannotBeEntered").Before({{Jobs + "/.P#", "0"}}).AsOtherUser(),
         problem + jobs + ".P cannot be entered"},
        {Done("JPDataCannotBeEntered").Before({{Jobs + "#", "0"}}).AsOtherUser(),
         "problem  " + jobs + " cannot be entered"},
        {Done("JPDataCannotBeListed")
             .Before({{Jobs + "#", "L"}})
             .AsOtherUser()
             .NotUnderWine(CannotEnter),
         "problem  " + jobs + " cannot be listed"},
        {Done("APresetIsADirectory").Before({{PresetPlace, Removed}, {PresetPlace + "/", ""}}),
         problem + "reached over a link, or not a file"},
        {Done("PresetsIsALink")
             .Before({{PresetPlace, Removed},
                      {Jobs + "/.P/Presets/", "{link:elsewhere/d}"},
                      {"elsewhere/d/", ""}}),
         problem + "reached over a link, or not a file"},
        {Done("APresetIsNotText").Preset(Text("\xFF\xFE\0", 3)),
         problem + "left as it is (cannot be decoded)"},
        {Done("AByteIsWrong").Preset("<p>\xC3\xA4 \xE4</p>"),
         problem + "is not UTF-8, so the whole file is read as Latin-1\n" + change + comesOut},
        {Done("APresetDeclaresLatin1")
             .Preset("<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><p>\xE4</p>"),
         problem + "declares the encoding ISO-8859-1, but comes out as UTF-8\n" + change +
             comesOut},
        {Done("TwoPathsMove").Preset(Stored(MovedFrom) + Stored(MovedFrom)), change + "2 paths"},
        {Done("AByteOrderMarkIsLost").Preset("\xEF\xBB\xBF<p/>"),
         change + "loses its byte-order mark"},
        {Done("AByteOrderMarkAndLineEndsAreLost").Preset("\xEF\xBB\xBF<p>\n</p>"),
         change + "loses its byte-order mark" +
             (IsWindowsProgram() ? ", and its line ends become CR LF" : "")},
        {Done("TheEncodingChanges").Preset("{utf16}<p>ä</p>"),
         change + "comes out as UTF-8, without byte-order mark"},
        {Done("LineEndsChange").Preset("<p>\n</p>"),
         IsWindowsProgram() ? change + "its line ends become CR LF" : ""},
        {Done("TheLogIsALink").Before({{LogPlace, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks),
         noLog + "it is reached over a link: {user}{/}ORX_Installers{/}UpgradeDowngrade.log"},
        {Done("TheLogFolderCannotBeEntered").Before({{LogFolder + "#", "0"}}).AsOtherUser(),
         noLog + "its folder cannot be entered: {user}{/}ORX_Installers{/}"},
        {Done("TheLogFolderBelongsToAnotherUser")
             .Before({{LogPlace, Removed}, {LogFolder + "/", ""}, {LogFolder + "#", "X"}})
             .AsOtherUser()
             .NotUnderWine(NoRefusal),
         noLog + "its folder cannot be written to: {user}{/}ORX_Installers{/}"},
        {Done("AFolderHasTheLogsName").Before({{LogPlace, Removed}, {Text(LogPlace) + "/", ""}}),
         "note     there will be no run log: something else has its name: "
         "{user}{/}ORX_Installers{/}UpgradeDowngrade.log"},
    };
}

class Findings : public testing::TestWithParam<Finding>
{
};

void PrintTo(const Finding& finding, std::ostream* stream)
{
    *stream << finding.workstation.name.what;
}

TEST_P(Findings, AreReported)
{
    const auto& [scenario, lines] = GetParam();
    TestOn(
        scenario, "FolderUpgradeCheck",
        [&, &scenario = scenario, &lines = lines](Workstation& workstation)
        {
            const CheckReport report(workstation,
                                     workstation.Start(scenario.arguments, "FolderUpgradeCheck"));
            Text actual;
            std::istringstream text(report.text);
            for (Text line; std::getline(text, line);)
            {
                line.erase(line.find_last_not_of('\r') + 1);
                if (line.find("can't open file '") != Text::npos)
                    line.replace(line.find(" '"), Text::npos, "*");
                actual += StartsWith(line, "  ") ? line.substr(2) + "\n" : ""; // without the titles
            }
            EXPECT_EQ(workstation.Expand(lines.empty() ? "" : lines + "\n"), actual) << report.text;
        });
}

TEST(Check, ReportsInBlocks)
{
    Workstation workstation(false);
    workstation.LayOut(WorkstationBefore(
        Moving("")
            .FolderCfg(Changed(Written(MovedFrom), "Centralized=\"1\"", "Centralized=\"2x\""))
            .Preset(Stored(MovedFrom))
            .Before({{Icon, "old"}, {LogPlace, Removed}})));
    Text report = CheckReport(workstation, workstation.Start({"i"}, "FolderUpgradeCheck")).text;
    ReplaceAll(report, "\r\n", "\n");
    const size_t head = report.find('\n') + 1;
    const testing::Matcher<const Text&> isHead =
        testing::MatchesRegex("FolderUpgradeCheck [0-9]+\\.[0-9]+\\.[0-9]+, upgrade, 20[0-9-]+ "
                              "[0-9]+:[0-9]+, [^,]+, (not )?elevated\n");
    EXPECT_TRUE(isHead.Matches(report.substr(0, head))) << report;
    EXPECT_EQ(workstation.Expand("From {previous} to {default}\n\nWorkstation\n"
                                 "  note     there will be no run log: there is no folder "
                                 "{user}{/}ORX_Installers{/}\n\n{hot}{/}A\n"
                                 "  problem  Folder.cfg: Centralized=\"2x\" comes out as \"0\"\n"
                                 "  change   Folder.cfg: " +
                                 MovedFrom + " -> " + MovedTo +
                                 "\n  change   hf_folder.ico\n  note     no such file: " + MovedTo +
                                 "\n\nJob presets\n  change   .P{/}Presets{/}presets.xml: 1 "
                                 "path\n\n3 changes, 1 problem, 2 notes\n"),
              report.substr(head));
}

TEST(Check, WritesToAFile)
{
    Workstation workstation(false);
    workstation.LayOut(
        WorkstationBefore(Moving("").Before({{"hot/Bericht ä 版.txt", Text(10000, '.')}})));
    const CheckReport report(workstation, workstation.Start({"U"}, "FolderUpgradeCheck"));
    const Text file = workstation.Expand("{hot}{/}Bericht ä 版.txt");
    EXPECT_EQ(0, workstation.Start({"u", file}, "FolderUpgradeCheck").process.exitStatus);
    const Text written = ReadFile(workstation.HostPath("hot/Bericht ä 版.txt"));
    EXPECT_EQ(report.text.substr(report.text.find("From ")),
              written.substr(written.find("From "))); // without the time

    const RunResult run =
        workstation.Start({"U", workstation.Expand("{hot}{/}none{/}a.txt")}, "FolderUpgradeCheck");
    EXPECT_EQ(2, run.process.exitStatus);
    EXPECT_EQ("", run.output);
    const Text complaint = workstation.Expand(
        "FolderUpgradeCheck: the report cannot be written to {hot}{/}none{/}a.txt\n");
    EXPECT_EQ(IsWindowsProgram() ? "" : complaint, run.libraryLog);
}

TEST(Check, PrintsItsUsage)
{
    const Text usage = "Usage: FolderUpgradeCheck I|U [FILE]\n"
                       "Reports what FolderUpgrade would change with the same switch, and what "
                       "would prevent a change, to the standard "
                       "output or to FILE.\n"
                       "Exit status: 0 nothing to do, 1 changes, 2 problems, 3 wrong arguments.\n";
    Workstation workstation(false);
    for (const std::vector<Text>& wrong :
         {std::vector<Text>{}, {"V"}, {"/I"}, {"I", "report", "V"}})
    {
        const RunResult run = workstation.Start(wrong, "FolderUpgradeCheck");
        EXPECT_EQ(3, run.process.exitStatus);
        EXPECT_EQ("", run.output);
        EXPECT_EQ(IsWindowsProgram() ? "" : usage, run.libraryLog);
    }
}

#define TEST_FINDINGS(function)                                                                    \
    INSTANTIATE_TEST_SUITE_P(function, Findings, testing::ValuesIn(function()),                    \
                             [](const auto& finding)                                               \
                             { return finding.param.workstation.name.what; })

TEST_FINDINGS(Lists);
TEST_FINDINGS(Registry);
TEST_FINDINGS(FolderCfgs);
TEST_FINDINGS(Losses);
TEST_FINDINGS(Icons);
TEST_FINDINGS(PresetsAndLogs);

} // namespace
