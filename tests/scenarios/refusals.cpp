// What is refused to a user who is not root.
#include "tests/scenarios/texts.h"

namespace
{

const char* const WineLosesSystem = "Wine loses SYSTEM on a read-only file of a user who is not root";

std::vector<Scenario> Refusals()
{
    const Text found = Found(MovedFrom);
    const Text cfg = Written(MovedFrom);
    const auto refused = [](const Name& name, const Text& place, const Text& attributes) {
        return Scenario(name).Before({{place + "#", attributes}}).AsOtherUser().LibraryReports();
    };
    return {
        refused("AReadOnlyFolderCfgStays", CfgPlace, "R").FolderCfg(cfg).LogOfA(found),
        refused("AnUnreadableFolderCfgStays", CfgPlace, "0").FolderCfg(cfg).LogOfDisabledA(""),
        refused("AnUnreadablePresetStays", PresetPlace, "0").Preset(Stored(MovedFrom)).LogOfPreset("Unable to open preset.xml for read : "),
        refused("AReadOnlyPresetStays", PresetPlace, "R").Preset(Stored(MovedFrom)).LogOfPreset("Unable to open preset.xml for write : "),
        refused("AnUnreadableListIsEmpty", ListPlace, "0").Before({{"hot/A/", ""}}).Log(""),
    };
}

// The icon's state does not depend on what is refused, so the log says the same each time.
std::vector<Scenario> IconRefusals()
{
    const Text icon = "hot/A/[P]/hf_folder_disabled.ico";
    const Text ini = "hot/A/Desktop.ini";
    const Text own = "[.ShellClassInfo]\r\nInfoTip=This folder has been configured as an ORX hot folder.\r\n"
                     "IconFile=.\\[_ORX_HotFolder_]\\hf_folder_disabled.ico\r\n";
    const auto withIcon = [&](const Name& name, const Files& before)
    {
        return Scenario(name)
            .Before({{icon, "old"}})
            .Before(before)
            .AsOtherUser()
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()));
    };
    const Files refreshed = {{icon, "{icon:hf_folder_disabled.ico}"}, {"hot/A#", "S"}};
    return {
        withIcon("AReadOnlyDesktopIniOfTheUsersIsWritten", {{ini, ""}, {ini + "#", "RS"}})
            .After(refreshed)
            .After({{ini, own}, {ini + "#", "RS"}})
            .NotUnderWine(WineLosesSystem),
        withIcon("AnothersDesktopIniStays", {{ini, "[x]\r\n"}, {ini + "#", "X"}}).After(refreshed).NotUnderWine(WineLosesSystem),
        withIcon("AReadOnlyIconIsReplaced", {{icon + "#", "R"}, {ini, own}})
            .After(refreshed)
            .After({{ini + "#", "RS"}, {icon + "#", ""}})
            .NotUnderWine("Wine refuses another user than root to replace it, as Windows does"),
        withIcon("AnothersFolderStays", {{icon + "#", "X"}, {"hot/A#", "X"}, {"hot/A/[P]#", "X"}}).LibraryReports(),
    };
}

TEST_SCENARIOS(Refusals);
TEST_SCENARIOS(IconRefusals);

} // namespace
