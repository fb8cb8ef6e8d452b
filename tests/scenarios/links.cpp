// Links and pipes where an ordinary user can plant them. Files elsewhere stay as they are.
#include "tests/scenarios/texts.h"

namespace
{

const char* const NoPipes = "Windows has no pipes among files";

const Text CannotOpenPreset = "Unable to open preset.xml for read : ";

SCENARIOS(PlantedLinks)
{
    const Text cfg = Written(MovedFrom);
    const Text from = Stored(MovedFrom);
    const Text stays = "left as it is (reached over a link)";
    std::vector<Scenario> scenarios = {
        Scenario("LinkedPrivateAndPresetDirectoriesAreNotOpened",
                 {{"hot/A/[P]/", "{link:elsewhere/P}"},
                  {JobPresets + "/.P/Presets/", "{link:elsewhere/P}"}})
            .Before({{"elsewhere/P/Folder.cfg", cfg}, {"elsewhere/P/presets.xml", from}})
            .Before({{"elsewhere/P/hf_folder_disabled.ico", "old"}})
            .Log({{"A", NoCfg, Disabled}}, PresetLine(CannotOpenPreset))
            .IsReported(R"(
A: problem  [_ORX_HotFolder_]: reached over a link
Job presets: problem  .P{xml}: reached over a link, or not a file)"),
        Scenario("ALinkedLogFolderGetsNoLog",
                 {{LogPlace, Removed}, {LogFolder + "/", "{link:elsewhere/L}"}})
            .Before({{"elsewhere/L/UpgradeDowngrade.log", "-"}})
            .File(PresetPlace, from, Stored(MovedTo))
            .IsReported(R"(
Workstation: problem  there will be no run log: it is reached over a link: {log}
Job presets: {presetmoves})"),
        Scenario("AHotFolderAndAJobPresetDirectoryMayBeLinks",
                 {{"hot/A/", "{link:elsewhere/A}"}, {"elsewhere/A/[P]/Folder.cfg", cfg}})
            .Before({{JobPresets + "/", Removed}, {"user/ORX/", "{link:elsewhere/ORX}"}})
            .Before({{"elsewhere/ORX/JPData/", "{link:elsewhere/JPData}"}})
            .Before({{"elsewhere/JPData/.P/", "{link:elsewhere/P}"}})
            .File("elsewhere/P/Presets/presets.xml", from, Stored(MovedTo))
            .After({{"elsewhere/A/[P]/Folder.cfg", Written(MovedTo)}})
            .Log({{"A", Found(MovedFrom)}}, PresetLine(Updated)),
        Scenario("ALinkedErrorFileCountsByItsName",
                 {{"elsewhere/other", ""}, {"hot/A/[P]/Error.er", "{link:elsewhere/missing}"}})
            .File(CfgPlace, Written(MovedTo))
            .Log({{"A", Found(MovedTo), "hf_error_active"}})
            .NotUnderWine(NoLinks),
    };
    // In that place: a link to a file with this text, a dangling link, and a pipe.
    const auto add = [&](const Scenario& scenario, const Text& place, const Text& text,
                         const Text& linked, const Text& piped)
    {
        for (const auto& [name, planted] : Files{{"IsALink", "{link:elsewhere/file}"},
                                                 {"IsADanglingLink", "{link:elsewhere/missing}"},
                                                 {"IsAPipe", "{fifo}"}})
        {
            scenarios.push_back(scenario);
            scenarios.back().name += name;
            scenarios.back()
                .Before({{"elsewhere/file", text}, {place, planted}})
                .NotOnWindows(planted == "{fifo}" ? NoPipes : "")
                .NotUnderWine(NoLinks)
                .IsReported(planted == "{fifo}" ? piped : linked);
        }
    };
    const auto done = [](const Text& name)
    {
        return Scenario(name, DoneFolder("A", "<H/>", Disabled));
    };
    add(done("AFolderCfg").Log({{"A", NoCfg, Disabled}}), CfgPlace, cfg,
        "A: problem  Folder.cfg: reached over a link", "A: problem  Folder.cfg: is not a file");
    add(done("AnIcon").Before({{Icon, Removed}}).Log({{"A", "", Disabled}}), Icon, "old",
        "A: problem  hf_folder_disabled.ico: reached over a link",
        "A: note     no copy of the icon to replace: hf_folder_disabled.ico");
    add(done("DesktopIni")
            .Before({{Ini + "#", Removed}})
            .Log({{"A", "",
                   "Desktop.ini " + stays + ": {hot}{/}A{/}Desktop.ini\n" + Copied(Disabled)}}),
        Ini, "[.ShellClassInfo]\r\n", "A: problem  Desktop.ini: " + stays,
        "A: problem  Desktop.ini: is not a file\nA: change   Desktop.ini: attributes none -> "
        "READONLY SYSTEM");
    scenarios.back().Log({{"A", "", Disabled}});
    const Text skipped = "Job presets: problem  .P{xml}: reached over a link, or not a file";
    add(Scenario("APreset").Log({}, PresetLine(CannotOpenPreset)), PresetPlace, from, skipped,
        skipped);
    add(Scenario("TheLog").File(PresetPlace, from, Stored(MovedTo)), LogPlace, "-", R"(
Workstation: problem  there will be no run log: it is reached over a link: {log}
Job presets: {presetmoves})",
        R"(
Workstation: note     there will be no run log: something else has its name: {log}
Job presets: {presetmoves})");
    scenarios.push_back(Scenario("TheListIsAPipe", {{ListPlace, "{fifo}"}, {"hot/A/", ""}})
                            .Log()
                            .NotOnWindows(NoPipes));
    return scenarios;
}

} // namespace
