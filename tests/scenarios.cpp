#include "tests/scenario.h"
#include "tests/text_files.h"

const std::string OldLog = "The log of an earlier run\r\n";

namespace
{

using Text = std::string;

const char* const ListPlace = "machine/hotfolder/HotFolderList.cfg";
const char* const CfgA = "hot/A/[P]/Folder.cfg";
const char* const PresetP = "user/ORX/JPData/.P/Presets/presets.xml";
const Text Removed = "(not there)";

const Text MovedFrom = "{previous}{/}Booklet.tpl";
const Text MovedTo = "{default}{/}Booklet.tpl";

Text Repeat(const Text& text, int times)
{
    Text result;
    for (int i = 0; i < times; ++i)
        result += text;
    return result;
}

// Files ------------------------------------------------------------------------------------------

// A hive with one value in one key; {APP} and {PREVIOUS} are the folders as such text has them.
Text Hive(const Text& key, const Text& value)
{
    return "Windows Registry Editor Version 5.00\r\n\r\n[" + key + "]\r\n\"Other\"=dword:00000001\r\n" + value + "\r\n";
}

Text MachineValue(const Text& value)
{
    return Hive("HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA", value);
}

Text UserValue(const Text& value)
{
    return Hive("HKEY_CURRENT_USER\\SOFTWARE\\HF", value);
}

Text Bytes(const Text& name, const Text& type, const Text& bytes)
{
    static const char* const digits = "0123456789abcdef";
    Text value = "\"" + name + "\"=hex" + type + ":";
    for (const char byte : bytes)
    {
        const auto number = static_cast<unsigned char>(byte);
        value += Text(1, digits[number / 16]) + digits[number % 16] + ",";
    }
    value.pop_back();
    return value;
}

// A file of tests/data, with what stands in doubled braces replaced.
Text Data(const Text& file, const Files& values)
{
    Text text = ReadFile(Text(DATA_DIR) + "/" + file);
    for (const auto& [name, value] : values)
        ReplaceAll(text, "{{" + name + "}}", value);
    return text;
}

// A Folder.cfg as the tool writes it.
Text Written(const Text& path, const Text& filter = "  <FilterSetting mode=\"2\" name=\"&lt;\">\n    <a/>\n  </FilterSetting>\n")
{
    return Data("written.cfg", {{"path", path}, {"filter", filter}});
}

// The same settings as another program may write them.
Text Foreign(const Text& path)
{
    return Data("foreign.cfg", {{"path", path}});
}

// A Folder.cfg with just an imposition entry, and the way it comes out.
Text Minimal(const Text& path, const Text& declaration = "", const Text& name = "n")
{
    return declaration + "<HotFolder name=\"" + name + "\"><ImposeSetting><K k=\"ORXImposeTemplate\" v=\"" + path +
           "\"/></ImposeSetting></HotFolder>";
}

Text MinimalWritten(const Text& path, const Text& name = "n")
{
    return Data("minimal_written.cfg", {{"path", path}, {"name", name}});
}

Text Filter(const Text& content)
{
    return "  <FilterSetting>" + content + "</FilterSetting>\n";
}

// A chain of elements, as the library writes it: one below the other, the levels counted from 1.
Text Nested(int levels)
{
    Text opened;
    Text closed;
    for (int level = 1; level <= levels; ++level)
    {
        const Text indentation = "\n" + Text(static_cast<size_t>(2 * level + 2), ' ');
        opened += indentation + (level < levels ? "<e>" : "<e/>");
        closed = (level < levels ? indentation + "</e>" : "") + closed;
    }
    return opened + closed + "\n  ";
}

// A template path as a preset stores it.
Text Stored(const Text& path)
{
    return "<K n=\"ORXImposeTemplate\">\"" + path + "\"</K>\r\n";
}

// The workstation that every row starts from, and what the row has otherwise.
Files World(const Files& special)
{
    Files files = {{LogPlace, OldLog},
                   {"user/ORX/JPData/", ""},
                   {MachineHive, MachineValue("\"InstallPath\"=\"{APP}\"")},
                   {UserHive, UserValue("\"Path\"=\"{PREVIOUS}\"")}};
    Text list = "<HotFolders>";
    Text last;
    for (const auto& [place, text] : special)
    {
        const Text name = place.compare(0, 4, "hot/") == 0 ? place.substr(4, place.find('/', 4) - 4) : "";
        if (!name.empty() && name != last)
            list += "<HotFolder path=\"{hot}{/}" + name + "\"/>";
        last = name.empty() ? last : name;
    }
    files[ListPlace] = list + "</HotFolders>";
    for (const auto& [place, text] : special)
        files[place] = text;
    for (auto file = files.begin(); file != files.end();)
        file = file->second == Removed ? files.erase(file) : std::next(file);
    return files;
}

Files OneFolder(const Text& cfg, const Files& special = {})
{
    Files files = special;
    files[CfgA] = cfg;
    return World(files);
}

Files OnePreset(const Text& preset, const Files& special = {})
{
    Files files = special;
    files[PresetP] = preset;
    return World(files);
}

// Logs -------------------------------------------------------------------------------------------

Text Log(const Text& letter, const Text& folders, const Text& presets = "")
{
    const Text start = letter == "I" ? "Installation : Upgrade call with switch: I\n" : "Un-installation : Downgrade call with switch: U\n";
    return start + (folders.empty() ? "No Hotfolder listed\n" : "") + "Start: HF updation\n" + folders +
           "End: HF updation\nStart: Updating Impose path for JP Presets\n" + presets + "End: Updating Impose path for JP Presets\n";
}

Text NoIcon(const Text& name)
{
    return "Icon path  not exist: {tool}{/}" + name + ".ico\n";
}

// One folder's lines: what its icon and its template led to.
Text Folder(const Text& name, int position, const Text& icon, const Text& impose)
{
    const Text end = name + " count:  " + std::to_string(position) + "\n";
    return icon + "Updated icon for hf{hot}{/}" + end + impose + "updated Impose path for hf{hot}{/}" + end;
}

Text Found(const Text& path, const Text& name = "A")
{
    return "Imposepath:{hot}{/}" + name + "is: " + path + "\n";
}

Text LogOfA(const Text& impose, const Text& letter = "I", const Text& icon = "hf_folder", const Text& presets = "")
{
    return Log(letter, Folder("A", 1, NoIcon((letter == "U" ? "BundleIcons{/}" : "") + icon), impose), presets);
}

Text Untouched(const Text& reason)
{
    return "HF cfg file left as it is (" + reason + "): {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
}

const Text NoDefault = "Unable to read: Default Impose Template Path\n";
const Text NoPrevious = "Unable to read: Previous Version  Default Impose Template Path\n";
const Text NoPreviousTo = "unable to read: Previous Version  Default Impose Template Path\n";

Text PresetLine(const Text& line)
{
    return line + "{user}{/}ORX{/}JPData{/}.P{/}Presets{/}presets.xml\n";
}

Text LogOfPreset(const Text& line, const Text& letter = "I")
{
    return Log(letter, "", PresetLine(line));
}

const Text Updated = "Updated preset.xml  : ";

// Rows -------------------------------------------------------------------------------------------

using Rows = std::vector<Scenario>;

void AddRuns(Rows& rows)
{
    const Files before = OneFolder(Written(MovedFrom));
    const Files moved = {{CfgA, Written(MovedTo)}};
    const Text log = LogOfA(Found(MovedFrom));
    const Text invalid = "Invalid call check calling parameter: exiting....\n";
    rows.push_back({"NoSwitchTouchesNothing", before, {}, {}, OldLog});
    rows.push_back({"ADashedSwitchIsInvalid", before, {"-I"}, {}, invalid});
    rows.push_back({"AnInvalidSwitchIsNotLoggedWithV", before, {"X", "V"}, {}, OldLog});
    rows.push_back({"VLeavesTheLogAlone", before, {"I", "v"}, moved, OldLog});
    rows.push_back({"AnUpgradeMovesTheTemplate", before, {"i"}, moved, log});
    rows.push_back({"VIsIgnoredBeforeAnotherArgument", before, {"I", "V", "x"}, moved, log});
    rows.push_back({"AnotherSecondArgumentIsIgnored", before, {"I", "W"}, moved, log});
    rows.push_back(
        {"ADowngradeMovesTheTemplateBack", OneFolder(Written(MovedTo)), {"u"}, {{CfgA, Written(MovedFrom)}}, LogOfA(Found(MovedTo), "U")});
    rows.push_back({"WithoutALogFolderTheRestIsDone", OneFolder(Written(MovedFrom), {{LogPlace, Removed}}), {"I"}, moved, OldLog});
    rows.push_back(
        {"AMissingLogIsCreated", OneFolder(Written(MovedFrom), {{LogPlace, Removed}, {"user/ORX_Installers/", ""}}), {"I"}, moved, log});
    rows.push_back({"ALogWithAByteOrderMarkLosesIt", OneFolder(Written(MovedFrom), {{LogPlace, "{utf16}old\r\n"}}), {"I"}, moved, log});
    rows.push_back({"AFolderInPlaceOfTheLogStopsNothing",
                    OneFolder(Written(MovedFrom), {{LogPlace, Removed}, {Text(LogPlace) + "/", ""}}),
                    {"I"},
                    moved,
                    OldLog});
    rows.push_back({"APercentSignIsLoggedAsItIs",
                    World({{"hot/%d %s/", ""}}),
                    {"I"},
                    {},
                    Log("I", Folder("%d %s", 1, NoIcon("hf_folder_disabled"),
                                    "HF cfg file unable to read/exist: {hot}{/}%d %s{/}[_ORX_HotFolder_]{/}"
                                    "Folder.cfg\n"))});
}

void AddLists(Rows& rows)
{
    const Text gone = "HF cfg file unable to read/exist: {hot}{/}";
    const auto folder = [&](const Text& name, int position)
    {
        return Folder(name, position, NoIcon("hf_folder_disabled"), gone + name + "{/}[_ORX_HotFolder_]{/}Folder.cfg\n");
    };
    const Files folders = {{"hot/A/", ""}, {"hot/b ü 漢/", ""}, {"hot/C/", ""}, {"hot/file", "x"}};
    const auto listed = [&](const Text& list)
    {
        Files files = folders;
        files[ListPlace] = list;
        return World(files);
    };
    rows.push_back({"ListedFoldersThatExistAreTakenOnceAndInOrder",
                    listed("<any><!-- --><HotFolder/><HotFolder path=''/><HotFolder path='{hot}{/}missing'/>"
                           "<HotFolder path='{hot}{/}C '/><hotfolder path='{hot}{/}A'/>"
                           "<x><HotFolder path='{hot}{/}A'/></x><HotFolder path='{hot}{/}file'/>"
                           "<HotFolder Path='{hot}{/}A'/><HotFolder path=' {hot}{/}A'/>"
                           "<HotFolder z='1' path='{hot}{/}b ü 漢&#10;'/><HotFolder path='{hot}{/}C'/></any>"),
                    {"I"},
                    {},
                    Log("I", folder("C", 1) + folder("b ü 漢", 2))});
    rows.push_back({"ARepeatInAnotherCaseIsDropped",
                    World({{"hot/A/", ""},
                           {"hot/a/", ""},
                           {"hot/ä/", ""},
                           {ListPlace, "<l><HotFolder path='{hot}{/}a'/><HotFolder path='{hot}{/}A'/></l>"}}),
                    {"I"},
                    {},
                    Log("I", folder("a", 1)),
                    false,
                    false,
                    nullptr});
    rows.push_back(
        {"AnEmptyListStillMigratesPresets", OnePreset(Stored(MovedFrom)), {"I"}, {{PresetP, Stored(MovedTo)}}, LogOfPreset(Updated)});
    rows.push_back({"AMissingListStillMigratesPresets",
                    OnePreset(Stored(MovedFrom), {{ListPlace, Removed}}),
                    {"I"},
                    {{PresetP, Stored(MovedTo)}},
                    LogOfPreset(Updated)});
    rows.push_back({"AMalformedListIsEmpty", listed("<any><HotFolder path='{hot}{/}A'/>"), {"I"}, {}, Log("I", ""), true});
    rows.push_back(
        {"AUtf16ListIsRead", listed("{utf16}<a><HotFolder path='{hot}{/}b ü 漢'/></a>"), {"I"}, {}, Log("I", folder("b ü 漢", 1))});
}

void AddFolderCfgs(Rows& rows)
{
    const Text found = Found(MovedFrom);
    const Text disabled = "hf_folder_disabled";
    const auto add = [&](const Text& name, const Text& before, const Text& after, const Text& log, bool libraryLogs = false)
    {
        rows.push_back({name, OneFolder(before), {"I"}, {{CfgA, after}}, log, libraryLogs});
    };
    const auto keep = [&](const Text& name, const Text& cfg, const Text& log, bool libraryLogs = false)
    {
        add(name, cfg, cfg, log, libraryLogs);
    };
    add("AForeignFolderCfgIsRewrittenInTheToolsForm", Foreign(MovedFrom), Written(MovedTo), LogOfA(found));
    add("AnIncompleteChainIsRewrittenWithDefaults", Minimal(MovedFrom), MinimalWritten(MovedTo), LogOfA(found, "I", disabled));
    add("ADocumentTypeIsNotCarriedOver", Minimal(MovedFrom, "<!DOCTYPE h [<!ENTITY e 'x'>]>", "&e;"), MinimalWritten(MovedTo, "x"),
        LogOfA(found, "I", disabled));
    add("AByteOrderMarkGoesFromFolderCfg", "\xEF\xBB\xBF" + Minimal(MovedFrom, "<?xml version='1.0' encoding='utf-8'?>"),
        MinimalWritten(MovedTo), LogOfA(found, "I", disabled));
    add("AUtf16FolderCfgComesOutInUtf8", "{utf16}" + Minimal(MovedFrom), MinimalWritten(MovedTo), LogOfA(found, "I", disabled));
    keep("ATemplateInASubfolderStays", Written("{previous}{/}Sub{/}x"), LogOfA(Found("{previous}{/}Sub{/}x")));
    keep("ATemplateElsewhereStays", Written("{previous}2{/}x"), LogOfA(Found("{previous}2{/}x")));
    keep("AnEmptyFolderCfgStays", "", LogOfA("", "I", disabled), true);
    keep("ATruncatedFolderCfgStays", Foreign(MovedFrom).substr(0, 700), LogOfA("", "I", disabled), true);
    keep("WithoutImposeSettingNothingIsLogged", "<HotFolder/>", LogOfA("", "I", disabled));
    keep("WithoutTheTemplateKeyNothingMoves", "<H><ImposeSetting><K k='orximposetemplate' v='" + MovedFrom + "'/></ImposeSetting></H>",
         LogOfA(Found(""), "I", disabled));
    const Text mixed = Filter("t\n    <x>u\n      <y/>v</x>\n    <![CDATA[<w>]]>z\n    <!--c-->\n  ");
    add("MixedContentIsIndented", Written(MovedFrom, Filter("\n \nt<x>u<y/>v</x><![CDATA[<w>]]>z<!--c-->")), Written(MovedTo, mixed),
        LogOfA(found));
    add("MixedContentIsIndentedOnceOnly", Written(MovedFrom, mixed), Written(MovedTo, mixed), LogOfA(found));
    add("AFilterOf1024LevelsIsSaved", Written(MovedFrom, Filter(Nested(1024))), Written(MovedTo, Filter(Nested(1024))), LogOfA(found));
    for (const int levels : {1025, 60000})
        keep("AFilterOf" + std::to_string(levels) + "LevelsStays",
             Written(MovedFrom, Filter(Repeat("<e>", levels) + Repeat("</e>", levels))),
             LogOfA(found + Untouched("filter setting nested too deep")));
    rows.push_back({"ADotInTheStoredPathDoesNotMatter",
                    OneFolder(Written("{app}{/}.{/}template{/}x")),
                    {"U"},
                    {{CfgA, Written("{previous}{/}x")}},
                    LogOfA(Found("{app}{/}.{/}template{/}x"), "U")});
    rows.push_back({"NoFolderCfgIsLogged",
                    World({{"hot/A/[P]/", ""}}),
                    {"I"},
                    {},
                    LogOfA("HF cfg file unable to read/exist: {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n", "I", disabled)});

    // In these encodings only folders with ASCII names can be told.
    const Files ascii = {{MachineHive, MachineValue("\"InstallPath\"=\"{HOT}\"")}, {UserHive, UserValue("\"Path\"=\"{HOT}\"")}};
    const auto declared = [](const Text& encoding, const Text& name)
    {
        return Minimal("{hot}{/}x", "<?xml version='1.0' encoding='" + encoding + "'?>", name);
    };
    const Text asciiFound = Found("{hot}{/}x");
    rows.push_back({"AWindows1252FolderCfgComesOutInUtf8",
                    OneFolder(declared("windows-1252", "\x80\xE4"), ascii),
                    {"I"},
                    {{CfgA, MinimalWritten("{hot}{/}template{/}x", "€ä")}},
                    LogOfA(asciiFound, "I", disabled)});
    rows.push_back({"AShiftJisDeclarationWithBlanksStays",
                    OneFolder(Minimal("{hot}{/}x", "<?xml version='1.0' encoding = 'Shift_JIS'?>", "\x93\xFA"), ascii),
                    {"I"},
                    {},
                    LogOfA(asciiFound + Untouched("unknown encoding"), "I", disabled)});
    for (const auto& [encoding, name] : Files{{"windows-1253", "\xE1\xD2"}, {"Shift_JIS", "\x93\xFA\x96\x7B"}, {"x-own", "x"}})
        rows.push_back({"ThisEncodingStays_" + encoding.substr(encoding.size() - 3),
                        OneFolder(declared(encoding, name), ascii),
                        {"I"},
                        {},
                        LogOfA(asciiFound + Untouched("unknown encoding"), "I", disabled)});
}

void AddRegistries(Rows& rows)
{
    const Text found = Found(MovedFrom);
    const auto add = [&](const Text& name, const Text& letter, const Files& hives, const Text& folderLines, const Text& presetLines,
                         const Files& after = {})
    {
        Files files = hives;
        const Text path = letter == "I" ? MovedFrom : MovedTo;
        files[CfgA] = Written(path);
        files[PresetP] = Stored(path);
        rows.push_back({name, World(files), {letter}, after, LogOfA(Found(path) + folderLines, letter, "hf_folder", presetLines)});
    };
    const Text updated = PresetLine(Updated);
    const Files moved = {{CfgA, Written(MovedTo)}, {PresetP, Stored(MovedTo)}};
    add("WithoutAnyHiveNothingMoves", "I", {{MachineHive, Removed}, {UserHive, Removed}}, NoPrevious, NoDefault + NoPrevious);
    add("WithoutADefaultFolderAnUpgradeMovesNothing", "I", {{MachineHive, MachineValue("\"x\"=\"y\"")}}, NoDefault, NoDefault);
    add("WithoutAPreviousFolderADowngradeMovesNothing", "U", {{UserHive, UserValue("\"x\"=\"y\"")}}, NoPreviousTo, NoPrevious);
    add("A32BitKeyHidesTheOtherEvenWithoutAValue", "I",
        {{UserHive, UserValue("\"Path\"=\"{PREVIOUS}\"\r\n\r\n[HKEY_CURRENT_USER\\software\\wow6432node\\hf]")}}, NoPrevious, NoPrevious);
    add("A32BitKeyComesFirst", "I",
        {{UserHive, UserValue("\"Path\"=\"x\"\r\n[HKEY_CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF]\r\n"
                              "\"PATH\"=\"{PREVIOUS}\"")},
         {MachineHive, MachineValue("\"InstallPath\"=\"x\"\r\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix\\QZA]\r\n"
                                    "\"InstallPath\"=\"{APP}\"")}},
        "", updated, moved);
    add("ATextOf258CharactersIsTooLong", "I", {{UserHive, UserValue("\"Path\"=\"" + Text(258, 'x') + "\"")}}, NoPrevious, NoPrevious);
    add("ATextOf257CharactersIsRead", "I", {{UserHive, UserValue("\"Path\"=\"" + Text(257, 'x') + "\"")}}, "", updated);
    add("ANumberIsNoFolderThatCanBeStored", "I", {{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}},
        Untouched("new path holds a character that XML cannot store"), updated);
    add("ALoneSurrogateIsNoFolderThatCanBeStored", "I",
        {{MachineHive, MachineValue(Bytes("InstallPath", "", Text("C\0\0\xD8:\0\0\0", 8)))}},
        Untouched("new path holds a character that XML cannot store"), updated);
    add("AnUnterminatedOddValueIsReadToItsLastWholeUnit", "I", {{UserHive, UserValue(Bytes("Path", "(2)", Text("x\0y\0z", 5)))}}, "",
        updated);
    add("AFinalSeparatorMovesPresetsOnly", "I", {{UserHive, UserValue("\"Path\"=\"{PREVIOUS}{/2}\"")}}, "", updated,
        {{PresetP, Stored(MovedTo)}});
    add("AFinalSeparatorIsDoubledInFolderCfgOnly", "U", {{UserHive, UserValue("\"Path\"=\"{PREVIOUS}{/2}\"")}}, "", updated,
        {{CfgA, Written("{previous}{/}{/}Booklet.tpl")}, {PresetP, Stored(MovedFrom)}});
    add("AnEmptyPreviousFolderReplacesNothing", "I", {{UserHive, UserValue("\"Path\"=\"\"")}}, "", updated);
    rows.push_back({"WithoutTheEntryNoFolderIsLookedUp",
                    OneFolder("<H><ImposeSetting/></H>", {{MachineHive, Removed}, {UserHive, "garbage"}}),
                    {"I"},
                    {},
                    LogOfA(Found(""), "I", "hf_folder_disabled", NoDefault + NoPrevious)});
}

void AddPresets(Rows& rows)
{
    const auto add = [&](const Text& name, const Text& before, const Text& after, const Text& line = Updated, bool libraryLogs = false)
    {
        rows.push_back({name, OnePreset(before), {"I"}, {{PresetP, after}}, LogOfPreset(line), libraryLogs});
    };
    const auto left = [&](const Text& name, const Text& preset, const Text& reason)
    {
        add(name, preset, preset, "preset.xml left as it is (" + reason + "): ");
    };
    const Text near = "x ORXImposeTemplate\">\"{previous}er{/}x\" ORXImposeTemplate\">\"{previous} "
                      "orximposetemplate\">\"{previous}\" ORXImposeTemplate='>\"{previous}\" "
                      "ORXImposeTemplate\">\"{previous}";
    add("EveryPathInTheFolderMoves",
        "\r\n" + Stored(MovedFrom) + near + "\r\n" + Stored("{previous}{/}Sub{/}x") + Stored("{previous}") + near,
        "\r\n" + Stored(MovedTo) + near + "\r\n" + Stored("{default}{/}Sub{/}x") + Stored("{default}") + near);
    add("APresetWithoutAPathIsUpdatedAllTheSame", near, near);
    add("AnEmptyPresetIsUpdated", "", "");
    add("AByteOrderMarkAloneGoes", "\xEF\xBB\xBF", "");
    add("AByteOrderMarkGoes", "\xEF\xBB\xBF" + Stored(MovedFrom), Stored(MovedTo));
    add("AUtf16PresetComesOutInUtf8", "{utf16}\r\n" + Stored(MovedFrom) + "Ě\x1A", "\r\n" + Stored(MovedTo) + "Ě\x1A");
    add("NulAndCtrlZEndNothing", Text("a\0b\x1A\r\n", 6) + Stored(MovedFrom) + "end", Text("a\0b\x1A\r\n", 6) + Stored(MovedTo) + "end");
    add("BytesThatAreNotUtf8AreTakenAsLatin1", "\xE4\r\n", "ä\r\n");
    left("HalfAUtf16UnitStays", Text("\xFF\xFE") + Text("a\0b", 3), "cannot be decoded");
    left("ALoneSurrogateStays", Text("\xFF\xFE\0\0\0\xD8\0\0a\0\0\0", 12), "cannot be encoded again");
    rows.push_back({"PresetsMoveBack", OnePreset(Stored(MovedTo)), {"U"}, {{PresetP, Stored(MovedFrom)}}, LogOfPreset(Updated, "U")});
    rows.push_back({"AFolderInPlaceOfAPresetIsSkipped",
                    World({{Text(PresetP) + "/", ""}}),
                    {"I"},
                    {},
                    LogOfPreset("Unable to open preset.xml for read : ")});
    rows.push_back({"OnlyDirectSubdirectoriesAreSearched",
                    World({{"user/ORX/JPData/Presets/presets.xml", Stored(MovedFrom)},
                           {"user/ORX/JPData/P/Q/Presets/presets.xml", Stored(MovedFrom)},
                           {"user/ORX/JPData/presets.xml", Stored(MovedFrom)}}),
                    {"I"},
                    {},
                    Log("I", "")});
    rows.push_back({"WithoutAPresetRootItsPathIsLogged",
                    World({{"user/ORX/JPData/", Removed}, {UserHive, Removed}}),
                    {"I"},
                    {},
                    Log("I", "", "Preset dirctory  not exist: {user}{/}ORX{/}JPData{/}\n" + NoPrevious)});
}

const Text InfoTip = "InfoTip=This folder has been configured as an ORX hot folder.\r\n";

Text IconFile(const Text& name)
{
    return "IconFile=.\\[_ORX_HotFolder_]\\" + name + ".ico\r\n";
}

void AddIcons(Rows& rows)
{
    const Text ini = "hot/A/Desktop.ini";
    const Text header = "[.ShellClassInfo]\r\n";
    struct State
    {
        const char* name;
        const char* enabled;
        bool isInError;
    };
    const auto copied = [](const Text& from, const Text& name)
    {
        return "Icon  copied from : {tool}{/}" + from + name + ".ico To {hot}{/}A{/}[_ORX_HotFolder_]{/}" + name + ".ico \n";
    };
    const auto place = [](const Text& name)
    {
        return "hot/A/[P]/" + name + ".ico";
    };
    const auto log = [&](const Text& letter, const Text& name)
    {
        return Log(letter, Folder("A", 1, copied(letter == "U" ? "BundleIcons{/}" : "", name), ""));
    };
    const auto cfg = [](const Text& enabled)
    {
        return "<H name='' description='' server_ip='' server_name='' Enable='" + enabled + "'/>";
    };
    for (const State& state : {State{"hf_folder", "1", false}, State{"hf_folder_disabled", "01", false},
                               State{"hf_error_active", "1", true}, State{"hf_error_inactive", "", true}})
    {
        Files before = {{CfgA, cfg(state.enabled)},
                        {place(state.name), "old"},
                        {place("other"), "stays"},
                        {"hot/A/Error.er", ""},
                        {"tool/BundleIcons/" + Text(state.name) + ".ico", "bundled"}};
        before[Text("hot/A/[P]/Error.er") + (state.isInError ? "" : "/")] = "";
        Files after = {{"hot/A#", "S"},
                       {ini + "#", "RS"},
                       {place(state.name), "{icon:" + Text(state.name) + ".ico}"},
                       {ini, header + IconFile(state.name) + "IconIndex=00\r\n" + InfoTip}};
        rows.push_back({Text("AnUpgradeShows_") + state.name, World(before), {"I"}, after, log("I", state.name)});
        after[place(state.name)] = "bundled";
        rows.push_back({Text("ADowngradeShows_") + state.name, World(before), {"U"}, after, log("U", state.name)});
    }

    const Files icon = {{place("hf_folder_disabled"), "old"}};
    const auto refresh = [&](const Text& name, const Text& before, const Text& attributes, const Text& after,
                             const Text& folderAttributes = "", const Text& attributesAfter = "S")
    {
        Files files = icon;
        files[ini] = before;
        files[ini + "#"] = attributes;
        files["hot/A#"] = folderAttributes;
        const Text noCfg = "HF cfg file unable to read/exist: {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
        rows.push_back(
            {name,
             World(files),
             {"I"},
             {{"hot/A#", attributesAfter}, {ini + "#", "RS"}, {ini, after}, {place("hf_folder_disabled"), "{icon:hf_folder_disabled.ico}"}},
             Log("I", Folder("A", 1, copied("", "hf_folder_disabled"), noCfg))});
    };
    const Text disabled = IconFile("hf_folder_disabled");
    const Text users = "; "
                       "mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=x.ico\nIconIndex=3\n"
                       "IconResource=y,1\n\n[.ShellClassInfo]\nInfoTip=second\n";
    const Text usersAfter = "; mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=" + disabled.substr(9) +
                            "IconIndex=3\nIconResource=y,1\n" + InfoTip + "\n[.ShellClassInfo]\nInfoTip=second\n";
    refresh("OurDesktopIniIsRefreshed", header + IconFile("hf_folder") + "IconIndex=00\r\nInfoTip=old\r\n", "RS",
            header + disabled + "IconIndex=00\r\n" + InfoTip, "R");
    refresh("AUsersDesktopIniKeepsAllElse", users, "", usersAfter, "RS");
    refresh("HiddenStaysOnTheFolderAlone", users, "HRS", usersAfter, "HR", "HS");
    refresh("AReadOnlyDesktopIniIsWritten", users, "R", usersAfter);
    refresh("ASystemDesktopIniIsWritten", users, "S", usersAfter);
    refresh("AMissingSectionIsAddedBehindTheLastLine", "[x]\r\na=b", "", "[x]\r\na=b\r\n" + header + InfoTip + disabled);
    refresh("AUtf16DesktopIniStaysUtf16", "{utf16}" + header + "IconFile=ü.ico\r\nInfoTip=old\r\n", "RS",
            "{utf16}" + header + disabled + InfoTip);
    refresh("AnEmptyDesktopIniIsFilled", "", "RS", header + InfoTip + disabled);

    Files noSource = icon;
    noSource["tool/BundleIcons/hf_folder_disabled.ico"] = "-";
    noSource[ini] = users;
    noSource[CfgA] = cfg("1");
    rows.push_back({"WithoutItsIconAFolderStays", World(noSource), {"I"}, {}, Log("I", Folder("A", 1, NoIcon("hf_folder"), ""))});
}

const char* const WineLosesSystem = "Wine loses SYSTEM on a read-only file of a user who is not root";

void AddRefusals(Rows& rows)
{
    const Text found = Found(MovedFrom);
    const auto add = [&](const Text& name, const Files& files, const Files& after, const Text& log)
    {
        rows.push_back({name, World(files), {"I"}, after, log, true, true});
    };
    const Text cfgHash = Text(CfgA) + "#";
    const Text presetHash = Text(PresetP) + "#";
    add("AReadOnlyFolderCfgStays", {{CfgA, Written(MovedFrom)}, {cfgHash, "R"}}, {}, LogOfA(found));
    add("AnUnreadableFolderCfgStays", {{CfgA, Written(MovedFrom)}, {cfgHash, "0"}}, {}, LogOfA("", "I", "hf_folder_disabled"));
    add("AnUnreadablePresetStays", {{PresetP, Stored(MovedFrom)}, {presetHash, "0"}}, {},
        LogOfPreset("Unable to open preset.xml for read : "));
    add("AReadOnlyPresetStays", {{PresetP, Stored(MovedFrom)}, {presetHash, "R"}}, {},
        LogOfPreset("Unable to open preset.xml for write : "));
    add("AnUnreadableListIsEmpty", {{"hot/A/", ""}, {Text(ListPlace) + "#", "0"}}, {}, Log("I", ""));
    // The icon's state does not depend on what is refused, so the rest of the run is as ever.
    const Text icon = "hot/A/[P]/hf_folder_disabled.ico";
    const Text ini = "hot/A/Desktop.ini";
    const Text copied = "Icon  copied from : {tool}{/}hf_folder_disabled.ico To "
                        "{hot}{/}A{/}[_ORX_HotFolder_]{/}hf_folder_disabled.ico \n";
    const Text noCfg = "HF cfg file unable to read/exist: {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
    const Text iconLog = Log("I", Folder("A", 1, copied, noCfg));
    const Text shipped = "{icon:hf_folder_disabled.ico}";
    const Files refreshed = {{icon, shipped}, {"hot/A#", "S"}};
    const Text own = "[.ShellClassInfo]\r\n" + InfoTip + IconFile("hf_folder_disabled");
    Files after = refreshed;
    after[ini] = own;
    after[ini + "#"] = "RS";
    rows.push_back({"AReadOnlyDesktopIniOfTheUsersIsWritten",
                    World({{icon, "old"}, {ini, ""}, {ini + "#", "RS"}}),
                    {"I"},
                    after,
                    iconLog,
                    false,
                    true,
                    WineLosesSystem});
    rows.push_back({"AnothersDesktopIniStays",
                    World({{icon, "old"}, {ini, "[x]\r\n"}, {ini + "#", "X"}}),
                    {"I"},
                    refreshed,
                    iconLog,
                    false,
                    true,
                    WineLosesSystem});
    rows.push_back({"AReadOnlyIconIsReplaced",
                    World({{icon, "old"}, {icon + "#", "R"}, {ini, own}}),
                    {"I"},
                    {{icon, shipped}, {"hot/A#", "S"}, {ini + "#", "RS"}, {icon + "#", ""}},
                    iconLog,
                    false,
                    true,
                    "Wine refuses another user than root to replace it, as Windows does"});
    rows.push_back({"AnothersFolderStays",
                    World({{icon, "old"}, {icon + "#", "X"}, {"hot/A#", "X"}, {"hot/A/[P]#", "X"}}),
                    {"I"},
                    {},
                    iconLog,
                    true,
                    true,
                    nullptr});
}

} // namespace

std::vector<Scenario> Scenarios()
{
    Rows rows;
    AddRuns(rows);
    AddLists(rows);
    AddFolderCfgs(rows);
    AddRegistries(rows);
    AddPresets(rows);
    AddIcons(rows);
    AddRefusals(rows);
    return rows;
}
