// The two template folders in the registry, and what happens where they are missing or unusable.
#include "tests/scenarios/texts.h"

namespace
{

// A hot folder and a preset whose paths would move, and these hives.
Scenario Both(const Text& name, const Text& letter, const Files& hives)
{
    const Text path = letter == "I" ? MovedFrom : MovedTo;
    return Scenario(name)
        .Before(hives)
        .File(CfgPlace, Written(path))
        .File(PresetPlace, Stored(path))
        .Run({letter});
}

Scenario WithPrevious(const Text& name, const Text& value)
{
    return Both(name, "I", {{UserHive, UserValue(value)}});
}

SCENARIOS(Registry)
{
    const Text found = Found(MovedFrom);
    const Text foundNew = Found(MovedTo);
    const Text updated = PresetLine(Updated);
    return {
        Both("WithoutAnyHiveNothingMoves", "I", {{MachineHive, Removed}, {UserHive, Removed}})
            .LogOfA(found + NoPrevious, NoDefault + NoPrevious),
        Both("WithoutADefaultFolderAnUpgradeMovesNothing", "I",
             {{MachineHive, MachineValue("\"x\"=\"y\"")}})
            .LogOfA(found + NoDefault, NoDefault),
        Both("WithoutAPreviousFolderADowngradeMovesNothing", "U",
             {{UserHive, UserValue("\"x\"=\"y\"")}})
            .LogOfA(foundNew + NoPreviousTo, NoPrevious),
        WithPrevious(
            "A32BitKeyHidesTheOtherEvenWithoutAValue",
            "\"Path\"=\"{previous}\"\r\n\r\n[HKEY_CURRENT_USER\\software\\wow6432node\\hf]")
            .LogOfA(found + NoPrevious, NoPrevious),
        WithPrevious("A32BitKeyComesFirst",
                     "\"Path\"=\"x\"\r\n[HKEY_CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF]\r\n\"PATH\"="
                     "\"{previous}\"")
            .Before({{MachineHive, MachineValue("\"InstallPath\"=\"x\"\r\n[HKEY_LOCAL_"
                                                "MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix\\QZA]\r\n"
                                                "\"InstallPath\"=\"{app}\"")}})
            .After({{CfgPlace, Written(MovedTo)}, {PresetPlace, Stored(MovedTo)}})
            .LogOfA(found, updated),
        WithPrevious("ATextOf258CharactersIsTooLong", "\"Path\"=\"" + Text(258, 'x') + "\"")
            .LogOfA(found + NoPrevious, NoPrevious),
        WithPrevious("ATextOf257CharactersIsRead", "\"Path\"=\"" + Text(257, 'x') + "\"")
            .LogOfA(found, updated),
        Both("ANumberAsTheNewFolderMovesNothing", "I",
             {{MachineHive, MachineValue("\"InstallPath\"=dword:00000001")}})
            .LogOfA(found + Untouched("new path holds a character that XML cannot store"), updated),
        WithPrevious("AnUnterminatedOddValueIsReadToItsLastWholeUnit",
                     "\"Path\"=hex:78,00,79,00,7a")
            .LogOfA(found, updated),
        WithPrevious("AFinalSeparatorMovesPresetsOnly", "\"Path\"=\"{previous}{/}\"")
            .After({{PresetPlace, Stored(MovedTo)}})
            .LogOfA(found, updated),
        Both("AFinalSeparatorIsDoubledInFolderCfgOnly", "U",
             {{UserHive, UserValue("\"Path\"=\"{previous}{/}\"")}})
            .After({{CfgPlace, Written("{previous}{/}{/}Booklet.tpl")},
                    {PresetPlace, Stored(MovedFrom)}})
            .LogOfA(foundNew, updated),
        WithPrevious("AnEmptyPreviousFolderReplacesNothing", "\"Path\"=\"\"")
            .LogOfA(found, updated),
        Scenario("WithoutATemplateNoFolderIsLookedUp")
            .Before({{MachineHive, Removed}, {UserHive, "garbage"}})
            .File(CfgPlace, "<H><ImposeSetting/></H>")
            .LogOfA(Found(""), NoDefault + NoPrevious, Disabled),
    };
}

} // namespace
