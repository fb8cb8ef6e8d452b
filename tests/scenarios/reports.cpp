// What FolderUpgradeCheck reports. Every other scenario shows that it counts each change and
// changes nothing itself.
#include "tests/scenarios/texts.h"

#include <gmock/gmock.h>

namespace
{

const Text Jobs = "user/ORX/JPData";
const Text LogFolder = "user/ORX_Installers";
const Text Ini = "hot/A/Desktop.ini";
const char* const NoLinks = "Wine does not show links to files as links";
const char* const NoRefusal = "Wine lets every user open or list a directory";

Text Cfg(char name)
{
    return Replaced(CfgPlace, "A", Text(1, name));
}

Text PresetOf(char name)
{
    return Replaced(PresetPlace, ".P", Text(1, name));
}

// A hot folder in which a run changes nothing.
Files DoneFolder(char name)
{
    const Text folder = Text("hot/") + name;
    return {
        {folder + "#", "S"},
        {folder + "/Desktop.ini#", "RS"},
        {folder + "/Desktop.ini",
         "[.ShellClassInfo]\r\nInfoTip=This folder has been configured as an ORX hot folder.\r\n"
         "IconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\n"},
        {folder + "/[P]/hf_folder.ico", "{icon:hf_folder.ico}"},
        {Cfg(name), Written(MovedTo)}};
}

// A run would change nothing here, and there is nothing to report.
Scenario Done(const Text& name)
{
    return Scenario(name).Before(DoneFolder('A')).Preset(Stored("elsewhere"));
}

std::vector<Scenario> Machines()
{
    const auto listed = [](const Text& name, const Text& folders)
    {
        Text list = "<HotFolders>";
        for (const char folder : folders)
            list += Text("<HotFolder path=\"{hot}{/}") + folder + "\"/>";
        return Done(name).Before({{ListPlace, list + "</HotFolders>"}});
    };
    return {
        Done("WhatIsDoneIsNotReported").IsReported(""),
        Scenario("AnEmptyMachine")
            .Before({{ListPlace, Removed}, {LogPlace, Removed}, {Jobs + "/", Removed}})
            .Before({{MachineHive, Removed}, {UserHive, Removed}})
            .IsReported(R"(
Workstation
  note     there is no HotFolderList.cfg
  note     there will be no run log: there is no folder {user}{/}ORX_Installers{/}
Job presets
  note     there are no presets, because there is no folder {user}{/}ORX{/}JPData{/})"),
        Done("AListIsCutOff").Before({{ListPlace, "<HotFolders>"}}).IsReported(R"(
Workstation
  problem  HotFolderList.cfg: XML parsing error: 'no element found' at line 1)"),
        Done("TheListIsADirectory")
            .Before({{ListPlace, Removed}, {ListPlace + "/", ""}})
            .IsReported(R"(
Workstation
  problem  HotFolderList.cfg: is not a file)"),
        listed("AListIsEmpty", "").IsReported(R"(
Workstation
  note     HotFolderList.cfg lists no hot folder)"),
        listed("NoListedFolderIsThere", "BC").IsReported(R"(
Workstation
  problem  none of the listed hot folders exists (another account? mapped drives?)
  note     listed hot folder does not exist: {hot}{/}B
  note     listed hot folder does not exist: {hot}{/}C)"),
        listed("AListedFolderIsMissingTwiceOrHasTwoNames", "AABC")
            .Before({{"hot/C/", "{link:hot/A}"}})
            .IsReported(R"(
Workstation
  note     listed hot folder does not exist: {hot}{/}B
  note     hot folder is listed twice: {hot}{/}A
{hot}{/}C
  note     the same directory as {hot}{/}A)"),
        Done("TheLogIsALink")
            .Before({{LogPlace, "{link:elsewhere/a}"}})
            .NotUnderWine(NoLinks)
            .IsReported(R"(
Workstation
  problem  there will be no run log: it is reached over a link: {log})"),
        Done("AFolderHasTheLogsName")
            .Before({{LogPlace, Removed}, {LogPlace + "/", ""}})
            .IsReported(R"(
Workstation
  note     there will be no run log: something else has its name: {log})"),
        Done("TheLogFolderBelongsToAnotherUser")
            .Before({{LogPlace, Removed}, {LogFolder + "/", ""}, {LogFolder + "#", "X"}})
            .AsOtherUser()
            .NotUnderWine(NoRefusal)
            .IsReported(R"(
Workstation
  problem  there will be no run log: its folder cannot be written to: {user}{/}ORX_Installers{/})"),
        Done("TheListCannotBeRead").Before({{ListPlace + "#", "0"}}).AsOtherUser().IsReported(R"(
Workstation
  problem  HotFolderList.cfg: can't open file*)"),
        Done("NoFolderCanBeEntered")
            .Before({{"machine/hotfolder#", "0"}, {LogFolder + "#", "0"}, {Jobs + "#", "0"}})
            .AsOtherUser()
            .IsReported(R"(
Workstation
  problem  HotFolderList.cfg: its folder cannot be entered
  problem  there will be no run log: its folder cannot be entered: {user}{/}ORX_Installers{/}
Job presets
  problem  {user}{/}ORX{/}JPData{/} cannot be entered)"),
        Done("JPDataCannotBeListed")
            .Before({{Jobs + "#", "L"}})
            .AsOtherUser()
            .NotUnderWine(NoRefusal)
            .IsReported(R"(
Job presets
  problem  {user}{/}ORX{/}JPData{/} cannot be listed)"),
    };
}

// The registry values of the two template folders.
std::vector<Scenario> Values()
{
    const Text stays = R"(
{hot}{/}A
  note     template elsewhere: {previous}{/}Booklet.tpl)";
    const Text below = stays + R"(
Job presets
  problem  the folder being installed is below the one being left; every further run moves the)"
                               " paths of presets again";
    const Text noPresets = R"(
Job presets
  note     there are no presets in {user}{/}ORX{/}JPData{/})";
    const auto with = [](const Text& name, const Files& hives)
    {
        return Done(name).FolderCfg(Written(MovedFrom)).Before(hives);
    };
    const auto withPath = [&](const Text& name, const Text& path)
    {
        return with(name, {{UserHive, UserValue("\"Path\"=\"" + path + "\"")}});
    };
    return {
        with("PathIsMissing", {{UserHive, Removed}}).Before(DoneFolder('B')).IsReported(R"(
{hot}{/}A
  problem  {Path}: {unknown})"),
        with("OnlyAPresetAsksForPath", {{UserHive, Removed}, {CfgPlace, Removed}}).IsReported(R"(
{hot}{/}A
  note     no Folder.cfg
  note     no copy of the icon to replace: hf_folder_disabled.ico
Job presets
  problem  {Path}: {unknown})"),
        with("InstallPathIsMissing", {{MachineHive, Removed}}).IsReported(R"(
{hot}{/}A
  problem  {InstallPath}: {unknown})"),
        with("NothingAsksForInstallPath", {{MachineHive, Removed}, {PresetPlace, Removed}})
            .FolderCfg(Written("{hot}{/}T"))
            .IsReported(Replaced(stays, "{previous}{/}Booklet.tpl", "{hot}{/}T") + noPresets),
        withPath("PathEndsInASeparator", "{PREVIOUS}{/2}")
            .IsReported(R"(
Workstation
  problem  {Path}: ends in a separator; no template of a hot folder moves)" +
                        stays),
        withPath("PathEndsInASeparatorOnTheWayBack", "{PREVIOUS}{/2}").Run({"U"}).IsReported(R"(
Workstation
  problem  {Path}: ends in a separator; it is doubled in the paths of hot folders)" + stays),
        withPath("PathIsEmpty", "")
            .IsReported(R"(
Workstation
  problem  {Path}: empty; only templates stored without a folder move)" +
                        stays),
        withPath("PathIsEmptyOnTheWayBack", "").Run({"U"}).IsReported(R"(
Workstation
  problem  {Path}: empty; templates move to the root of the drive)" + stays),
        withPath("PathHoldsAnAmpersand", "{PREVIOUS}&").IsReported(stays + R"(
Job presets
  problem  {Path}: holds & or <, which presets store in another form)"),
        withPath("TheNewFolderIsBelowTheOld", "{APP}").IsReported(below),
        withPath("TheOldFolderIsBelowTheNew", "{APP}{/2}template{/2}old")
            .Run({"U"})
            .IsReported(below),
        withPath("WithoutPresetsAFolderBelowIsHarmless", "{APP}&")
            .Before({{PresetPlace, Removed}})
            .IsReported(stays + noPresets),
        withPath("BothFoldersAreTheSame", "{APP}{/2}template")
            .FolderCfg(Written(MovedTo))
            .Preset(Stored(MovedTo))
            .IsReported(""),
        with("InstallPathIsANumber",
             {{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}})
            .IsReported(R"(
{hot}{/}A
  problem  Folder.cfg: left as it is (new path holds a character that XML cannot store)
Job presets
  problem  the folder being installed holds a character that XML cannot store; no path of a)"
                        " preset moves"),
    };
}

// What is lost when a template moves.
Scenario Losses()
{
    const Text root = "<HotFolder ";
    const Text end = "<PreflightSettings>\n";
    const Text entry = "<KEYVALUE Key=\"B\"";
    Text cfg = Written(MovedFrom);
    Text alike;
    for (int i = 0; i < 2000; ++i)
        alike += "<r kind=\"alike\" number=\"" + std::to_string(i) + "\" empty=\"\"/>";
    for (const auto& [from, to] :
         Files{{" Quickset=\"q\"", ""},
               {"\"-5\"", "\"5b\""},
               {"Centralized=\"1\"", "Centralized=\"1 \""}, // no loss
               {root, "<!DOCTYPE H [<!ENTITY e \"t\">]>\n<?top?>" + root + "mine=\"7\" "},
               {"<a/>", alike}, // no loss
               {entry, entry + " Mine=\"\" Value=\"1\"/>" + entry},
               {end, "<Mine><b/></Mine><Paths/>Note <?mine?><!-- no loss -->" + end}})
        cfg = Replaced(cfg, from, to);
    return Scenario("Losses")
        .Before({{Cfg('A'), Replaced(cfg, "HotFolder", "Old")},
                 {Cfg('B'), Replaced(Written(MovedFrom), " description=\"\"", "")},
                 {Cfg('C'), Replaced(Written(MovedFrom), "Enable=\"1\"", "Enable=\"true\"")},
                 {PresetPlace, ""}})
        .IsReported(Replaced(
            Replaced(R"(
{hot}{/}A
  problem  Folder.cfg: loses its document type, and with it the entities in its texts
  problem  Folder.cfg: loses the instruction <?top?>
  problem  Folder.cfg: its root <Old> comes out as <HotFolder>
  problem  Folder.cfg: lacks the attribute "Quickset"; {defaults}
  problem  Folder.cfg: server_version="5b" comes out as "5"
  problem  Folder.cfg: loses the attribute mine="7"
  problem  Folder.cfg: loses <KEYVALUE Key="B" Mine="" Value="1"> in <JobSetting>
  problem  Folder.cfg: loses {entry} in <JobSetting>
  problem  Folder.cfg: loses <Mine> in <Old>
  problem  Folder.cfg: loses <b> in <Mine>
  problem  Folder.cfg: loses <Paths> in <Old>
  problem  Folder.cfg: loses the text "Note" in <Old>
  problem  Folder.cfg: loses the instruction <?mine?>
{moves}
  note     no copy of the icon to replace: hf_folder.ico
{hot}{/}B
  problem  Folder.cfg: lacks the attribute "description"; {defaults} (the folder comes out disabled)
{moves}
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}C
  problem  Folder.cfg: Enable="true" comes out as "0"
{moves}
  note     no copy of the icon to replace: hf_folder_disabled.ico)",
                     "{defaults}", "the rewrite sets it and all that follow it to their defaults"),
            "{entry}", entry + " Value=\"2\" KeyDisplayValue=\"two\" LocDisplayValue=\"zwei\">"));
}

std::vector<Scenario> FoldersAndPresets()
{
    const Text hidden = Replaced(Written(MovedTo), " description=\"\"", "");
    const Text utf16 = Replaced(Replaced(Written(MovedFrom), "UTF-8", "UTF-16"), "𝄞", "");
    return {
        Losses(),
        Done("FolderCfgs")
            .FolderCfg(Written(MovedFrom))
            .Before({{"hot/B/[P]/", ""},
                     {Cfg('C'), "<a><b></a>"},
                     {Cfg('D') + "/", ""},
                     {"hot/E/[P]/", "{link:elsewhere/d}"},
                     {"elsewhere/d/Folder.cfg", Written(MovedFrom)},
                     {Cfg('F'), Minimal(MovedFrom, "<?xml version='1.0' encoding='x'?>", "ä")},
                     {Cfg('G'), "{utf16}" + utf16},
                     {Cfg('H'), hidden},
                     {Cfg('I'), Replaced(hidden, "Enable=\"1\"", "Enable=\"0\"")},
                     {Cfg('J'), Written("{hot}{/}T")}})
            .IsReported(R"(
{hot}{/}A
{moves}
{hot}{/}B
  note     no Folder.cfg
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}C
  problem  Folder.cfg: XML parsing error: 'mismatched tag' at line 1
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}D
  problem  Folder.cfg: is not a file
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}E
  problem  [_ORX_HotFolder_]: reached over a link
{hot}{/}F
  problem  Folder.cfg: left as it is (unknown encoding)
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}G
  change   Folder.cfg: {previous}{/}Booklet.tpl -> {default}{/}Booklet.tpl
  note     Folder.cfg: comes out as UTF-8
  note     no such file: {default}{/}Booklet.tpl
  note     no copy of the icon to replace: hf_folder.ico
{hot}{/}H
  problem  Folder.cfg: lacks the attribute "description", so the enabled folder shows as disabled
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}I
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}J
  note     template elsewhere: {hot}{/}T
  note     no copy of the icon to replace: hf_folder.ico)"),
        Done("Presets")
            .Before({{PresetOf('B') + "/", ""},
                     {Jobs + "/C/Presets/", "{link:elsewhere/d}"},
                     {"elsewhere/d/", ""},
                     {PresetOf('D'), Text("\xFF\xFE\0", 3)},
                     {PresetOf('E'), "<p>\xC3\xA4 \xE4</p>"},
                     {PresetOf('F'), "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><p>\xE4</p>"},
                     {PresetOf('G'), Stored(MovedFrom) + Stored(MovedFrom)},
                     {PresetOf('H'), Stored(MovedFrom)},
                     {PresetOf('I'), "\xEF\xBB\xBF<p/>"},
                     {PresetOf('J'), "{utf16}<p>ä</p>"}})
            .IsReported(R"(
Job presets
  change   E{/}Presets{/}presets.xml: comes out as UTF-8
  change   F{/}Presets{/}presets.xml: comes out as UTF-8
  change   G{/}Presets{/}presets.xml: 2 paths
  change   H{/}Presets{/}presets.xml: 1 path
  change   I{/}Presets{/}presets.xml: loses its byte-order mark
  change   J{/}Presets{/}presets.xml: comes out as UTF-8, without byte-order mark
  problem  B{/}Presets{/}presets.xml: reached over a link, or not a file
  problem  C{/}Presets{/}presets.xml: reached over a link, or not a file
  problem  D{/}Presets{/}presets.xml: left as it is (cannot be decoded)
  problem  E{/}Presets{/}presets.xml: is not UTF-8, so the whole file is read as Latin-1
  problem  F{/}Presets{/}presets.xml: declares the encoding ISO-8859-1, but comes out as UTF-8)"),
        Done("LineEndsOfPresets")
            .Preset("<p>\n</p>")
            .Before({{PresetOf('B'), "\xEF\xBB\xBF<p>\n</p>"}})
            .IsReported(IsWindowsProgram() ? R"(
Job presets
  change   .P{/}Presets{/}presets.xml: its line ends become CR LF
  change   B{/}Presets{/}presets.xml: loses its byte-order mark, and its line ends become CR LF)"
                                           : R"(
Job presets
  change   B{/}Presets{/}presets.xml: loses its byte-order mark)"),
        Done("Links")
            .Before(DoneFolder('B'))
            .Before(DoneFolder('C'))
            .Before({{CfgPlace, "{link:elsewhere/a}"},
                     {"hot/B/[P]/hf_folder.ico", "{link:elsewhere/a}"},
                     {"hot/C/Desktop.ini", "{link:elsewhere/a}"},
                     {"hot/C/Desktop.ini#", Removed}})
            .NotUnderWine(NoLinks)
            .IsReported(R"(
{hot}{/}A
  problem  Folder.cfg: reached over a link
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}B
  problem  hf_folder.ico: reached over a link
{hot}{/}C
  problem  Desktop.ini: left as it is (reached over a link))"),
        Done("ReadOnlyFiles")
            .FolderCfg(Written(MovedFrom))
            .Before(DoneFolder('B'))
            .Before({{PresetPlace + "#", "R"},
                     {CfgPlace + "#", "R"},
                     {Cfg('B') + "#", "R"}, // it stays
                     {LogPlace + "#", "R"}})
            .AsOtherUser()
            .IsReported(R"(
Workstation
  problem  there will be no run log: can't open file*
{hot}{/}A
  problem  Folder.cfg: cannot be opened for writing (can't open file*
Job presets
  problem  .P{/}Presets{/}presets.xml: cannot be opened for writing (can't open file*)"),
        Done("NothingCanBeRead")
            .Before(DoneFolder('B'))
            .Before(DoneFolder('C'))
            .Before(DoneFolder('D'))
            .Before({{CfgPlace + "#", "0"},
                     {"hot/B/[P]#", "0"},
                     {"hot/C#", "0"},
                     {"tool/hf_folder.ico#", "0"},
                     {PresetPlace + "#", "0"},
                     {PresetOf('Q'), ""},
                     {Jobs + "/Q#", "0"}})
            .AsOtherUser()
            .IsReported(R"(
{hot}{/}A
  problem  Folder.cfg: can't open file*
  note     no copy of the icon to replace: hf_folder_disabled.ico
{hot}{/}B
  problem  [_ORX_HotFolder_]: cannot be entered
{hot}{/}C
  problem  the hot folder cannot be entered
{hot}{/}D
  problem  hf_folder.ico: the copy would be refused
Job presets
  problem  .P{/}Presets{/}presets.xml: cannot be opened for reading (can't open file*
  problem  Q{/}Presets{/}presets.xml: {user}{/}ORX{/}JPData{/}Q cannot be entered)"),
        Done("IconsOfAnotherUser")
            .Before(DoneFolder('B'))
            .Before({{"hot/A/[P]/hf_folder.ico", "old"},
                     {"hot/A/[P]/hf_folder.ico#", "R"},
                     {"hot/A/[P]#", "X"},
                     {"hot/B/Desktop.ini", "[.ShellClassInfo]"},
                     {"hot/B/Desktop.ini#", "X"}})
            .AsOtherUser()
            .IsReported(R"(
{hot}{/}A
  problem  hf_folder.ico: the copy would be refused
{hot}{/}B
  problem  Desktop.ini: cannot be opened for reading and writing
  problem  Desktop.ini: its attributes cannot be changed)"),
        Done("FoldersOfAnotherUser")
            .Before(DoneFolder('B'))
            .Before({{Ini, Removed}, {Ini + "#", Removed}, {"hot/A#", "SX"}, {"hot/B#", "X"}})
            .AsOtherUser()
            .NotUnderWine(NoRefusal)
            .IsReported(R"(
{hot}{/}A
  problem  Desktop.ini: cannot be created, because the hot folder cannot be written to
{hot}{/}B
  problem  hot folder: its attributes cannot be changed)"),
        Done("SourceIconsAreMissing")
            .Before({{"tool/BundleIcons#", "0"},
                     {"hot/B/[P]/hf_folder_disabled.ico", ""},
                     {"hot/C/[P]/hf_folder_disabled.ico", ""}})
            .FolderCfg(Written("{hot}{/}T"))
            .Run({"U"})
            .AsOtherUser()
            .IsReported(R"(
{hot}{/}A
  problem  source icon missing: {tool}{/}BundleIcons{/}hf_folder.ico
  note     template elsewhere: {hot}{/}T
{hot}{/}B
  problem  source icon missing: {tool}{/}BundleIcons{/}hf_folder_disabled.ico
  note     no Folder.cfg
{hot}{/}C
  note     no Folder.cfg)"),
        Done("KeysAndAttributes")
            .Before(
                {{Ini, "[.ShellClassInfo]\r\nIconFile=x\r\n"}, {Ini + "#", "H"}, {"hot/A#", "H"}})
            .IsReported(R"(
{hot}{/}A
  change   Desktop.ini: InfoTip, IconFile
  change   Desktop.ini: attributes HIDDEN -> READONLY SYSTEM
  change   hot folder: attributes HIDDEN -> HIDDEN SYSTEM)"),
    };
}

TEST_SCENARIOS(Machines);
TEST_SCENARIOS(Values);
TEST_SCENARIOS(FoldersAndPresets);

TEST(Check, WritesToAFile)
{
    Workstation workstation;
    workstation.LayOut(
        WorkstationBefore(Done("").Before({{"hot/A/Bericht ä 版.txt", Text(10000, '.')}})));
    const auto run = [&](const Text& file)
    {
        return workstation.Start("FolderUpgradeCheck", {"i", workstation.Expand(file)});
    };
    EXPECT_EQ(0, run("{hot}{/}A{/}Bericht ä 版.txt").status);
    const Text report = ReadFile(workstation.HostPath("hot/A/Bericht ä 版.txt"));
    const Text rest = workstation.Expand("\nFrom {previous} to {default}\n\n"
                                         "0 changes, 0 problems, 0 notes\n");
    const size_t head = report.find_first_of("\r\n");
    EXPECT_THAT(report.substr(0, head),
                testing::MatchesRegex("FolderUpgradeCheck [0-9]+\\.[0-9]+\\.[0-9]+, upgrade, "
                                      "20[0-9-]+ [0-9]+:[0-9]+, [^,]+, (not )?elevated"));
    EXPECT_EQ(rest, Replaced(report.substr(head), "\r", ""));

    const RunResult refused = run("{hot}{/}none{/}a.txt");
    EXPECT_EQ(2, refused.status);
    EXPECT_EQ("", refused.output);
    const Text complaint = workstation.Expand(
        "FolderUpgradeCheck: the report cannot be written to {hot}{/}none{/}a.txt\n");
    EXPECT_EQ(IsWindowsProgram() ? "" : complaint, refused.libraryLog);
}

TEST(Check, PrintsItsUsage)
{
    const Workstation workstation;
    for (const std::vector<Text>& wrong :
         {std::vector<Text>{}, {"V"}, {"/I"}, {"I", "report", "V"}})
    {
        const RunResult run = workstation.Start("FolderUpgradeCheck", wrong);
        EXPECT_EQ(3, run.status);
        EXPECT_EQ("", run.output);
        EXPECT_EQ(IsWindowsProgram() ? ""
                                     : R"(Usage: FolderUpgradeCheck I|U [FILE]
Reports what FolderUpgrade would change with the same switch, and what would prevent a change, )"
                                       R"(to the standard output or to FILE.
Exit status: 0 nothing to do, 1 changes, 2 problems, 3 wrong arguments.
)",
                  run.libraryLog);
    }
}

} // namespace
