// What FolderUpgradeCheck says of workstations with one thing amiss. Whether it names every change,
// and changes nothing itself, each scenario of a run shows.
#include "tests/check_report.h"
#include "tests/scenarios/texts.h"

#include <fstream>
#include <sstream>

namespace
{

const Text Icon = "hot/A/[P]/hf_folder.ico";
const Text Ini = "hot/A/Desktop.ini";
const char* const NoLinks = "links to files are for this machine only";
const char* const PathValue = "problem  registry value Path in HKEY_CURRENT_USER\\SOFTWARE[\\Wow6432Node]\\HF: ";
const char* const InstallPathValue = "problem  registry value InstallPath in HKEY_LOCAL_MACHINE\\SOFTWARE[\\Wow6432Node]\\Vantorix\\QZA: ";
const char* const Unknown = "missing, longer than 257 characters, or not readable; nothing moves";

// A workstation, and all lines of one kind that the report has: "problem  ..." and so on. A line that
// ends in * goes on with the system's own words.
struct Finding
{
    Scenario workstation;
    Text lines;
};

// A run would change nothing here.
Scenario Done(const Name& name)
{
    return Scenario(name)
        .Before({{Icon, "{icon:hf_folder.ico}"},
                 {Ini, "[.ShellClassInfo]\r\nInfoTip=This folder has been configured as an ORX hot folder.\r\n"
                       "IconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\n"},
                 {Ini + "#", "RS"},
                 {"hot/A#", "S"}})
        .FolderCfg(Written(MovedTo))
        .Preset(Stored("elsewhere"));
}

Scenario Moving(const Name& name) { return Done(name).FolderCfg(Written(MovedFrom)); }

Text Changed(Text text, const Text& from, const Text& to)
{
    ReplaceAll(text, from, to);
    return text;
}

std::vector<Finding> Lists()
{
    const Text missing = "<HotFolder path=\"{hot}{/}B\"/>";
    const Text listed = "<HotFolder path=\"{hot}{/}A\"/>";
    return {
        {Done("OfWhatIsDoneNothingIsSaid"), ""},
        {Done("AListIsCutOff").Before({{ListPlace, "<HotFolders>"}}),
         "problem  HotFolderList.cfg: XML parsing error: 'no element found' at line 1"},
        {Done("AListMayNotBeRead").Before({{Text(ListPlace) + "#", "0"}}).AsOtherUser(), "problem  HotFolderList.cfg: can't open file*"},
        {Done("TheListsFolderMayNotBeEntered").Before({{"machine/hotfolder#", "0"}}).AsOtherUser(),
         "problem  HotFolderList.cfg: its folder cannot be entered"},
        {Done("NoListedFolderIsThere").Before({{ListPlace, "<HotFolders>" + missing + missing + "</HotFolders>"}}),
         "problem  none of the listed hot folders is there (another account, mapped drives?)"},
        {Done("AListedFolderIsMissing").Before({{ListPlace, "<HotFolders>" + missing + listed + "</HotFolders>"}}),
         "note     listed hot folder is not there: {hot}{/}B"},
        {Done("AFolderIsListedTwice").Before({{ListPlace, "<HotFolders>" + listed + listed + "</HotFolders>"}}),
         "note     hot folder is listed twice: {hot}{/}A"},
        {Done("ADirectoryIsListedUnderTwoNames").Before({{"hot/B/", "{link:hot/A}"}}), "note     the same directory as {hot}{/}A"},
        {Done("ThereIsNoList").Before({{ListPlace, Removed}}), "note     there is no HotFolderList.cfg"},
        {Done("AListIsEmpty").Before({{ListPlace, "<HotFolders/>"}}), "note     HotFolderList.cfg lists no hot folder"},
    };
}

std::vector<Finding> Registry()
{
    const auto path = [](const Name& name, const Text& value) {
        return Moving(name).Before({{UserHive, UserValue("\"Path\"=\"" + value + "\"")}});
    };
    const Files below = {{UserHive, UserValue("\"Path\"=\"{APP}\"")}};
    const Text isBelow = "problem  the folder being installed is below the one being left; every further run moves the paths of "
                         "presets again";
    return {
        {Moving("PathIsMissing").Before({{UserHive, Removed}, {"hot/B/[P]/Folder.cfg", Written(MovedFrom)}}), Text(PathValue) + Unknown},
        {Moving("InstallPathIsMissing").Before({{MachineHive, Removed}}), Text(InstallPathValue) + Unknown},
        {Done("NothingAsksForInstallPath").Before({{MachineHive, Removed}, {PresetPlace, Removed}}), "problem"},
        {path("PathEndsInASeparator", "{PREVIOUS}{/2}"), Text(PathValue) + "ends in a separator; no template of a hot folder moves"},
        {path("PathEndsInASeparatorOnADowngrade", "{PREVIOUS}{/2}").Run({"U"}),
         Text(PathValue) + "ends in a separator; it is doubled in the paths of hot folders"},
        {path("PathIsEmpty", ""), Text(PathValue) + "empty; only templates stored without a folder move"},
        {path("PathIsEmptyOnADowngrade", "").Run({"U"}), Text(PathValue) + "empty; templates move to the root of the drive"},
        {path("PathHoldsAnAmpersand", "{PREVIOUS}&"), Text(PathValue) + "holds & or <, which presets store in another form"},
        {path("WithoutPresetsAnAmpersandIsHarmless", "{PREVIOUS}&").Before({{PresetPlace, Removed}}), "problem"},
        {Moving("InstallPathIsANumber").Before({{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}}),
         "problem  Folder.cfg: left as it is (new path holds a character that XML cannot store)\n"
         "problem  the folder being installed holds a character that XML cannot store; no path of a preset moves"},
        {Done("TheNewFolderIsBelowTheOld").Before(below), isBelow},
        {Done("WithoutPresetsAFolderBelowIsHarmless").Before(below).Before({{PresetPlace, Removed}}), "problem"},
        {Done("OnADowngradeTheOldFolderIsBelow").Before({{UserHive, UserValue("\"Path\"=\"{APP}{/2}template{/2}old\"")}}).Run({"U"}), isBelow},
        {Moving("BothFoldersAreTheSame")
             .FolderCfg(Written(MovedTo))
             .Preset(Stored(MovedTo))
             .Before({{UserHive, UserValue("\"Path\"=\"{APP}{/2}template\"")}}),
         "change"},
    };
}

// What a moving Folder.cfg loses.
std::vector<Finding> Losses()
{
    const auto with = [](const Name& name, const Text& from, const Text& to, const Text& line)
    { return Finding{Moving(name).FolderCfg(Changed(Written(MovedFrom), from, to)), line.empty() ? "problem" : "problem  Folder.cfg: " + line}; };
    const Text defaults = "; the rewrite sets it and all that follow it to their defaults";
    const Text section = "<PreflightSettings>\n";
    const Text comment = "<FilterSetting mode=\"2\" name=\"&lt;\">";
    return {
        with("ItLacksADescription", " description=\"\"", "",
             "lacks the attribute \"description\"" + defaults + " (the folder comes out disabled)"),
        with("ItLacksAQuickset", " Quickset=\"q\"", "", "lacks the attribute \"Quickset\"" + defaults),
        with("ItIsDisabledAndLacksADescription", " description=\"\" ", " ", "lacks the attribute \"description\"" + defaults +
             " (the folder comes out disabled)"),
        with("EnableIsAWord", "Enable=\"1\"", "Enable=\"true\"", "Enable=\"true\" comes out as \"0\""),
        with("ANumberIsNone", "server_version=\"-5\"", "server_version=\"5b\"", "server_version=\"5b\" comes out as \"5\""),
        with("ANumericFlagIsNone", "Quickset_Enabled=\"0\"", "Quickset_Enabled=\"no\"", "Quickset_Enabled=\"no\" comes out as \"0\""),
        with("SpaceAroundAFlagIsNoLoss", "Centralized=\"1\"", "Centralized=\"1 \"", ""),
        with("AnAttributeIsUnknown", "<HotFolder ", "<HotFolder mine=\"7\" ", "loses the attribute mine=\"7\""),
        with("TheRootHasAnotherName", "HotFolder", "Anything", "its root <Anything> comes out as <HotFolder>"),
        with("AnElementIsUnknown", section, "<Mine><a/></Mine>" + section,
             "loses <Mine> in <HotFolder>\nproblem  Folder.cfg: loses <a> in <Mine>"),
        with("AnAttributeOfAnEntryIsUnknown", "Value=\"2\"", "Value=\"2\" Empty=\"\"",
             "loses <KEYVALUE Key=\"B\" Value=\"2\" Empty=\"\" KeyDisplayValue=\"two\" LocDisplayValue=\"zwei\"> in <JobSetting>"),
        with("AKeyIsRepeated", "<KEYVALUE Key=\"B\"", "<KEYVALUE Key=\"B\" Value=\"1\"/><KEYVALUE Key=\"B\"",
             "loses <KEYVALUE Key=\"B\" Value=\"2\" KeyDisplayValue=\"two\" LocDisplayValue=\"zwei\"> in <JobSetting>"),
        with("ASectionIsRepeated", section, "<PreflightSettings/>" + section, "?"),
        with("ThereIsAText", section, "Note <![CDATA[this]]>" + section, "?"),
        with("ThereIsAnInstruction", section, "<?mine?>" + section, "loses the instruction <?mine?>"),
        with("AnEntityIsLost", "<HotFolder ", "<!DOCTYPE HotFolder [<!ENTITY e \"text\">]>\n<HotFolder ",
             "loses its document type, and with it the entities in its texts"),
        with("CommentsAndOrderAreNoLoss", section, section + "<!-- c -->", ""),
        with("ManyAlikeInTheFilterSettingAreNoLoss", comment,
             comment + [] { Text many; for (int i = 0; i < 3000; ++i) many += "<r type=\"a\" n=\"" + std::to_string(i) + "\" e=\"\"/>"; return many; }(), ""),
    };
}

std::vector<Finding> FolderCfgs()
{
    const Text privateDir = "hot/A/[P]";
    const Text hidden = Changed(Written(MovedTo), " description=\"\"", "");
    return {
        {Done("ItIsMissing").Before({{CfgPlace, Removed}}), "note     no Folder.cfg"},
        {Done("ItIsMalformed").FolderCfg("<a><b></a>"), "problem  Folder.cfg: XML parsing error: 'mismatched tag' at line 1"},
        {Done("ItMayNotBeRead").Before({{CfgPlace + "#", "0"}}).AsOtherUser(), "problem  Folder.cfg: can't open file*"},
        {Moving("ItMayNotBeWritten").Before({{CfgPlace + "#", "R"}}).AsOtherUser(),
         "problem  Folder.cfg: cannot be opened for writing (can't open file*"},
        {Done("WhatStaysNeedNotBeWritten").Before({{CfgPlace + "#", "R"}}).AsOtherUser(), "problem"},
        {Done("ItIsALink").Before({{CfgPlace, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks), "problem  Folder.cfg: reached over a link"},
        {Done("ItIsADirectory").Before({{CfgPlace, Removed}, {CfgPlace + "/", ""}}), "problem  Folder.cfg: is no file"},
        {Done("ThePrivateDirectoryIsALink").Before({{CfgPlace, Removed}, {Icon, Removed}, {privateDir + "/", "{link:elsewhere/d}"}, {"elsewhere/d/Folder.cfg", Written(MovedFrom)}}),
         "problem  [_ORX_HotFolder_]: reached over a link"},
        {Done("ThePrivateDirectoryMayNotBeEntered").Before({{privateDir + "#", "0"}}).AsOtherUser(),
         "problem  [_ORX_HotFolder_]: cannot be entered"},
        {Done("TheHotFolderMayNotBeEntered").Before({{"hot/A#", "0"}}).AsOtherUser(), "problem  the hot folder cannot be entered"},
        {Moving("ItsEncodingIsUnknown").FolderCfg(Minimal(MovedFrom, "<?xml version='1.0' encoding='x-unknown'?>", "\xC3\xA4")),
         "problem  Folder.cfg: left as it is (unknown encoding)"},
        {Moving("ItsEncodingIsAnother").FolderCfg("{utf16}" + Changed(Written(MovedFrom), "UTF-8", "UTF-16")), "note     Folder.cfg: comes out in UTF-8"},
        {Done("ItHidesThatItIsEnabled").FolderCfg(hidden), "problem  Folder.cfg: lacks the attribute \"description\", so the enabled folder shows as disabled"},
        {Done("ItIsDisabledAnyway").FolderCfg(Changed(hidden, "Enable=\"1\"", "Enable=\"0\"")), "problem"},
        {Moving("NothingIsAtTheNewPath"), "note     no such file: " + MovedTo},
        {Done("TheTemplateIsElsewhere").FolderCfg(Written("{hot}{/}T")), "note     template elsewhere: {hot}{/}T"},
    };
}

std::vector<Finding> Icons()
{
    const Text icon = "tool/hf_folder.ico";
    return {
        {Done("ThereIsNoIconToReplace").Before({{Icon, Removed}}), "note     no copy of the icon to replace: hf_folder.ico"},
        {Done("TheSourceIsMissing").Before({{"hot/B/[P]/hf_folder_disabled.ico", "old"}, {"hot/C/[P]/hf_folder_disabled.ico", "old"}}).Run({"U"}), "?"},
        {Done("TheCopyIsRefused").Before({{Icon, "old"}, {Icon + "#", "R"}, {"hot/A/[P]#", "X"}}).AsOtherUser(), "problem  hf_folder.ico: the copy would be refused"},
        {Done("TheSourceMayNotBeRead").Before({{"tool/hf_folder.ico#", "0"}}).AsOtherUser(), "problem  hf_folder.ico: the copy would be refused"},
        {Done("TheIconIsALink").Before({{Icon, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks), "problem  hf_folder.ico: reached over a link"},
        {Done("DesktopIniIsALink").Before({{Ini, "{link:elsewhere/a}"}, {Ini + "#", Removed}}).NotUnderWine(NoLinks), "problem  Desktop.ini: left as it is (reached over a link)"},
        {Done("DesktopIniMayNotBeWritten").Before({{Ini, "[.ShellClassInfo]"}, {Ini + "#", "X"}}).AsOtherUser(), "?"},
        {Done("TheHotFolderIsAnothers").Before({{"hot/A#", "X"}}).AsOtherUser(), "problem  hot folder: its attributes may not be changed"},
        {Done("ADesktopIniCannotBeMade").Before({{Ini, Removed}, {Ini + "#", Removed}, {"hot/A#", "SX"}}).AsOtherUser(), "problem  Desktop.ini: cannot be made, the hot folder may not be written"},
        {Done("OtherKeysAndAttributes").Before({{Ini, "[.ShellClassInfo]\r\nIconFile=x\r\n"}, {Ini + "#", "H"}, {"hot/A#", "R"}}), "?change"},
    };
}

std::vector<Finding> Presets()
{
    const Text declared = "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>";
    const Text name = "{/}.P{/}Presets{/}presets.xml: ";
    return {
        {Done("ThereIsNone").Before({{PresetPlace, Removed}}), "note     there are no presets in {user}{/}ORX{/}JPData{/}"},
        {Done("ThereIsNoFolder").Before({{PresetPlace, Removed}, {"user/ORX/JPData/", Removed}}), "note     there are no presets: there is no folder {user}{/}ORX{/}JPData{/}"},
        {Done("APresetMayNotBeRead").Before({{PresetPlace + "#", "0"}}).AsOtherUser(), "?"},
        {Done("APresetMayNotBeWritten").Before({{PresetPlace + "#", "R"}}).AsOtherUser(), "?"},
        {Done("ADirectoryMayNotBeEntered").Before({{"user/ORX/JPData/.P#", "0"}}).AsOtherUser(), "?"},
        {Done("TheFolderMayNotBeListed").Before({{"user/ORX/JPData#", "0"}}).AsOtherUser(), "?"},
        {Done("APresetIsNoText").Preset(Text("\xFF\xFE\0", 3)), "?"},
        {Done("OneByteIsWrong").Preset("<p>\xC3\xA4 \xE4</p>"), "?"},
        {Done("APresetDeclaresLatin1").Preset(declared + "<p>\xE4</p>"), "?"},
        {Done("TwoPathsMove").Preset(Stored(MovedFrom) + Stored(MovedFrom) + "\xC3\xA4"), "?change"},
        {Done("OnlyTheMarkGoes").Preset("\xEF\xBB\xBF<p/>"), "?change"},
        {Done("OnlyTheEncodingChanges").Preset("{utf16}<p>ä</p>"), "?change"},
        {Done("OnlyLineEndsChange").Preset("<p>\n</p>"), "?change"},
        {Done("ADirectoryHasItsName").Before({{PresetPlace, Removed}, {PresetPlace + "/", ""}}), "?"},
        {Done("TheDirectoryPresetsIsALink").Before({{PresetPlace, Removed}, {"user/ORX/JPData/.P/Presets/", "{link:elsewhere/d}"}, {"elsewhere/d/", ""}}), "?"},
    };
}

std::vector<Finding> Logs()
{
    const Text folder = "user/ORX_Installers";
    return {
        {Done("TheLogIsReadOnly").Before({{Text(LogPlace) + "#", "R"}}).AsOtherUser(), "?"},
        {Done("TheLogIsALink").Before({{LogPlace, "{link:elsewhere/a}"}}).NotUnderWine(NoLinks), "?"},
        {Done("ItsFolderIsALink").Before({{LogPlace, Removed}, {folder + "/", "{link:elsewhere/d}"}, {"elsewhere/d/", ""}}), "?"},
        {Done("ItsFolderMayNotBeEntered").Before({{folder + "#", "0"}}).AsOtherUser(), "?"},
        {Done("ItsFolderMayNotBeWritten").Before({{LogPlace, Removed}, {folder + "/", ""}, {folder + "#", "X"}}).AsOtherUser(), "?"},
        {Done("ThereIsNoFolder").Before({{LogPlace, Removed}}), "?note"},
        {Done("AFolderHasItsName").Before({{LogPlace, Removed}, {Text(LogPlace) + "/", ""}}), "?note"},
    };
}

// The lines of that kind, without their indentation.
std::vector<Text> LinesOf(const CheckReport& report, const Text& kind)
{
    std::vector<Text> lines;
    std::istringstream text(report.text);
    for (Text line; std::getline(text, line);)
    {
        line.erase(line.find_last_not_of("\r") + 1);
        if (StartsWith(line, "  " + kind))
            lines.push_back(line.substr(2));
    }
    return lines;
}

void Compare(const Text& expected, const std::vector<Text>& lines, const Text& report)
{
    std::istringstream text(expected);
    size_t count = 0;
    for (Text line; std::getline(text, line); ++count)
    {
        const bool goesOn = !line.empty() && line.back() == '*';
        const Text actual = count < lines.size() ? lines[count] : "";
        const size_t length = line.size() - (goesOn ? 1 : 0);
        EXPECT_EQ(line.substr(0, length), goesOn ? actual.substr(0, length) : actual) << report;
    }
    EXPECT_EQ(count, lines.size()) << report;
}

class Findings : public testing::TestWithParam<Finding>
{
};

void PrintTo(const Finding& finding, std::ostream* stream) { *stream << finding.workstation.name.what; }

TEST_P(Findings, AreSaid)
{
    const auto& [scenario, lines] = GetParam();
    if (IsWindowsProgram() && !scenario.notUnderWine.empty())
        GTEST_SKIP() << scenario.notUnderWine;
    const testing::ScopedTrace trace(scenario.name.file, scenario.name.line, scenario.name.what);
    Workstation workstation(scenario.asOtherUser);
    workstation.LayOut(WorkstationBefore(scenario));
    const CheckReport report(workstation, workstation.Start({scenario.arguments[0]}, "FolderUpgradeCheck"));
    const Text kind = lines.substr(0, lines.find(' '));
    Compare(workstation.Expand(lines == kind ? "" : lines), LinesOf(report, kind), report.text);
    std::cerr << report.text;
}

#define TEST_FINDINGS(function)                                                                                                          \
    INSTANTIATE_TEST_SUITE_P(function, Findings, testing::ValuesIn(function()),                                                          \
                             [](const auto& finding) { return finding.param.workstation.name.what; })

TEST_FINDINGS(Lists);
TEST_FINDINGS(Registry);
TEST_FINDINGS(FolderCfgs);
TEST_FINDINGS(Losses);
TEST_FINDINGS(Icons);
TEST_FINDINGS(Presets);
TEST_FINDINGS(Logs);

} // namespace
