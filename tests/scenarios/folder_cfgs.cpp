// Folder.cfg: what is read, what moves, and the form in which it is written again; refused files.
#include "tests/scenarios/texts.h"

#include <iterator>

namespace
{

// Hot folders that each lack one attribute of the root, and one that has all.
Scenario Gaps()
{
    std::istringstream words(
        "description server_ip server_name Enable BaseVirtualPrinter BaseVirtualPrinterName "
        "BaseVirtualPrinterDisplayName HFPresetName Centralized Isjobpresetattached "
        "IsCustomInterval TimeInterval PPDVersion ServerTypeAndJPDefaultKeyInfo "
        "server_textversion server_type Quickset Quickset_Supported Quickset_Enabled IsWidthBased");
    const std::vector<Text> chain(std::istream_iterator<Text>(words), {});
    // server_version is read after 14 of them, and is no gap itself.
    const Text numbers[] = {"2147483647", "-2147483648", "2147483648", "x1", " 01", "", "9x"};
    const Text read[] = {"2147483647", "-2147483648", "0", "0", "1", "0", "9"};
    std::map<Text, HotFolder> folders;
    for (size_t gap = 0; gap <= chain.size(); ++gap)
    {
        const size_t row = gap < 14 ? 0 : (gap - 14) % std::size(numbers);
        Text attributes = "<HotFolder server_version='" + numbers[row] + "'";
        Text written = MinimalWritten(MovedTo);
        for (size_t i = 0; i < chain.size(); ++i)
        {
            const Text value = " " + chain[i] + "=\"1\"";
            attributes += i == gap ? "" : value;
            for (const char* unset : {"=\"\"", "=\"0\""})
                written = i < gap ? Replaced(written, " " + chain[i] + unset, value) : written;
        }
        folders["gap " + std::to_string(10 + gap)] = {
            Replaced(Minimal(MovedFrom), "<HotFolder", attributes),
            Replaced(written, "\"-1\"", "\"" + (gap < 14 ? "-1" : read[row]) + "\""),
            Found(MovedFrom), gap > 3 ? "hf_folder" : Disabled};
    }
    return HotFolders("AttributesAfterAGapComeOutAsDefaults", folders);
}

// The paths are ASCII, because nothing else can be compared in these encodings.
Scenario Encodings()
{
    // Without a new name, the file stays.
    const auto declared =
        [](const Text& encoding, const Text& name, const Text& newName = "", const Text& mark = "")
    {
        const Text cfg =
            mark + Minimal("{hot}{/}x", "<?xml version='1.0' encoding" + encoding + "?>", name);
        const Text found = Found("{hot}{/}x");
        return newName.empty()
                   ? HotFolder{cfg, "", found + Untouched("unknown encoding")}
                   : HotFolder{cfg, MinimalWritten("{hot}{/}template{/}x", newName), found};
    };
    return HotFolders(
               "EncodingsThatTheLibraryReadsWronglyStay",
               {{"Ascii", declared("='ASCII'", "x", "x")},
                {"AsciiInLatin1", declared("='latin1'", "x", "x")},
                {"AsciiInShiftJis", declared("='Shift_JIS'", "x", "x")},
                {"Windows1252", declared("='windows-1252'", "\x80\xE4", "€ä")},
                {"Utf8OfAnotherName", declared("='UTF8'", "\xC3\xA4")},
                {"Windows1253", declared("='windows-1253'", "\xE1\xD2")},
                {"ShiftJisAfterSpaces", declared(" = 'Shift_JIS'", "\x93\xFA")},
                {"Unknown", declared("='x-own'", "x")},
                {"UnknownAfterAByteOrderMark", declared("='x-own'", "n", "", "\xEF\xBB\xBF")}})
        .Before({{MachineHive, Hive(MachineKey, "\"InstallPath\"=\"{hot}\"")},
                 {UserHive, Hive(UserKey, "\"Path\"=\"{hot}\"")}});
}

// A Folder.cfg that loses much when its template moves.
Text Rich()
{
    const Text entry = "<KEYVALUE Key=\"B\"";
    Text cfg = Written(MovedFrom);
    for (const auto& [from, to] :
         Files{{" Quickset=\"q\"", ""},
               {"\"-5\"", "\"5b\""},
               {"Centralized=\"1\"", "Centralized=\"1 \""}, // no loss
               {"<HotFolder ", "<!DOCTYPE H [<!ENTITY e \"t\">]>\n<?top?><HotFolder mine=\"7\" "},
               {"<a/>", Times(2000, "<r kind=\"alike\" number=\"#\" empty=\"\"/>")}, // no loss
               {entry, entry + " Mine=\"\" Value=\"1\"/>" + entry},
               {"<PreflightSettings>\n",
                "<Mine><b/></Mine><Paths/>Note <!-- no loss --><PreflightSettings>\n"}})
        cfg = Replaced(cfg, from, to);
    return Replaced(cfg, "HotFolder", "Old");
}

SCENARIOS(FolderCfgs)
{
    const Text found = Found(MovedFrom);
    const Text written = MinimalWritten(MovedTo);
    const Text mixed = "<FilterSetting>t\n    <x>u\n      <y/>v</x>\n    <![CDATA[<w>]]>z\n    "
                       "<!--c-->\n  </FilterSetting>";
    const Text utf16 =
        "{utf16}" + Replaced(Replaced(Written(MovedFrom), "UTF-8", "UTF-16"), "𝄞", "");
    const auto path = [](const Text& stored, const Text& becomes = "")
    {
        return HotFolder{Minimal(stored), becomes.empty() ? "" : MinimalWritten(becomes),
                         Found(stored)};
    };
    return {
        Gaps(),
        Encodings(),
        HotFolders(
            "AFolderCfgIsRewrittenInTheToolsForm",
            {{"Foreign", {Data("foreign.cfg", MovedFrom), Written(MovedTo), found, "hf_folder"}},
             {"Incomplete", {Minimal(MovedFrom), written, found}},
             {"DocumentType",
              {Minimal(MovedFrom, "<!DOCTYPE h [<!ENTITY e 'x'>]>", "&e;"),
               MinimalWritten(MovedTo, "x"), found}},
             {"ByteOrderMark",
              {"\xEF\xBB\xBF" + Minimal(MovedFrom, "<?xml version='1.0' encoding='utf-8'?>"),
               written, found}},
             {"Utf16", {"{utf16}" + Minimal(MovedFrom), written, found}},
             {"MixedContentIsIndented",
              {Written(
                   MovedFrom,
                   "<FilterSetting>\n \nt<x>u<y/>v</x><![CDATA[<w>]]>z<!--c--></FilterSetting>"),
               Written(MovedTo, mixed), found, "hf_folder"}},
             {"IndentedOnceOnly",
              {Written(MovedFrom, mixed), Written(MovedTo, mixed), found, "hf_folder"}}})
            .Before({{"hot/Foreign/[P]/Folder.cfg#", "HS"}}),
        HotFolders("OnlyATemplateInTheFolderBeingLeftMoves",
                   {{"ATemplateInASubfolder", path("{previous}{/}Sub{/}x")},
                    {"ATemplateElsewhere", path("{previous}2{/}x")},
                    {"ATemplateOnAServerStays", path("\\\\host\\share\\x\\B")},
                    {"ATemplateOnAServerStaysWithSlashes", path("//host/share/B")},
                    {"Dots", path("{app}{/}.{/}..{/}Vorige 版{/}x", "{default}{/}x")},
                    {"WithoutImposeSettingNothingIsLogged", {"<HotFolder/>", "", ""}},
                    {"WithoutTheTemplateKey",
                     {Replaced(Minimal(MovedFrom), "ORX", "orx"), "", Found("")}}}),
        HotFolders("ATemplateOnTheShareBeingLeftMoves",
                   {{"ThisShare", path("{/}{/}host{/}share{/}old{/}x", "{default}{/}x")},
                    {"ATemplateOnAnotherShareStays", path("{/}{/}host{/}other{/}old{/}x")}})
            .Before({{UserHive, Hive(UserKey, "\"Path\"=\"{/}{/}host{/}share{/}old\"")}}),
        HotFolders("ATemplateInARelativeFolderMoves", {{"A", path("x{/}y{/}B", "{default}{/}B")}})
            .Before({{UserHive, Hive(UserKey, "\"Path\"=\"x{/}y\"")}}),
        HotFolders("DamagedFolderCfgsStayAndShowAsDisabled",
                   {{"Empty", {}},
                    {"Truncated", {Data("foreign.cfg", MovedFrom).substr(0, 700)}},
                    {"WithoutADescription",
                     {Replaced(Written(MovedTo), " description=\"\"", ""), "", Found(MovedTo)}},
                    {"WithoutADescriptionButDisabled",
                     {Replaced(Replaced(Written(MovedTo), " description=\"\"", ""), "Enable=\"1\"",
                               "Enable=\"0\""),
                      "", Found(MovedTo)}}})
            .LibraryReports(4)
            .IsReported(R"(
Empty: problem  Folder.cfg: damaged (line 1: no element found); it stays as it is, and the folder shows as disabled
Truncated: problem  Folder.cfg: damaged (line 1: unclosed token); it stays as it is, and the folder shows as disabled
WithoutADescription: problem  Folder.cfg: lacks "description", so the enabled folder shows as disabled)"),
        Scenario("Losses", DoneFolder("A", Rich()))
            .Before(DoneFolder("B", Replaced(Written(MovedFrom), " TimeInterval=\"010\"", "")))
            .Before(DoneFolder("C", Replaced(Written(MovedFrom), "Enable=\"1\"", "Enable=\"true\""),
                               Disabled))
            .Before(DoneFolder("D", utf16))
            .Before(
                DoneFolder("E", Replaced(Written(MovedFrom), " description=\"\"", ""), Disabled))
            .IsReported(R"(
A: problem  Folder.cfg: loses its document type, and with it the entities in its texts
A: problem  Folder.cfg: loses the instruction <?top?>
A: problem  Folder.cfg: its root <Old> comes out as <HotFolder>
A: problem  Folder.cfg: lacks "Quickset", so the rewrite resets: Quickset_Supported, IsWidthBased
A: problem  Folder.cfg: server_version="5b" comes out as "5"
A: problem  Folder.cfg: loses the attribute mine="7"
A: problem  Folder.cfg: loses <KEYVALUE Key="B" Mine="" Value="1"> in <JobSetting>
A: problem  Folder.cfg: loses <KEYVALUE Key="B" KeyDisplayValue="two" LocDisplayValue="zwei" Value="2"> in <JobSetting>
A: problem  Folder.cfg: loses <Mine>
A: problem  Folder.cfg: loses <b> in <Mine>
A: problem  Folder.cfg: loses <Paths>
A: problem  Folder.cfg: loses the text "Note"
A: {moves}
B: problem  Folder.cfg: lacks "TimeInterval", so the rewrite resets: PPDVersion, ServerTypeAndJPDefaultKeyInfo, server_version, server_textversion, server_type, Quickset, Quickset_Supported, IsWidthBased
B: {moves}
C: problem  Folder.cfg: Enable="true" comes out as "0"
C: {moves}
D: {moves}
D: note     Folder.cfg: comes out as UTF-8
E: problem  Folder.cfg: lacks "description", so the rewrite resets: server_ip, server_name, Enable, BaseVirtualPrinter, BaseVirtualPrinterName, BaseVirtualPrinterDisplayName, HFPresetName, Centralized, IsCustomInterval, TimeInterval, PPDVersion, ServerTypeAndJPDefaultKeyInfo, server_version, server_textversion, server_type, Quickset, Quickset_Supported, IsWidthBased (the folder ends up disabled)
E: {moves})"),
    };
}

// What a user who is not root can neither read nor write.
SCENARIOS(Refusals)
{
    const Text found = Found(MovedFrom);
    const Text cfg = Written(MovedFrom);
    const Text preset = Stored(MovedFrom);
    const Text icon = Replaced(Icon, "A", "B");
    return {
        Refused("WhatCannotBeReadStays",
                {{CfgPlace, cfg}, {"hot/B/[P]/Folder.cfg", cfg}, {"hot/C/[P]/Folder.cfg", cfg}}, 3)
            .Before({{CfgPlace + "#", "0"}, {"hot/B/[P]#", "0"}, {"hot/C#", "0"}})
            .Before({{PresetPlace, preset}, {PresetPlace + "#", "0"}})
            .Log({{"A", "", Disabled}, {"B", NoCfg, Disabled}, {"C", NoCfg, Disabled}},
                 PresetLine("Unable to open preset.xml for read : "))
            .IsReported(R"(
A: problem  Folder.cfg: can't open file*
B: problem  [_ORX_HotFolder_]: cannot be entered
C: problem  the hot folder cannot be entered
Job presets: problem  .P{xml}: cannot be opened for reading (can't open file*)"),
        Refused("WhatCannotBeWrittenStays", {{CfgPlace + "#", "R"}, {PresetPlace + "#", "R"}}, 2)
            .Before({{CfgPlace, cfg}, {PresetPlace, preset}})
            .Log({{"A", found}}, PresetLine("Unable to open preset.xml for write : "))
            .IsReported(R"(
A: problem  Folder.cfg: cannot be opened for writing (can't open file*
A: problem  stays in the folder being left (in a file that stays as it is): {previous}{/}Booklet.tpl
Job presets: problem  .P{xml}: cannot be opened for writing (can't open file*
Job presets: problem  .P{xml}: stays in the folder being left (in a file that stays as it is): {previous}{/}Booklet.tpl)"),
        Refused("NeitherIconsNorADesktopIniCanBeReplaced", DoneFolder("A", Written(MovedTo)))
            .Before({{Ini, "[.ShellClassInfo]"}, {Ini + "#", "X"}, {CfgPlace + "#", "R"}})
            .Before({{icon, "old"}, {icon + "#", "R"}, {"tool/hf_folder.ico#", "0"}})
            .Before({{"hot/B/[P]#", "X"}, {"hot/B/Desktop.ini", ""}, {"hot/B/Desktop.ini#", "0"}})
            .IsReported(R"(
A: problem  hf_folder.ico: cannot be replaced with {tool}{/}hf_folder.ico (error *
A: problem  Desktop.ini: cannot be opened for reading and writing (error *
A: problem  Desktop.ini: its attributes cannot be changed
B: problem  hf_folder_disabled.ico: cannot be replaced with {tool}{/}hf_folder_disabled.ico (error *
B: problem  Desktop.ini: cannot be opened for reading and writing (error *
B: change   Desktop.ini: attributes )" +
                        Text(IsWindows ? "none" : "READONLY") + R"( -> READONLY SYSTEM
B: change   hot folder: attributes none -> SYSTEM
B: note     no Folder.cfg)"),
        Refused("AReadOnlyLogStays", {{LogPlace + "#", "R"}})
            .File(PresetPlace, preset, Stored(MovedTo))
            .IsReported(R"(
Workstation: problem  there will be no run log: can't open file*
Job presets: {presetmoves})"),
        Refused("AnUnreadableListIsEmptyAndAClosedPresetFolderSkipped",
                {{ListPlace + "#", "0"}, {JobPresets + "/.P#", "0"}})
            .File(PresetPlace, preset)
            .Log()
            .IsReported(R"(
Workstation: problem  can't open file*; no hot folder is migrated
Job presets: problem  .P{xml}: {user}{/}ORX{/}JPData{/}.P cannot be entered)"),
    };
}

} // namespace
