// The command line and the run log.
#include "tests/scenarios/texts.h"

namespace
{

std::vector<Scenario> Runs()
{
    const Text from = Written(MovedFrom);
    const Text to = Written(MovedTo);
    const Text found = Found(MovedFrom);
    return {
        Scenario("NoSwitchTouchesNothing").FolderCfg(from).Run({}),
        Scenario("ADashedSwitchIsInvalid").FolderCfg(from).Run({"-I"}).WholeLog("Invalid call check calling parameter: exiting....\n"),
        Scenario("AnInvalidSwitchIsNotLoggedWithV").FolderCfg(from).Run({"X", "V"}),
        Scenario("VLeavesTheLogAlone").FolderCfg(from, to).Run({"I", "v"}),
        Scenario("AnUpgradeMovesTheTemplate").FolderCfg(from, to).Run({"i"}).LogOfA(found),
        Scenario("VIsIgnoredBeforeAnotherArgument").FolderCfg(from, to).Run({"I", "V", "x"}).LogOfA(found),
        Scenario("AnotherSecondArgumentIsIgnored").FolderCfg(from, to).Run({"I", "W"}).LogOfA(found),
        Scenario("ADowngradeMovesTheTemplateBack").FolderCfg(to, from).Run({"u"}).LogOfA(Found(MovedTo)),
        Scenario("WithoutALogFolderTheRestIsDone").Before({{LogPlace, Removed}}).FolderCfg(from, to),
        Scenario("AMissingLogIsCreated").Before({{LogPlace, Removed}, {"user/ORX_Installers/", ""}}).FolderCfg(from, to).LogOfA(found),
        Scenario("ALogWithAByteOrderMarkLosesIt").Before({{LogPlace, "{utf16}old\r\n"}}).FolderCfg(from, to).LogOfA(found),
        Scenario("AFolderInPlaceOfTheLogStopsNothing").Before({{LogPlace, Removed}, {Text(LogPlace) + "/", ""}}).FolderCfg(from, to),
        Scenario("APercentSignIsLoggedAsItIs")
            .Before({{"hot/%d %s/", ""}})
            .Log(FolderLines("%d %s", 1, NoIcon("hf_folder_disabled"), NoCfg("%d %s"))),
    };
}

TEST_SCENARIOS(Runs);

} // namespace
