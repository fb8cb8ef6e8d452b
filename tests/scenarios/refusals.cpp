// Stored files that a user who is not root cannot read or write; icons.cpp has the others.
#include "tests/scenarios/texts.h"

namespace
{

std::vector<Scenario> Refusals()
{
    const Text found = Found(MovedFrom);
    const Text cfg = Written(MovedFrom);
    const auto refused = [](const Text& name, const Text& place, const Text& attributes)
    {
        return Scenario(name).Before({{place + "#", attributes}}).AsOtherUser().LibraryReports();
    };
    return {
        refused("AReadOnlyFolderCfgStays", CfgPlace, "R").FolderCfg(cfg).LogOfA(found),
        refused("AnUnreadableFolderCfgStays", CfgPlace, "0")
            .FolderCfg(cfg)
            .LogOfA("", "", Disabled),
        refused("AnUnreadablePresetStays", PresetPlace, "0")
            .Preset(Stored(MovedFrom))
            .LogOfPreset("Unable to open preset.xml for read : "),
        refused("AReadOnlyPresetStays", PresetPlace, "R")
            .Preset(Stored(MovedFrom))
            .LogOfPreset("Unable to open preset.xml for write : "),
        refused("AReadOnlyLogStays", LogPlace, "R").FolderCfg(cfg, Written(MovedTo)),
        refused("AnUnreadableListIsEmpty", ListPlace, "0").Before({{"hot/A/", ""}}).Log(""),
    };
}

TEST_SCENARIOS(Refusals);

} // namespace
