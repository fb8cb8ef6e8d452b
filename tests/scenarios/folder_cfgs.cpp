// Folder.cfg: what is read, what moves, and the form in which it is written again.
#include "tests/scenarios/texts.h"

namespace
{

Text Filter(const Text& content)
{
    return "<FilterSetting>" + content + "</FilterSetting>";
}

// A chain of nested elements, as the library writes it; levels are counted from 1.
Text Nested(int levels)
{
    const auto indentation = [](int level)
    {
        return "\n" + Text(static_cast<size_t>(2 * level + 2), ' ');
    };
    Text text;
    for (int level = 1; level < levels; ++level)
        text += indentation(level) + "<e>";
    text += indentation(levels) + "<e/>";
    for (int level = levels - 1; level > 0; --level)
        text += indentation(level) + "</e>";
    return text + "\n  ";
}

// The same on one line.
Text Chain(int levels)
{
    Text text;
    for (int level = 0; level < 2 * levels; ++level)
        text += level < levels ? "<e>" : "</e>";
    return text;
}

// Hot folders that each lack one attribute of the root, and one that has all.
Scenario Gaps()
{
    const std::vector<Text> chain = {"description",
                                     "server_ip",
                                     "server_name",
                                     "Enable",
                                     "BaseVirtualPrinter",
                                     "BaseVirtualPrinterName",
                                     "BaseVirtualPrinterDisplayName",
                                     "HFPresetName",
                                     "Centralized",
                                     "Isjobpresetattached",
                                     "IsCustomInterval",
                                     "TimeInterval",
                                     "PPDVersion",
                                     "ServerTypeAndJPDefaultKeyInfo",
                                     "server_textversion",
                                     "server_type",
                                     "Quickset",
                                     "Quickset_Supported",
                                     "Quickset_Enabled",
                                     "IsWidthBased"};
    // server_version is read after 14 of them, and is no gap itself.
    const std::vector<std::pair<Text, Text>> numbers = {{"2147483647", "2147483647"},
                                                        {"-2147483648", "-2147483648"},
                                                        {"2147483648", "0"},
                                                        {"x1", "0"},
                                                        {" 01", "1"},
                                                        {"", "0"},
                                                        {"9x", "9"}};
    Scenario scenario("AttributesAfterAGapComeOutAsDefaults");
    Text log;
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
        const Text name = "gap " + std::to_string(10 + gap);
        scenario
            .Before({{"hot/" + name + "/[P]/Folder.cfg",
                      Replaced(Minimal(MovedFrom), "<HotFolder", attributes)}})
            .After({{"hot/" + name + "/[P]/Folder.cfg",
                     Replaced(written, "\"-1\"", "\"" + (gap < 14 ? "-1" : read) + "\"")}});
        log += FolderLines(name, static_cast<int>(gap) + 1,
                           NoIcon(gap > 3 ? "hf_folder" : "hf_folder_disabled"),
                           Found(MovedFrom, name));
    }
    return scenario.Log(log);
}

std::vector<Scenario> FolderCfgs()
{
    const Text found = Found(MovedFrom);
    const Text written = MinimalWritten(MovedTo);
    const Text mixed =
        Filter("t\n    <x>u\n      <y/>v</x>\n    <![CDATA[<w>]]>z\n    <!--c-->\n  ");
    const auto elsewhere = [](const Text& name, const Text& path)
    {
        return Scenario(name).FolderCfg(Written(path)).LogOfA(Found(path));
    };
    const Text onServer = "{/}{/}host{/}share{/}old{/}x";
    const auto onShare = [&](const Text& name, const Text& share)
    {
        return Scenario(name)
            .Before({{UserHive, UserValue("\"Path\"=\"{/2}{/2}host{/2}" + share + "{/2}old\"")}})
            .LogOfA(Found(onServer));
    };
    const auto nested = [&](const Text& name, int levels)
    {
        return Scenario(name).FolderCfg(Written(MovedFrom, Filter(Chain(levels))));
    };
    return {
        Gaps(),
        Scenario("AForeignFolderCfgIsRewrittenInTheToolsForm")
            .FolderCfg(Foreign(MovedFrom), Written(MovedTo))
            .LogOfA(found),
        Scenario("AnIncompleteChainIsRewrittenWithDefaults")
            .FolderCfg(Minimal(MovedFrom), written)
            .LogOfDisabledA(found),
        Scenario("ADocumentTypeIsNotCarriedOver")
            .FolderCfg(Minimal(MovedFrom, "<!DOCTYPE h [<!ENTITY e 'x'>]>", "&e;"),
                       MinimalWritten(MovedTo, "x"))
            .LogOfDisabledA(found),
        Scenario("FolderCfgLosesItsByteOrderMark")
            .FolderCfg("\xEF\xBB\xBF" +
                           Minimal(MovedFrom, "<?xml version='1.0' encoding='utf-8'?>"),
                       written)
            .LogOfDisabledA(found),
        Scenario("AUtf16FolderCfgComesOutInUtf8")
            .FolderCfg("{utf16}" + Minimal(MovedFrom), written)
            .LogOfDisabledA(found),
        elsewhere("ATemplateInASubfolderStays", "{previous}{/}Sub{/}x"),
        elsewhere("ATemplateElsewhereStays", "{previous}2{/}x"),
        elsewhere("ATemplateOnAServerStays", "\\\\host\\share\\x\\B"),
        elsewhere("ATemplateOnAServerStaysWithSlashes", "//host/share/B"),
        onShare("ATemplateOnTheShareBeingLeftMoves", "share")
            .FolderCfg(Written(onServer), Written("{default}{/}x")),
        onShare("ATemplateOnAnotherShareStays", "other").FolderCfg(Written(onServer)),
        Scenario("ATemplateInARelativeFolderMoves")
            .Before({{UserHive, UserValue("\"Path\"=\"x{/2}y\"")}})
            .FolderCfg(Written("x{/}y{/}B"), Written("{default}{/}B"))
            .LogOfA(Found("x{/}y{/}B")),
        Scenario("HiddenAndSystemFilesAreWrittenAndKeepTheirAttributes")
            .Before({{CfgPlace + "#", "HS"}, {PresetPlace + "#", "HS"}})
            .FolderCfg(Written(MovedFrom), Written(MovedTo))
            .Preset(Stored(MovedFrom), Stored(MovedTo))
            .LogOfA(found, PresetLine(Updated)),
        Scenario("AnEmptyFolderCfgStays").FolderCfg("").LogOfDisabledA("").LibraryReports(),
        Scenario("ATruncatedFolderCfgStays")
            .FolderCfg(Foreign(MovedFrom).substr(0, 700))
            .LogOfDisabledA("")
            .LibraryReports(),
        Scenario("WithoutImposeSettingNothingIsLogged")
            .FolderCfg("<HotFolder/>")
            .LogOfDisabledA(""),
        Scenario("WithoutTheTemplateKeyNothingMoves")
            .FolderCfg("<H><ImposeSetting><K k='orximposetemplate' v='" + MovedFrom +
                       "'/></ImposeSetting></H>")
            .LogOfDisabledA(Found("")),
        Scenario("MixedContentIsIndented")
            .FolderCfg(Written(MovedFrom, Filter("\n \nt<x>u<y/>v</x><![CDATA[<w>]]>z<!--c-->")),
                       Written(MovedTo, mixed))
            .LogOfA(found),
        Scenario("MixedContentIsIndentedOnceOnly")
            .FolderCfg(Written(MovedFrom, mixed), Written(MovedTo, mixed))
            .LogOfA(found),
        nested("AFilterOf1000LevelsIsSaved", 1000)
            .After({{CfgPlace, Written(MovedTo, Filter(Nested(1000)))}})
            .LogOfA(found),
        nested("AFilterThatWouldBeTooBigToReadStays", 1025)
            .LogOfA(found + Untouched("the new content would be too large")),
        nested("AFilterThatIsTooDeepIsNotRead", 2048)
            .LogOfDisabledA(Untouched("too large to read safely")),
        Scenario("ADotInTheStoredPathDoesNotMatter")
            .FolderCfg(Written("{app}{/}.{/}template{/}x"), Written("{previous}{/}x"))
            .Run({"U"})
            .LogOfA(Found("{app}{/}.{/}template{/}x")),
        Scenario("AMissingFolderCfgIsLogged").Before({{"hot/A/[P]/", ""}}).LogOfDisabledA(NoCfg()),
    };
}

// The paths are ASCII, because nothing else can be compared in these encodings.
std::vector<Scenario> Encodings()
{
    const auto declared = [](const Text& name, const Text& encoding, const Text& folder)
    {
        return Scenario(name)
            .Before({{MachineHive, MachineValue("\"InstallPath\"=\"{HOT}\"")},
                     {UserHive, UserValue("\"Path\"=\"{HOT}\"")}})
            .FolderCfg(
                Minimal("{hot}{/}x", "<?xml version='1.0' encoding" + encoding + "?>", folder))
            .LogOfDisabledA(Found("{hot}{/}x") + Untouched("unknown encoding"));
    };
    const auto ascii = [&](const Text& name, const Text& encoding)
    {
        return declared(name, "='" + encoding + "'", "x")
            .After({{CfgPlace, MinimalWritten("{hot}{/}template{/}x", "x")}})
            .LogOfDisabledA(Found("{hot}{/}x"));
    };
    return {
        ascii("AsciiInUtf8OfAnotherNameIsRead", "UTF8"),
        ascii("AsciiInLatin1IsRead", "latin1"),
        ascii("AsciiIsRead", "ASCII"),
        ascii("AsciiInWindows1252IsRead", "windows-1252"),
        ascii("AsciiInShiftJisIsRead", "Shift_JIS"),
        declared("Utf8OfAnotherNameStays", "='UTF8'", "\xC3\xA4"),
        declared("AWindows1252FolderCfgComesOutInUtf8", "='windows-1252'", "\x80\xE4")
            .After({{CfgPlace, MinimalWritten("{hot}{/}template{/}x", "€ä")}})
            .LogOfDisabledA(Found("{hot}{/}x")),
        declared("AFolderCfgInWindows1253Stays", "='windows-1253'", "\xE1\xD2"),
        declared("AFolderCfgInShiftJisStays", "='Shift_JIS'", "\x93\xFA\x96\x7B"),
        declared("ShiftJisStaysWithSpacesInItsDeclaration", " = 'Shift_JIS'", "\x93\xFA"),
        declared("AFolderCfgInAnUnknownEncodingStays", "='x-own'", "x"),
        declared("AnUnknownEncodingIsSeenAfterAByteOrderMark", "", "")
            .FolderCfg("\xEF\xBB\xBF" +
                       Minimal("{hot}{/}x", "<?xml version='1.0' encoding='x-own'?>")),
    };
}

TEST_SCENARIOS(FolderCfgs);
TEST_SCENARIOS(Encodings);

} // namespace
