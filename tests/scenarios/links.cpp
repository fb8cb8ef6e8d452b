// Links and pipes where an ordinary user can plant them. Files elsewhere stay as they are.
#include "tests/scenarios/texts.h"

namespace
{

const char* const NoPipes = "Windows has no pipes among files";

const Text PresetDir = JobPresets + "/.P/Presets";
const Text CannotOpenPreset = "Unable to open preset.xml for read : ";

// What a run without a Folder.cfg does to A, whose icon exists.
Scenario WithIcon(const Text& name)
{
    return Scenario(name)
        .Before({{Icon, "old"}})
        .After({{Icon, "{icon:hf_folder_disabled.ico}"}, {"hot/A#", "S"}})
        .Log(CopiedToA());
}

SCENARIOS(PlantedLinks)
{
    const Text cfg = Written(MovedFrom);
    const Text preset = Stored(MovedFrom);
    const Text ini = IniHeader + IconFile(Disabled) + "IconIndex=00\r\n" + InfoTip;
    const Text iniStays =
        "Desktop.ini left as it is (reached over a link): {hot}{/}A{/}Desktop.ini\n";
    std::vector<Scenario> scenarios = {
        Scenario("LinkedPrivateAndPresetDirectoriesAreNotOpened")
            .Before({{"elsewhere/P/Folder.cfg", cfg},
                     {"elsewhere/P/hf_folder_disabled.ico", "old"},
                     {"elsewhere/P/presets.xml", preset},
                     {PresetDir + "/", "{link:elsewhere/P}"},
                     {"hot/A/[P]/", "{link:elsewhere/P}"}})
            .LogOfA(NoCfg(), PresetLine(CannotOpenPreset), Disabled),
        Scenario("ALinkedLogFolderGetsNoLog")
            .Before({{LogPlace, Removed},
                     {"elsewhere/L/UpgradeDowngrade.log", "-"},
                     {LogFolder + "/", "{link:elsewhere/L}"}})
            .File(CfgPlace, cfg, Written(MovedTo)),
        Scenario("AHotFolderAndAJobPresetDirectoryMayBeLinks")
            .Before({{"elsewhere/A/[P]/Folder.cfg", cfg},
                     {"hot/A/", "{link:elsewhere/A}"},
                     {"elsewhere/P/Presets/presets.xml", preset},
                     {JobPresets + "/.P/", "{link:elsewhere/P}"}})
            .After({{"elsewhere/A/[P]/Folder.cfg", Written(MovedTo)},
                    {"elsewhere/P/Presets/presets.xml", Stored(MovedTo)}})
            .LogOfA(Found(MovedFrom), PresetLine(Updated)),
        Scenario("TheFoldersAboveThePresetsMayBeLinks")
            .Before({{JobPresets + "/", Removed},
                     {"elsewhere/ORX/other", ""},
                     {"elsewhere/JPData/.P/Presets/presets.xml", preset},
                     {"user/ORX/", "{link:elsewhere/ORX}"},
                     {"elsewhere/ORX/JPData/", "{link:elsewhere/JPData}"}})
            .After({{"elsewhere/JPData/.P/Presets/presets.xml", Stored(MovedTo)}})
            .LogOfPreset(Updated),
        Scenario("ALinkedErrorFileCountsByItsName")
            .Before({{"elsewhere/other", ""}, {"hot/A/[P]/Error.er", "{link:elsewhere/missing}"}})
            .File(CfgPlace, cfg, Written(MovedTo))
            .LogOfA(Found(MovedFrom), "", "hf_error_active")
            .NotUnderWine(NoLinks),
    };
    // In that place: a link to a file with this text, a dangling link, and a pipe.
    const auto add = [&](const Scenario& scenario, const Text& place, const Text& text)
    {
        const std::pair<Text, Text> kinds[] = {{"IsALink", "{link:elsewhere/file}"},
                                               {"IsADanglingLink", "{link:elsewhere/missing}"},
                                               {"IsAPipe", "{fifo}"}};
        for (const auto& [name, planted] : kinds)
        {
            scenarios.push_back(scenario);
            scenarios.back().name += name;
            scenarios.back()
                .Before({{"elsewhere/file", text}, {place, planted}})
                .NotOnWindows(planted == "{fifo}" ? NoPipes : "")
                .NotUnderWine(NoLinks);
        }
    };
    add(WithIcon("AFolderCfg").After({{Ini, ini}, {Ini + "#", "RS"}}), CfgPlace, cfg);
    add(Scenario("AnIcon").LogOfA(NoCfg(), "", Disabled), Icon, "old");
    add(WithIcon("DesktopIni").Log(CopiedToA(iniStays)), Ini, "[.ShellClassInfo]\r\n");
    scenarios.back().Log(CopiedToA());
    add(Scenario("APreset").LogOfPreset(CannotOpenPreset), PresetDir + "/presets.xml", preset);
    add(Scenario("TheLog").File(CfgPlace, cfg, Written(MovedTo)), LogPlace, "-");
    scenarios.push_back(Scenario("TheListIsAPipe")
                            .Before({{ListPlace, "{fifo}"}, {"hot/A/", ""}})
                            .Log("")
                            .NotOnWindows(NoPipes));
    return scenarios;
}

} // namespace
