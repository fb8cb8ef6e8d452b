// The two template folders in the registry, what happens where they are missing or unusable, and
// whether the templates are there.
#include "tests/scenarios/texts.h"

namespace
{

// A hot folder and a preset that store this path, and these hives.
Scenario Both(const Text& name, const Text& path, const Files& hives)
{
    return Scenario(name, hives)
        .Before(DoneFolder("A", Written(path)))
        .File(PresetPlace, Stored(path));
}

Scenario WithPath(const Text& name, const Text& previous, const Text& path = MovedFrom)
{
    return Both(name, path, {{UserHive, Hive(UserKey, "\"Path\"=\"" + previous + "\"")}});
}

SCENARIOS(Registry)
{
    const Text found = Found(MovedFrom);
    const Text foundNew = Found(MovedTo);
    const Text updated = PresetLine(Updated);
    return {
        Both("WithoutATemplateNoFolderIsLookedUp", MovedFrom,
             {{MachineHive, Removed}, {UserHive, "garbage"}})
            .File(CfgPlace, "<H><ImposeSetting/></H>")
            .Log({{"A", Found(""), Disabled}}, NoDefault + NoPrevious)
            .IsReported(R"(
A: note     no copy of the icon to replace: hf_folder_disabled.ico
Job presets: problem  registry value Path in HKEY_CURRENT_USER\SOFTWARE\Wow6432Node\HF or \SOFTWARE\HF: there is no such key{nothing}
Job presets: problem  registry value InstallPath in HKEY_LOCAL_MACHINE\SOFTWARE\Wow6432Node\Vantorix\QZA or \SOFTWARE\Vantorix\QZA: there is no such key{nothing})"),
        Both("WithoutADefaultFolderNothingMoves", MovedFrom, {{MachineHive, Hive(MachineKey, "")}})
            .Before(DoneFolder("B", Written("{app}{/}B")))
            .Log({{"A", found + NoDefault}, {"B", Found("{app}{/}B")}}, NoDefault),
        Both("WithoutAPreviousFolderNothingMovesBack", MovedTo, {{UserHive, Hive(UserKey, "")}})
            .Run({"U"})
            .Log({{"A", foundNew + NoPreviousTo}}, NoPrevious)
            .IsReported(R"(
A: problem  {Path}: missing{nothing}
A: problem  stays in the folder being left (the folder being installed is unknown): {default}{/}Booklet.tpl)"),
        WithPath("A32BitKeyHidesTheOtherEvenWithoutAValue",
                 "{previous}\"\r\n\r\n[HKEY_CURRENT_USER\\software\\wow6432node\\hf]\r\n\"x\"=\"")
            .Log({{"A", found + NoPrevious}}, NoPrevious)
            .IsReported("A: problem  registry value Path in HKEY_CURRENT_USER\\SOFTWARE\\"
                        "Wow6432Node\\HF: missing, and no other key is looked at{nothing}"),
        WithPath("A32BitKeyComesFirst",
                 "x\"\r\n[HKEY_CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF]\r\n\"PATH\"=\"{previous}")
            .Before(
                {{MachineHive, Hive(MachineKey, "\"InstallPath\"=\"x\"\r\n[HKEY_LOCAL_"
                                                "MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix\\QZA]\r\n"
                                                "\"InstallPath\"=\"{app}\"")}})
            .File(CfgPlace, Written(""))
            .After({{PresetPlace, Stored(MovedTo)}})
            .Log({{"A", Found("")}}, updated),
        WithPath("ATextOf258CharactersIsTooLong", Text(258, 'x'))
            .Before({{MachineHive, Removed}})
            .Log({{"A", found + NoPrevious}}, NoDefault + NoPrevious)
            .IsReported(R"(
A: problem  {Path}: longer than 257 characters{nothing}
Job presets: problem  registry value InstallPath in HKEY_LOCAL_MACHINE\SOFTWARE\Wow6432Node\Vantorix\QZA or \SOFTWARE\Vantorix\QZA: there is no such key{nothing})"),
        WithPath("ATextOf257CharactersIsRead", Text(257, 'x')).Log({{"A", found}}, updated),
        Both("ANumberAsTheNewFolderMovesNothing", MovedFrom,
             {{MachineHive, Hive(MachineKey, "\"InstallPath\"=dword:00000001")}})
            .Log({{"A", found + Untouched("new path holds a character that XML cannot store")}},
                 updated)
            .IsReported(R"(
A: problem  Folder.cfg: left as it is (new path holds a character that XML cannot store)
A: problem  stays in the folder being left (in a file that stays as it is): {previous}{/}Booklet.tpl
Job presets: problem  the folder being installed holds a character that XML cannot store; no path of a preset moves
Job presets: problem  .P{xml}: stays in the folder being left (no path moves): {previous}{/}Booklet.tpl)"),
        Both("AnUnterminatedOddValueIsReadToItsLastWholeUnit", MovedFrom,
             {{UserHive, Hive(UserKey, "\"Path\"=hex:78,00,79,00,7a")}})
            .Log({{"A", found}}, updated),
        WithPath("AFinalSeparatorMovesPresetsOnly", "{previous}{/}")
            .After({{PresetPlace, Stored(MovedTo)}})
            .Log({{"A", found}}, updated)
            .IsReported(R"(
Workstation: problem  {Path}: ends in a separator; no template of a hot folder moves
A: problem  stays in the folder being left (the registry value ends in a separator): {previous}{/}Booklet.tpl
Job presets: {presetmoves})"),
        WithPath("AFinalSeparatorIsDoubledInFolderCfgOnly", "{previous}{/}", MovedTo)
            .Run({"u"})
            .After({{CfgPlace, Written("{previous}{/}{/}Booklet.tpl")},
                    {PresetPlace, Stored(MovedFrom)}})
            .Log({{"A", foundNew}}, updated)
            .IsReported(R"(
Workstation: problem  {Path}: ends in a separator; it is doubled in the paths of hot folders
A: change   Folder.cfg: {default}{/}Booklet.tpl -> {previous}{/}{/}Booklet.tpl
Job presets: change   .P{xml}: {default}{/}Booklet.tpl -> {previous}{/}Booklet.tpl)"),
        WithPath("AnEmptyPreviousFolderReplacesNothing", "")
            .Log({{"A", found}}, updated)
            .IsReported("Workstation: problem  {Path}: empty; only templates stored without a "
                        "folder move"),
        WithPath("BothFoldersAreTheSame", "{app}{/}template", MovedTo)
            .Log({{"A", foundNew}}, updated)
            .IsReported(""),
        // Only reports from here on.
        WithPath("PathIsEmptyOnTheWayBack", "", "{hot}{/}A")
            .Run({"U"})
            .IsReported(
                "Workstation: problem  {Path}: empty; templates move to the root of the drive"),
        WithPath("PathHoldsAnAmpersand", "{hot}&", "{hot}{/}A")
            .Run({"U"})
            .IsReported("Job presets: problem  {Path}: holds & or <, which is inserted into "
                        "presets as it is"),
        WithPath("TheNewFolderIsBelowTheOld", "{app}", MovedTo)
            .File(CfgPlace, Written("{hot}{/}A"))
            .File(PresetPlace, Stored(MovedTo) + Stored("{app}{/}..{/}Apps ä{/}T"))
            .Before({{"default/template/Booklet.tpl", ""}})
            .IsReported(R"(
Job presets: problem  one template folder is below the other: another run would move paths of presets again
Job presets: problem  .P{xml}: stays in the folder being left (another run moves it): {default}{/}..{/}Apps ä{/}T
Job presets: change   .P{xml}: {app}{/}..{/}Apps ä{/}T -> {default}{/}..{/}Apps ä{/}T
Job presets: change   .P{xml}: {default}{/}Booklet.tpl -> {default}{/}template{/}Booklet.tpl)"),
        Scenario("TemplatesAreMissing", DoneFolder("A", Written("{default}{/}none")))
            .Before(DoneFolder("B", Written("{previous}{/}Sub{/}T")))
            .Before(DoneFolder("C", Written("{hot}{/}C{/}D{/}T")))
            .Before(DoneFolder("D", Written("{previous}{/}.{/}T")))
            .Before(DoneFolder("E", Written("{/}{/}host{/}share{/}T")))
            .Before({{"hot/C/D/", "{link:elsewhere/d}"}, {"default/D/", "{link:elsewhere/d}"}})
            .Before({{"elsewhere/d/T", ""}})
            .File(PresetPlace, Stored("{default}{/}D{/}T") + Stored("{hot}{/}..{/}Vorige 版{/}T") +
                                   Stored("{hot}{/}..{/}Vorige &#x7248;{/}&amp;") +
                                   Stored("{default}{/}&lt;&#65;") + Stored("{default}{/}&none;") +
                                   "ORXImposeTemplate\">\"{previous}")
            .IsReported(R"(
A: problem  no template at {default}{/}none
B: problem  stays in the folder being left (in a sub-folder): {previous}{/}Sub{/}T
C: note     not looked at: {hot}{/}C{/}D{/}T
D: problem  stays in the folder being left (its last folder is a dot): {previous}{/}.{/}T
E: note     not looked at: {/}{/}host{/}share{/}T
Job presets: problem  .P{xml}: no template at {default}{/}<A
Job presets: problem  .P{xml}: no template at {default}{/}&none;
Job presets: problem  .P{xml}: stays in the folder being left (stored as XML): {hot}{/}..{/}Vorige 版{/}&
Job presets: problem  .P{xml}: stays in the folder being left (other separators): {hot}{/}..{/}Vorige 版{/}T
Job presets: note     .P{xml}: a template path has no closing quote
Job presets: note     .P{xml}: not looked at: {default}{/}D{/}T)"),
        Scenario("ARehearsal", DoneFolder("A", Written("{hot}{/}old{/}T")))
            .File(PresetPlace, Times(2, Stored("{hot}{/}old{/}T")) + Stored("{hot}{/}new{/}T"))
            .Before({{MachineHive, Removed}, {UserHive, Removed}})
            .Run({"I", "--from", "{hot}{/}old", "--to", "{hot}{/}new"})
            .IsReported(R"(
A: change   Folder.cfg: {hot}{/}old{/}T -> {hot}{/}new{/}T
Job presets: change   .P{xml}: {hot}{/}old{/}T -> {hot}{/}new{/}T (2 times)
Templates: note     there is no folder {hot}{/}new; templates that will be looked for in it: 2)"),
    };
}

} // namespace
