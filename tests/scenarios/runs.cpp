// The command line, the run log, and the list of hot folders.
#include "tests/scenarios/texts.h"

namespace
{

SCENARIOS(Runs)
{
    const Text forged = "x&#13;&#10;End~&#x7F;&#x9F;&#xA0;&#x2027;&#x2028;&#x2029;&#x202A;&#9;y";
    const auto moving = [&](const Text& name, const Files& files = {})
    {
        return Scenario(name, files).File(PresetPlace, Stored(MovedFrom), Stored(MovedTo));
    };
    const Files staying = {{PresetPlace, Stored(MovedFrom)}};
    return {
        Scenario("WithoutASwitchNothingChanges", staying).Run({}),
        Scenario("ADashedSwitchIsInvalid", staying)
            .Run({"-I"})
            .WholeLog("Invalid call check calling parameter: exiting....\n"),
        Scenario("AnInvalidSwitchIsNotLoggedWithV", staying).Run({"X", "V"}),
        moving("VLeavesTheLogAlone").Run({"I", "v"}),
        moving("AnUpgradeMovesTheTemplate").Run({"i"}).Log({}, PresetLine(Updated)),
        moving("VIsIgnoredBeforeAnotherArgument").Run({"I", "V", "x"}).Log({}, PresetLine(Updated)),
        moving("AnotherSecondArgumentIsIgnored").Run({"I", "W"}).Log({}, PresetLine(Updated)),
        moving("PresetsNeedNeitherAListNorALogFolder", {{ListPlace, Removed}, {LogPlace, Removed}})
            .IsReported(R"(
Workstation: note     there is no {list}
Workstation: note     there will be no run log: there is no folder {user}{/}ORX_Installers{/}
Job presets: {presetmoves})"),
        Scenario("AMissingLogIsCreatedAndAMissingPresetFolderLogged",
                 {{LogPlace, Removed}, {LogFolder + "/", ""}})
            .Before({{"user/ORX/JPData/", Removed}, {UserHive, Removed}})
            .Log({}, "Preset dirctory  not exist: {user}{/}ORX{/}JPData{/}\n" + NoPrevious)
            .IsReported(R"(
Workstation: note     HotFolderList.cfg lists no hot folder
Job presets: note     there are no presets, because there is no folder {user}{/}ORX{/}JPData{/})"),
        moving("ALogWithAByteOrderMarkLosesIt", {{LogPlace, "{utf16}old\r\n"}})
            .Log({}, PresetLine(Updated)),
        moving("AFolderInPlaceOfTheLogStopsNothing", {{LogPlace, Removed}, {LogPlace + "/", ""}})
            .IsReported(R"(
Workstation: note     there will be no run log: something else has its name: {log}
Job presets: {presetmoves})"),
        moving("ALogFolderThatCannotBeWrittenToStopsNothing",
               {{LogPlace, Removed}, {LogFolder + "/", ""}, {LogFolder + "#", "X"}})
            .AsOtherUser()
            .NotUnderWine("there every user may write to the folder")
            .IsReported(R"(
Workstation: problem  there will be no run log: its folder cannot be written to: {user}{/}ORX_Installers{/}
Job presets: {presetmoves})"),
        Scenario("NoFolderCanBeEntered", {{ListPlace, ""}, {PresetPlace, ""}})
            .Before({{"machine/hotfolder#", "0"}, {LogFolder + "#", "0"}, {JobPresets + "#", "0"}})
            .AsOtherUser()
            .IsReported(R"(
Workstation: problem  HotFolderList.cfg: its folder cannot be entered
Workstation: problem  there will be no run log: its folder cannot be entered: {user}{/}ORX_Installers{/}
Job presets: problem  {user}{/}ORX{/}JPData{/} cannot be entered)"),
        Scenario("NamesAndStoredPathsStayInTheirLine", {{"hot/%d %s/", ""}})
            .File(CfgPlace, Minimal(forged))
            .Log({{"%d %s", NoCfg, Disabled},
                  {"A", Found(u8"x\uFFFD\uFFFDEnd~\uFFFD\uFFFD\u00A0\u2027\uFFFD\uFFFD\u202A\ty"),
                   Disabled}}),
        Scenario("AFolderNameStaysInItsLine",
                 {{"hot/x\ny/", ""}, {ListPlace, "<l><HotFolder path='{hot}{/}x&#10;y'/></l>"}})
            .Log({{u8"x\uFFFDy", NoCfg, Disabled}})
            .NotOnWindows("no file name has a line end"),
    };
}

SCENARIOS(Lists)
{
    const auto listed = [](const Text& name, const Text& list)
    {
        return Scenario(name, {{"hot/A/", ""}, {"hot/b ü 漢/", ""}, {"hot/C/", ""}, {"hot/c/", ""}})
            .Before({{"hot/D/", "{link:hot/C}"}, {"hot/file", "x"}, {ListPlace, list}});
    };
    const Text spaced = IsWindows
                            ? "problem  listed hot folder is on a drive or share that is not there:"
                            : "note     listed hot folder does not exist:";
    return {
        listed("ListedFoldersThatExistAreTakenOnceAndInOrder",
               "{utf16}<any><!-- --><HotFolder/><HotFolder path=''/><HotFolder path=' {hot}{/}A'/>"
               "<HotFolder path='{hot}{/}missing'/><HotFolder path='{hot}{/}C '/>"
               "<hotfolder path='{hot}{/}A'/><x><HotFolder path='{hot}{/}A'/></x>"
               "<HotFolder path='{hot}{/}file'/><HotFolder Path='{hot}{/}A'/>"
               "<HotFolder z='1' path='{hot}{/}b ü 漢&#10;'/><HotFolder path='{hot}{/}C'/>"
               "<HotFolder path='{hot}{/}c'/><HotFolder path='{hot}{/}D'/></any>")
            .Log({{"C", NoCfg, Disabled}, {"b ü 漢", NoCfg, Disabled}, {"D", NoCfg, Disabled}})
            .IsReported("\nWorkstation: " + spaced + "  {hot}{/}A" + R"(
Workstation: note     listed hot folder does not exist: {hot}{/}missing
Workstation: note     listed hot folder does not exist: {hot}{/}file
Workstation: note     listed hot folder is listed twice: {hot}{/}C
Workstation: note     listed hot folder is listed twice: {hot}{/}c
C: note     no Folder.cfg
b ü 漢: note     no Folder.cfg
D: note     the same directory as {hot}{/}C)"),
        listed("AMalformedListIsEmpty", "<any><HotFolder path='{hot}{/}A'/>")
            .Log()
            .LibraryReports()
            .IsReported(R"(
Workstation: problem  {list}: damaged (line 1: no element found); no hot folder is migrated)"),
        listed("NoListedFolderIsThere",
               "<l>" + Times(2000, "<HotFolder path='{hot}{/}#'/>") + "</l>")
            .Log()
            .IsReported(
                "Workstation: problem  none of the listed hot folders exists (another "
                "account? mapped drives?)" +
                Times(20, "\nWorkstation: note     listed hot folder does not exist: {hot}{/}#") +
                "\nWorkstation: note     listed hot folder and 1980 more"),
    };
}

} // namespace
