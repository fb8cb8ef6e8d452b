// The command line and the run log.
#include "tests/scenarios/texts.h"

namespace
{

std::vector<Scenario> Runs()
{
    const Text from = Written(MovedFrom);
    const Text to = Written(MovedTo);
    const Text found = Found(MovedFrom);
    const Text forged = "x&#13;&#10;End: Updating Impose path for JP "
                        "Presets&#13;&#10;&#x2028;&#x2029;&#x85;&#x7F;&#9;y";
    const auto moving = [&](const Text& name)
    {
        return Scenario(name).FolderCfg(from, to);
    };
    return {
        Scenario("WithoutASwitchNothingChanges").FolderCfg(from).Run({}),
        Scenario("ADashedSwitchIsInvalid")
            .FolderCfg(from)
            .Run({"-I"})
            .WholeLog("Invalid call check calling parameter: exiting....\n"),
        Scenario("AnInvalidSwitchIsNotLoggedWithV").FolderCfg(from).Run({"X", "V"}),
        moving("VLeavesTheLogAlone").Run({"I", "v"}),
        moving("AnUpgradeMovesTheTemplate").Run({"i"}).LogOfA(found),
        moving("VIsIgnoredBeforeAnotherArgument").Run({"I", "V", "x"}).LogOfA(found),
        moving("AnotherSecondArgumentIsIgnored").Run({"I", "W"}).LogOfA(found),
        Scenario("ADowngradeMovesTheTemplateBack")
            .FolderCfg(to, from)
            .Run({"u"})
            .LogOfA(Found(MovedTo)),
        moving("WithoutALogFolderTheRestIsDone").Before({{LogPlace, Removed}}),
        moving("AMissingLogIsCreated")
            .Before({{LogPlace, Removed}, {LogFolder + "/", ""}})
            .LogOfA(found),
        moving("ALogWithAByteOrderMarkLosesIt")
            .Before({{LogPlace, "{utf16}old\r\n"}})
            .LogOfA(found),
        moving("AFolderInPlaceOfTheLogStopsNothing")
            .Before({{LogPlace, Removed}, {LogPlace + "/", ""}}),
        Scenario("APercentSignIsLoggedAsItIs")
            .Before({{"hot/%d %s/", ""}})
            .Log(FolderLines("%d %s", 1, NoIcon(Disabled), NoCfg("%d %s"))),
        Scenario("AStoredPathStaysInItsLine")
            .FolderCfg(Minimal(forged))
            .LogOfA(Found(u8"x\uFFFD\uFFFDEnd: Updating Impose path for JP "
                          u8"Presets\uFFFD\uFFFD\uFFFD\uFFFD\uFFFD\uFFFD\ty"),
                    "", Disabled),
        Scenario("AFolderNameStaysInItsLine")
            .Before({{"hot/x\ny/", ""}, {ListPlace, "<l><HotFolder path='{hot}{/}x&#10;y'/></l>"}})
            .Log(FolderLines(u8"x\uFFFDy", 1, NoIcon(Disabled), NoCfg(u8"x\uFFFDy")))
            .NotOnWindows("no file name has a line end"),
    };
}

TEST_SCENARIOS(Runs);

} // namespace
