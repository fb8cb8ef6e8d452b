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
    const std::vector<std::pair<Text, Text>> numbers = {{"2147483647", "2147483647"},
                                                        {"-2147483648", "-2147483648"},
                                                        {"2147483648", "0"},
                                                        {"x1", "0"},
                                                        {" 01", "1"},
                                                        {"", "0"},
                                                        {"9x", "9"}};
    std::map<Text, HotFolder> folders;
    for (size_t gap = 0; gap <= chain.size(); ++gap)
    {
        const auto& [number, read] = numbers[gap < 14 ? 0 : gap - 14];
        Text attributes = "<HotFolder server_version='" + number + "'";
        Text written = MinimalWritten(MovedTo);
        for (size_t i = 0; i < chain.size(); ++i)
        {
            const Text value = " " + chain[i] + "=\"1\"";
            attributes += i == gap ? "" : value;
            for (const char* unset : {"\"\"", "\"0\""})
                written = Replaced(written, " " + chain[i] + "=" + unset,
                                   i < gap ? value : " " + chain[i] + "=" + unset);
        }
        folders["gap " + std::to_string(10 + gap)] = {
            Replaced(Minimal(MovedFrom), "<HotFolder", attributes),
            Replaced(written, "\"-1\"", "\"" + (gap < 14 ? "-1" : read) + "\""), Found(MovedFrom),
            gap > 3 ? "hf_folder" : Disabled};
    }
    return HotFolders("AttributesAfterAGapComeOutAsDefaults", folders);
}

// The paths are ASCII, because nothing else can be compared in these encodings.
Scenario Encodings()
{
    const auto declared = [](const Text& encoding, const Text& name)
    {
        return Minimal("{hot}{/}x", "<?xml version='1.0' encoding" + encoding + "?>", name);
    };
    const auto moves = [](const Text& cfg, const Text& name)
    {
        return HotFolder{cfg, MinimalWritten("{hot}{/}template{/}x", name), Found("{hot}{/}x")};
    };
    const auto stays = [](const Text& cfg)
    {
        return HotFolder{cfg, "", Found("{hot}{/}x") + Untouched("unknown encoding")};
    };
    return HotFolders(
               "EncodingsThatTheLibraryReadsWronglyStay",
               {{"Ascii", moves(declared("='ASCII'", "x"), "x")},
                {"AsciiInUtf8OfAnotherName", moves(declared("='UTF8'", "x"), "x")},
                {"AsciiInLatin1", moves(declared("='latin1'", "x"), "x")},
                {"AsciiInShiftJis", moves(declared("='Shift_JIS'", "x"), "x")},
                {"Windows1252", moves(declared("='windows-1252'", "\x80\xE4"), "€ä")},
                {"Utf8OfAnotherName", stays(declared("='UTF8'", "\xC3\xA4"))},
                {"Windows1253", stays(declared("='windows-1253'", "\xE1\xD2"))},
                {"ShiftJisAfterSpaces", stays(declared(" = 'Shift_JIS'", "\x93\xFA"))},
                {"Unknown", stays(declared("='x-own'", "x"))},
                {"UnknownAfterAByteOrderMark", stays("\xEF\xBB\xBF" + declared("='x-own'", "n"))}})
        .Before({{MachineHive, MachineValue("\"InstallPath\"=\"{hot}\"")},
                 {UserHive, UserValue("\"Path\"=\"{hot}\"")}});
}

SCENARIOS(FolderCfgs)
{
    const Text found = Found(MovedFrom);
    const Text written = MinimalWritten(MovedTo);
    const Text mixed = "<FilterSetting>t\n    <x>u\n      <y/>v</x>\n    <![CDATA[<w>]]>z\n    "
                       "<!--c-->\n  </FilterSetting>";
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
              {Written(MovedFrom, mixed), Written(MovedTo, mixed), found, "hf_folder"}}}),
        HotFolders("OnlyATemplateInTheFolderBeingLeftMoves",
                   {{"ATemplateInASubfolder", path("{previous}{/}Sub{/}x")},
                    {"ATemplateElsewhere", path("{previous}2{/}x")},
                    {"ATemplateOnAServerStays", path("\\\\host\\share\\x\\B")},
                    {"ATemplateOnAServerStaysWithSlashes", path("//host/share/B")},
                    {"Dots", path("{app}{/}.{/}..{/}Vorige 版{/}x", "{default}{/}x")},
                    {"WithoutImposeSettingNothingIsLogged", {"<HotFolder/>", "", ""}},
                    {"WithoutTheTemplateKey",
                     {"<H><ImposeSetting><K k='orximposetemplate' v='" + MovedFrom +
                          "'/></ImposeSetting></H>",
                      "", Found("")}}}),
        HotFolders("ATemplateOnTheShareBeingLeftMoves",
                   {{"ThisShare", path("{/}{/}host{/}share{/}old{/}x", "{default}{/}x")},
                    {"ATemplateOnAnotherShareStays", path("{/}{/}host{/}other{/}old{/}x")}})
            .Before({{UserHive, UserValue("\"Path\"=\"{/}{/}host{/}share{/}old\"")}}),
        HotFolders("ATemplateInARelativeFolderMoves", {{"A", path("x{/}y{/}B", "{default}{/}B")}})
            .Before({{UserHive, UserValue("\"Path\"=\"x{/}y\"")}}),
        Scenario("HiddenAndSystemFilesAreWrittenAndKeepTheirAttributes")
            .Before({{CfgPlace + "#", "HS"}, {PresetPlace + "#", "HS"}})
            .File(CfgPlace, Written(MovedFrom), Written(MovedTo))
            .File(PresetPlace, Stored(MovedFrom), Stored(MovedTo))
            .LogOfA(found, PresetLine(Updated)),
        HotFolders("DamagedFolderCfgsStay",
                   {{"Empty", {}}, {"Truncated", {Data("foreign.cfg", MovedFrom).substr(0, 700)}}})
            .LibraryReports(),
    };
}

// Stored files that a user who is not root cannot read or write; icons.cpp has the others.
SCENARIOS(Refusals)
{
    const Text found = Found(MovedFrom);
    const Text cfg = Written(MovedFrom);
    const auto refused = [](const Text& name, const Text& place, const Text& attributes)
    {
        return Scenario(name).Before({{place + "#", attributes}}).AsOtherUser().LibraryReports();
    };
    return {
        refused("AReadOnlyFolderCfgStays", CfgPlace, "R").File(CfgPlace, cfg).LogOfA(found),
        refused("AnUnreadableFolderCfgStays", CfgPlace, "0")
            .File(CfgPlace, cfg)
            .LogOfA("", "", Disabled),
        refused("AnUnreadablePresetStays", PresetPlace, "0")
            .File(PresetPlace, Stored(MovedFrom))
            .LogOfPreset("Unable to open preset.xml for read : "),
        refused("AReadOnlyPresetStays", PresetPlace, "R")
            .File(PresetPlace, Stored(MovedFrom))
            .LogOfPreset("Unable to open preset.xml for write : "),
        refused("AReadOnlyLogStays", LogPlace, "R").File(CfgPlace, cfg, Written(MovedTo)),
        refused("AnUnreadableListIsEmpty", ListPlace, "0").Before({{"hot/A/", ""}}).Log(""),
    };
}

} // namespace
