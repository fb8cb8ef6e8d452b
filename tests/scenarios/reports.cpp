// What FolderUpgradeCheck reports. Every other scenario shows that it counts each change and
// changes nothing itself.
#include "tests/scenarios/texts.h"

#include <regex>

namespace
{

const char* const NoRefusal = "Wine lets every user open or list a directory";

Text Cfg(char name)
{
    return Replaced(CfgPlace, "A", Text(1, name));
}

Text PresetOf(char name)
{
    return Replaced(PresetPlace, ".P", Text(1, name));
}

// A hot folder in which a run changes nothing but its template.
Files DoneFolder(char name, const Text& cfg = Written(MovedTo), const Text& icon = "hf_folder")
{
    const Text folder = Text("hot/") + name;
    return {{folder + "#", "S"},
            {folder + "/Desktop.ini#", "RS"},
            {folder + "/Desktop.ini", IniHeader + InfoTip + IconFile(icon)},
            {folder + "/[P]/" + icon + ".ico", "{icon:" + icon + ".ico}"},
            {Cfg(name), cfg}};
}

// A run would change nothing here, and there is nothing to report.
Scenario Done(const Text& name)
{
    return Scenario(name)
        .Before(DoneFolder('A'))
        .Before({{"default/Booklet.tpl", ""}})
        .File(PresetPlace, Stored(MovedTo));
}

SCENARIOS(Machines)
{
    const Text missing = Times(23, "<HotFolder path='{hot}{/}#'/>");
    const auto listed = [](const Text& name, const Text& folders)
    {
        return Done(name).Before({{ListPlace, "<l>" + folders + "</l>"}});
    };
    return {
        Scenario("AnEmptyMachine")
            .Before({{ListPlace, Removed}, {LogPlace, Removed}, {JobPresets + "/", Removed}})
            .IsReported(R"(
Workstation
  note     there is no {list}
  note     there will be no run log: there is no folder {user}{/}ORX_Installers{/}
Job presets
  note     there are no presets, because there is no folder {user}{/}ORX{/}JPData{/})"),
        Done("AListIsCutOffAndAFolderHasTheLogsName")
            .Before({{ListPlace, "<HotFolders>"}, {LogPlace, Removed}, {LogPlace + "/", ""}})
            .IsReported(R"(
Workstation
  problem  {list}: damaged (line 1: no element found); no hot folder is migrated
  note     there will be no run log: something else has its name: {log})"),
        Done("TheListIsADirectoryAndTheLogIsALink")
            .Before({{ListPlace, Removed}, {ListPlace + "/", ""}, {LogPlace, "{link:elsewhere/a}"}})
            .NotUnderWine(NoLinks)
            .IsReported(R"(
Workstation
  problem  HotFolderList.cfg: is not a file
  problem  there will be no run log: it is reached over a link: {log})"),
        listed("AListIsEmptyAndBothTemplateFoldersAreTheSame", "")
            .Before({{UserHive, UserValue("\"Path\"=\"{app}{/}template\"")}})
            .IsReported(R"(
Workstation
  note     HotFolderList.cfg lists no hot folder)"),
        listed("NoListedFolderIsThere", "<HotFolder path='{hot}{/}B'/>").IsReported(R"(
Workstation
  problem  none of the listed hot folders exists (another account? mapped drives?)
  note     listed hot folder does not exist: {hot}{/}B)"),
        listed("ListedFoldersAreMissingOrListedTwiceOrHaveTwoNames",
               Times(2, "<HotFolder path='{hot}{/}A'/>") + "<HotFolder path='{hot}{/}C'/>" +
                   missing)
            .Before({{"hot/C/", "{link:hot/A}"}})
            .IsReported("\nWorkstation" +
                        Times(20, "\n  note     listed hot folder does not exist: {hot}{/}#") + R"(
  note     listed hot folder and 4 more
{hot}{/}C
  note     the same directory as {hot}{/}A)"),
        Done("TheListCannotBeReadNorTheLogCreated")
            .Before({{ListPlace + "#", "0"},
                     {LogPlace, Removed},
                     {LogFolder + "/", ""},
                     {LogFolder + "#", "X"}})
            .AsOtherUser()
            .NotUnderWine(NoRefusal)
            .IsReported(R"(
Workstation
  problem  can't open file*; no hot folder is migrated
  problem  there will be no run log: its folder cannot be written to: {user}{/}ORX_Installers{/})"),
        Done("NoFolderCanBeEntered")
            .Before({{"machine/hotfolder#", "0"}, {LogFolder + "#", "0"}, {JobPresets + "#", "0"}})
            .AsOtherUser()
            .IsReported(R"(
Workstation
  problem  HotFolderList.cfg: its folder cannot be entered
  problem  there will be no run log: its folder cannot be entered: {user}{/}ORX_Installers{/}
Job presets
  problem  {user}{/}ORX{/}JPData{/} cannot be entered)"),
    };
}

// The template folders: what is in the registry, and whether the templates are there.
SCENARIOS(Templates)
{
    const auto with = [](const Text& name, const Files& hives)
    {
        return Done(name)
            .File(PresetPlace, Stored("{hot}{/}A"))
            .Before({{CfgPlace, Written(MovedFrom)}, {"previous/Booklet.tpl", ""}})
            .Before(hives);
    };
    const auto withPath = [&](const Text& name, const Text& path)
    {
        return with(name, {{UserHive, UserValue("\"Path\"=\"" + path + "\"")}});
    };
    return {
        with("PathIsMissing", {{UserHive, UserValue("")}}).IsReported(R"(
{hot}{/}A
  problem  {Path}: missing{nothing})"),
        with("OnlyAPresetAsksForPath", {{UserHive, Removed}, {CfgPlace, Written("")}})
            .IsReported(R"(
Job presets
  problem  registry value Path in HKEY_CURRENT_USER\SOFTWARE\Wow6432Node\HF or \SOFTWARE\HF: there is no such key{nothing})"),
        withPath("PathIsTooLong", Text(258, 'x')).IsReported(R"(
{hot}{/}A
  problem  {Path}: longer than 257 characters{nothing})"),
        with("InstallPathIsInTheOtherKey",
             {{MachineHive, Replaced(MachineValue(""), "SOFTWARE", "SOFTWARE\\Wow6432Node")}})
            .IsReported(R"(
{hot}{/}A
  problem  registry value InstallPath in HKEY_LOCAL_MACHINE\SOFTWARE\Wow6432Node\Vantorix\QZA: )"
                        R"(missing, and no other key is looked at{nothing}
  problem  stays in the folder being left (the folder being installed is unknown): {previous}{/}Booklet.tpl)"),
        with("NothingAsksForInstallPath",
             {{MachineHive, Removed}, {PresetPlace, Removed}, {CfgPlace, Written("{hot}{/}A")}})
            .IsReported(R"(
Job presets
  note     there are no presets in {user}{/}ORX{/}JPData{/})"),
        withPath("PathEndsInASeparator", "{previous}{/}").IsReported(R"(
Workstation
  problem  {Path}: ends in a separator; no template of a hot folder moves
{hot}{/}A
  problem  stays in the folder being left (the registry value ends in a separator): {previous}{/}Booklet.tpl)"),
        withPath("PathEndsInASeparatorOnTheWayBack", "{previous}{/}").Run({"U"}).IsReported(R"(
Workstation
  problem  {Path}: ends in a separator; it is doubled in the paths of hot folders)"),
        withPath("PathIsEmpty", "").IsReported(R"(
Workstation
  problem  {Path}: empty; only templates stored without a folder move)"),
        withPath("PathIsEmptyOnTheWayBack", "").Run({"U"}).IsReported(R"(
Workstation
  problem  {Path}: empty; templates move to the root of the drive)"),
        withPath("PathHoldsAnAmpersand", "{hot}&").Run({"U"}).IsReported(R"(
Job presets
  problem  {Path}: holds & or <, which is inserted into presets as it is)"),
        withPath("TheNewFolderIsBelowTheOld", "{app}")
            .File(PresetPlace, Stored(MovedTo))
            .Before({{"default/template/Booklet.tpl", ""}})
            .IsReported(R"(
Job presets
  change   .P{/}Presets{/}presets.xml: {default}{/}Booklet.tpl -> {default}{/}template{/}Booklet.tpl
  problem  one template folder is below the other: another run would move paths of presets again)"),
        with("InstallPathIsANumber",
             {{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}})
            .IsReported(R"(
{hot}{/}A
  problem  Folder.cfg: left as it is (new path holds a character that XML cannot store)
  problem  stays in the folder being left (in a file that stays as it is): {previous}{/}Booklet.tpl
Job presets
  problem  the folder being installed holds a character that XML cannot store; no path of a )"
                        R"(preset moves)"),
        Done("TemplatesAreMissing")
            .File(CfgPlace, Written("{default}{/}none"))
            .Before(DoneFolder('B', Written("{previous}{/}Sub{/}T")))
            .Before(DoneFolder('C', Written("{hot}{/}C{/}D{/}T")))
            .Before({{"hot/C/D/", "{link:elsewhere/d}"},
                     {"default/D/", "{link:elsewhere/d}"},
                     {"elsewhere/d/T", ""}})
            .File(PresetPlace, Stored("{default}{/}D{/}T") + Stored("{hot}{/}..{/}Vorige 版{/}T") +
                                   Stored("{hot}{/}..{/}Vorige &#x7248;{/}&amp;") +
                                   Stored("{default}{/}&lt;&#65;") + Stored("{default}{/}&none;") +
                                   "ORXImposeTemplate\">\"{previous}")
            .IsReported(R"(
{hot}{/}A
  problem  no template at {default}{/}none
{hot}{/}B
  problem  stays in the folder being left (in a sub-folder): {previous}{/}Sub{/}T
{hot}{/}C
  note     not looked at: {hot}{/}C{/}D{/}T
Job presets
  note     .P{/}Presets{/}presets.xml: a template path has no closing quote
  note     .P{/}Presets{/}presets.xml: not looked at: {default}{/}D{/}T
  problem  .P{/}Presets{/}presets.xml: no template at {default}{/}&none;
  problem  .P{/}Presets{/}presets.xml: no template at {default}{/}<A
  problem  .P{/}Presets{/}presets.xml: stays in the folder being left (other separators): )"
                        R"({hot}{/}..{/}Vorige 版{/}T
  problem  .P{/}Presets{/}presets.xml: stays in the folder being left (stored as XML): )"
                        R"({hot}{/}..{/}Vorige 版{/}&)"),
        Done("ARehearsal")
            .File(CfgPlace, Written("{hot}{/}old{/}T"))
            .File(PresetPlace, Stored("{hot}{/}old{/}T") + Stored("{hot}{/}old{/}T"))
            .Before({{MachineHive, Removed}, {UserHive, Removed}})
            .Run({"I", "--from", "{hot}{/}old", "--to", "{hot}{/}new"})
            .IsReported(R"(
{hot}{/}A
  change   Folder.cfg: {hot}{/}old{/}T -> {hot}{/}new{/}T
Job presets
  change   .P{/}Presets{/}presets.xml: {hot}{/}old{/}T -> {hot}{/}new{/}T (2 times)
Templates
  note     there is no folder {hot}{/}new; templates that will be looked for in it: 2)"),
    };
}

// A Folder.cfg that loses much when its template moves.
Text Rich()
{
    const Text root = "<HotFolder ";
    const Text end = "<PreflightSettings>\n";
    const Text entry = "<KEYVALUE Key=\"B\"";
    Text cfg = Written(MovedFrom);
    for (const auto& [from, to] :
         Files{{" Quickset=\"q\"", ""},
               {"\"-5\"", "\"5b\""},
               {"Centralized=\"1\"", "Centralized=\"1 \""}, // no loss
               {root, "<!DOCTYPE H [<!ENTITY e \"t\">]>\n<?top?>" + root + "mine=\"7\" "},
               {"<a/>", Times(2000, "<r kind=\"alike\" number=\"#\" empty=\"\"/>")}, // no loss
               {entry, entry + " Mine=\"\" Value=\"1\"/>" + entry},
               {end, "<Mine><b/></Mine><Paths/>Note <!-- no loss -->" + end}})
        cfg = Replaced(cfg, from, to);
    return Replaced(cfg, "HotFolder", "Old");
}

SCENARIOS(Contents)
{
    const Text hidden = Replaced(Written(MovedTo), " description=\"\"", "");
    const Text utf16 = Replaced(Replaced(Written(MovedFrom), "UTF-8", "UTF-16"), "𝄞", "");
    const Text lineEnds = IsWindows ? ", and its line ends become CR LF\n  change   "
                                      "K{/}Presets{/}presets.xml: its line ends become CR LF"
                                    : "";
    return {
        Done("Losses")
            .File(CfgPlace, Rich())
            .Before(DoneFolder('B', Replaced(Written(MovedFrom), " TimeInterval=\"010\"", "")))
            .Before(DoneFolder('C', Replaced(Written(MovedFrom), "Enable=\"1\"", "Enable=\"true\""),
                               Disabled))
            .IsReported(R"(
{hot}{/}A
  problem  Folder.cfg: loses its document type, and with it the entities in its texts
  problem  Folder.cfg: loses the instruction <?top?>
  problem  Folder.cfg: its root <Old> comes out as <HotFolder>
  problem  Folder.cfg: lacks "Quickset", so the rewrite resets: Quickset_Supported, IsWidthBased
  problem  Folder.cfg: server_version="5b" comes out as "5"
  problem  Folder.cfg: loses the attribute mine="7"
  problem  Folder.cfg: loses <KEYVALUE Key="B" Mine="" Value="1"> in <JobSetting>
  problem  Folder.cfg: loses <KEYVALUE Key="B" KeyDisplayValue="two" LocDisplayValue="zwei" )"
                        R"(Value="2"> in <JobSetting>
  problem  Folder.cfg: loses <Mine>
  problem  Folder.cfg: loses <b> in <Mine>
  problem  Folder.cfg: loses <Paths>
  problem  Folder.cfg: loses the text "Note"
{moves}
{hot}{/}B
  problem  Folder.cfg: lacks "TimeInterval", so the rewrite resets: PPDVersion, )"
                        R"(ServerTypeAndJPDefaultKeyInfo, server_version, server_textversion, )"
                        R"(server_type, Quickset, Quickset_Supported, IsWidthBased
{moves}
{hot}{/}C
  problem  Folder.cfg: Enable="true" comes out as "0"
{moves})"),
        Done("FolderCfgsAndPresets")
            .Before(DoneFolder('B', Removed, Disabled))
            .Before(DoneFolder('C', "<a><b></a>", Disabled))
            .Before(DoneFolder('G', "{utf16}" + utf16))
            .Before(DoneFolder('H', hidden, Disabled))
            .Before(DoneFolder('I', Replaced(hidden, "Enable=\"1\"", "Enable=\"0\""), Disabled))
            .Before({{"hot/A/Desktop.ini", "[.ShellClassInfo]\r\nIconFile=x\r\n"},
                     {"hot/A/Desktop.ini#", "H"},
                     {"hot/A#", "H"},
                     {Cfg('D') + "/", ""},
                     {"hot/E/[P]/", "{link:elsewhere/d}"},
                     {"elsewhere/d/Folder.cfg", Written(MovedFrom)},
                     {PresetOf('B') + "/", ""},
                     {JobPresets + "/C/Presets/", "{link:elsewhere/d}"},
                     {PresetOf('D'), Text("\xFF\xFE\0", 3)},
                     {PresetOf('E'), "<p>\xC3\xA4 \xE4</p>"},
                     {PresetOf('F'), "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><p>\xE4</p>"},
                     {PresetOf('G'), Stored(MovedFrom)},
                     {PresetOf('H'), "\xEF\xBB\xBF<p/>"},
                     {PresetOf('I'), "{utf16}<p>ä</p>"},
                     {PresetOf('J'), "\xEF\xBB\xBF<p>\n</p>"},
                     {PresetOf('K'), "<p>\n</p>"}})
            .IsReported(R"(
{hot}{/}A
  change   Desktop.ini: InfoTip, IconFile
  change   Desktop.ini: attributes HIDDEN -> READONLY SYSTEM
  change   hot folder: attributes HIDDEN -> HIDDEN SYSTEM
{hot}{/}B
  note     no Folder.cfg
{hot}{/}C
  problem  Folder.cfg: damaged (line 1: mismatched tag); it stays as it is, and the folder shows )"
                        R"(as disabled
{hot}{/}D
  problem  Folder.cfg: is not a file
{nodisabled}
{hot}{/}E
  problem  [_ORX_HotFolder_]: reached over a link
{hot}{/}G
{moves}
  note     Folder.cfg: comes out as UTF-8
{hot}{/}H
  problem  Folder.cfg: lacks "description", so the enabled folder shows as disabled
Job presets
  change   E{/}Presets{/}presets.xml: comes out as UTF-8
  change   F{/}Presets{/}presets.xml: comes out as UTF-8
  change   G{/}Presets{/}presets.xml: {previous}{/}Booklet.tpl -> {default}{/}Booklet.tpl
  change   H{/}Presets{/}presets.xml: loses its byte-order mark
  change   I{/}Presets{/}presets.xml: comes out as UTF-8, without byte-order mark
  change   J{/}Presets{/}presets.xml: loses its byte-order mark)" +
                        lineEnds +
                        R"(
  problem  B{/}Presets{/}presets.xml: reached over a link, or not a file
  problem  C{/}Presets{/}presets.xml: reached over a link, or not a file
  problem  D{/}Presets{/}presets.xml: left as it is (cannot be decoded)
  problem  E{/}Presets{/}presets.xml: is not UTF-8, so the whole file is read as Latin-1; )"
                        R"(accented characters come out wrong
  problem  F{/}Presets{/}presets.xml: declares the encoding ISO-8859-1, but comes out as UTF-8)"),
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
{nodisabled}
{hot}{/}B
  problem  hf_folder.ico: reached over a link
{hot}{/}C
  problem  Desktop.ini: left as it is (reached over a link))"),
        Done("NothingCanBeReadOrReplaced")
            .Before(DoneFolder('B'))
            .Before(DoneFolder('C'))
            .Before(DoneFolder('D'))
            .Before(DoneFolder('F', Written(MovedFrom)))
            .Before({{CfgPlace + "#", "0"},
                     {"hot/B/[P]#", "0"},
                     {"hot/C#", "0"},
                     {"hot/D/Desktop.ini", "[.ShellClassInfo]"},
                     {"hot/D/Desktop.ini#", "X"},
                     {Cfg('D') + "#", "R"}, // it stays
                     {"hot/E/[P]/hf_folder_disabled.ico", "old"},
                     {"hot/E/[P]/hf_folder_disabled.ico#", "R"},
                     {"hot/E/[P]#", "X"},
                     {Cfg('F') + "#", "R"},
                     {"tool/hf_folder.ico#", "0"},
                     {LogPlace + "#", "R"},
                     {PresetPlace + "#", "0"},
                     {PresetOf('Q'), ""},
                     {JobPresets + "/Q#", "0"},
                     {PresetOf('R'), ""},
                     {PresetOf('R') + "#", "R"}})
            .AsOtherUser()
            .IsReported(R"(
Workstation
  problem  there will be no run log: can't open file*
{hot}{/}A
  problem  Folder.cfg: can't open file*
{nodisabled}
{hot}{/}B
  problem  [_ORX_HotFolder_]: cannot be entered
{hot}{/}C
  problem  the hot folder cannot be entered
{hot}{/}D
  problem  hf_folder.ico: cannot be replaced (read-only, in use, or access denied)
  problem  Desktop.ini: cannot be opened for reading and writing
  problem  Desktop.ini: its attributes cannot be changed
{hot}{/}E
  problem  hf_folder_disabled.ico: cannot be replaced (read-only, in use, or access denied)
  change   Desktop.ini: new
  change   hot folder: attributes none -> SYSTEM
  note     no Folder.cfg
{hot}{/}F
  problem  Folder.cfg: cannot be opened for writing (can't open file*
  problem  stays in the folder being left (in a file that stays as it is): {previous}{/}Booklet.tpl
  problem  hf_folder.ico: cannot be replaced (read-only, in use, or access denied)
Job presets
  problem  .P{/}Presets{/}presets.xml: cannot be opened for reading (can't open file*
  problem  Q{/}Presets{/}presets.xml: {user}{/}ORX{/}JPData{/}Q cannot be entered
  problem  R{/}Presets{/}presets.xml: cannot be opened for writing (can't open file*)"),
        Done("FoldersOfAnotherUserAndPresetsThatCannotBeListed")
            .Before(DoneFolder('B'))
            .Before({{"hot/A/Desktop.ini", Removed},
                     {"hot/A/Desktop.ini#", Removed},
                     {"hot/A#", "SX"},
                     {"hot/B#", "X"},
                     {JobPresets + "#", "L"}})
            .AsOtherUser()
            .NotUnderWine(NoRefusal)
            .IsReported(R"(
{hot}{/}A
  problem  Desktop.ini: cannot be created, because the hot folder cannot be written to
{hot}{/}B
  problem  hot folder: its attributes cannot be changed
Job presets
  problem  {user}{/}ORX{/}JPData{/} cannot be listed)"),
        Done("SourceIconsAreMissing")
            .Before(DoneFolder('A', Written("{hot}{/}A")))
            .Before(DoneFolder('B', Written("{hot}{/}A")))
            .Before({{"tool/BundleIcons#", "0"}, {PresetPlace, ""}})
            .Run({"U"})
            .AsOtherUser()
            .IsReported(R"(
{hot}{/}A
  problem  source icon missing: {tool}{/}BundleIcons{/}hf_folder.ico)"),
    };
}

TEST(Check, WritesToAFile)
{
    Workstation workstation;
    workstation.LayOut(
        WorkstationBefore(Done("").Before({{"hot/A/Bericht ä 版.txt", Text(10000, '.')}})));
    const Text check = "FolderUpgradeCheck";
    EXPECT_EQ(0, workstation.Start(check, {"i", "{hot}{/}A{/}Bericht ä 版.txt"}).status);
    const Text report =
        Replaced(ReadFile(workstation.HostPath("hot/A/Bericht ä 版.txt")), "\r", "");
    const size_t head = report.find('\n');
    EXPECT_TRUE(std::regex_match(
        report.substr(0, head),
        std::regex("FolderUpgradeCheck [0-9]+\\.[0-9]+\\.[0-9]+, upgrade, 20[0-9-]+ "
                   "[0-9]+:[0-9]+, [^,]+, (not )?elevated")))
        << report;
    EXPECT_EQ(workstation.Expand("\nFrom {previous} to {default}\n\n"
                                 "0 changes, 0 problems, 0 notes\n"),
              report.substr(head));

    const RunResult refused = workstation.Start(check, {"i", "{hot}{/}none{/}a.txt"});
    EXPECT_EQ(2, refused.status);
    EXPECT_EQ("", refused.output);
    const Text complaint = workstation.Expand(
        "FolderUpgradeCheck: the report cannot be written to {hot}{/}none{/}a.txt\n");
    EXPECT_EQ(complaint, refused.libraryLog);
}

} // namespace
