// Links and pipes where an ordinary user can plant them. Files elsewhere stay as they are.
#include "tests/scenarios/texts.h"

namespace
{

const char* const WineFollowsLinks = "Wine shows neither links to files nor dangling ones as links";
const char* const NoPipes = "Windows has no pipes among files";

const Text LogDir = "user/ORX_Installers";
const Text PresetDir = "user/ORX/JPData/.P/Presets";
const Text Icon = "hot/A/[P]/hf_folder_disabled.ico";
const Text Ini = "hot/A/Desktop.ini";
const Text CannotOpenPreset = "Unable to open preset.xml for read : ";

Text LinkTo(const Text& place)
{
    return "{link:" + place + "}";
}

// What a run without a Folder.cfg does to A, whose icon exists.
Scenario WithIcon(const Text& name)
{
    return Scenario(name)
        .Before({{Icon, "old"}})
        .After({{Icon, "{icon:hf_folder_disabled.ico}"}, {"hot/A#", "S"}})
        .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()));
}

std::vector<Scenario> PlantedLinks()
{
    const Text cfg = Written(MovedFrom);
    const Text preset = Stored(MovedFrom);
    const Text ini = "[.ShellClassInfo]\r\nIconFile=.\\[_ORX_HotFolder_]\\hf_folder_disabled."
                     "ico\r\nIconIndex=00\r\n"
                     "InfoTip=This folder has been configured as an ORX hot folder.\r\n";
    const Text iniStays =
        "Desktop.ini left as it is (reached over a link): {hot}{/}A{/}Desktop.ini\n";
    std::vector<Scenario> scenarios = {
        Scenario("ALinkedPrivateDirectoryIsIgnored")
            .Before({{"elsewhere/P/Folder.cfg", cfg},
                     {"elsewhere/P/hf_folder_disabled.ico", "old"},
                     {"hot/A/[P]/", LinkTo("elsewhere/P")}})
            .LogOfDisabledA(NoCfg()),
        Scenario("ALinkedPresetDirectoryIsNotOpened")
            .Before({{"elsewhere/P/presets.xml", preset}, {PresetDir + "/", LinkTo("elsewhere/P")}})
            .LogOfPreset(CannotOpenPreset),
        Scenario("ALinkedLogFolderGetsNoLog")
            .Before({{LogPlace, Removed},
                     {"elsewhere/L/UpgradeDowngrade.log", "-"},
                     {LogDir + "/", LinkTo("elsewhere/L")}})
            .FolderCfg(cfg, Written(MovedTo)),
        Scenario("AHotFolderMayBeReachedOverALink")
            .Before({{"elsewhere/A/[P]/Folder.cfg", cfg}, {"hot/A/", LinkTo("elsewhere/A")}})
            .After({{"elsewhere/A/[P]/Folder.cfg", Written(MovedTo)}})
            .LogOfA(Found(MovedFrom)),
        Scenario("AJobPresetDirectoryMayBeALink")
            .Before({{"elsewhere/P/Presets/presets.xml", preset},
                     {"user/ORX/JPData/.P/", LinkTo("elsewhere/P")}})
            .After({{"elsewhere/P/Presets/presets.xml", Stored(MovedTo)}})
            .LogOfPreset(Updated),
        Scenario("TheFoldersAboveThePresetsMayBeLinks")
            .Before({{"user/ORX/JPData/", Removed},
                     {"elsewhere/ORX/other", ""},
                     {"elsewhere/JPData/.P/Presets/presets.xml", preset},
                     {"user/ORX/", LinkTo("elsewhere/ORX")},
                     {"elsewhere/ORX/JPData/", LinkTo("elsewhere/JPData")}})
            .After({{"elsewhere/JPData/.P/Presets/presets.xml", Stored(MovedTo)}})
            .LogOfPreset(Updated),
        Scenario("ALinkedErrorFileCountsByItsName")
            .Before({{"elsewhere/other", ""}, {"hot/A/[P]/Error.er", LinkTo("elsewhere/missing")}})
            .FolderCfg(cfg, Written(MovedTo))
            .LogOfA(Found(MovedFrom), "", "hf_error_active")
            .NotUnderWine(WineFollowsLinks),
    };
    // Two links in that place: one to a file, and a dangling one.
    const auto add =
        [&](const Scenario& scenario, const Text& place, const Text& target, const Text& text)
    {
        for (const Text& pointsTo : {target, Text("elsewhere/missing")})
        {
            scenarios.push_back(scenario);
            scenarios.back()
                .Before({{target, text}, {place, LinkTo(pointsTo)}})
                .NotUnderWine(WineFollowsLinks);
        }
        scenarios.back().name += "EvenIfDangling";
    };
    add(WithIcon("ALinkedFolderCfgIsNotRead").After({{Ini, ini}, {Ini + "#", "RS"}}), CfgPlace,
        "elsewhere/Folder.cfg", cfg);
    add(Scenario("ALinkedIconIsIgnored").LogOfDisabledA(NoCfg()), Icon, "elsewhere/icon.ico",
        "old");
    add(WithIcon("ALinkedDesktopIniStays")
            .Log(FolderLines("A", 1, iniStays + Copied("hf_folder_disabled"), NoCfg())),
        Ini, "elsewhere/Desktop.ini", "[.ShellClassInfo]\r\n");
    add(Scenario("ALinkedPresetIsNotOpened").LogOfPreset(CannotOpenPreset),
        PresetDir + "/presets.xml", "elsewhere/presets.xml", preset);
    add(Scenario("ALinkedLogStays").FolderCfg(cfg, Written(MovedTo)), LogPlace, "elsewhere/log",
        "-");
    return scenarios;
}

std::vector<Scenario> PlantedPipes()
{
    const Text cfg = Written(MovedFrom);
    const auto pipe = [](const Text& name, const Text& place)
    {
        return Scenario(name).Before({{place, "{fifo}"}}).NotUnderWine(NoPipes);
    };
    return {
        pipe("APipeIsNotAFolderCfg", CfgPlace).LogOfDisabledA(NoCfg()),
        pipe("APipeIsNotAnIcon", Icon).LogOfDisabledA(NoCfg()),
        WithIcon("APipeIsNotADesktopIni").Before({{Ini, "{fifo}"}}).NotUnderWine(NoPipes),
        pipe("APipeIsNotAPreset", PresetPlace).LogOfPreset(CannotOpenPreset),
        pipe("APipeIsNotAList", ListPlace).Before({{"hot/A/", ""}}).Log(""),
        pipe("APipeIsNotALog", LogPlace).FolderCfg(cfg, Written(MovedTo)),
    };
}

TEST_SCENARIOS(PlantedLinks);
TEST_SCENARIOS(PlantedPipes);

} // namespace
