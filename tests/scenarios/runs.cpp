// The command line, the run log, and the list of hot folders.
#include "tests/scenarios/texts.h"

namespace
{

SCENARIOS(Runs)
{
    const Text from = Written(MovedFrom);
    const Text to = Written(MovedTo);
    const Text found = Found(MovedFrom);
    const Text forged = "x&#13;&#10;End: Updating Impose path for JP "
                        "Presets&#13;&#10;~&#x7F;&#x9F;&#xA0;&#x2027;&#x2028;&#x2029;&#x202A;&#9;y";
    const auto moving = [&](const Text& name)
    {
        return Scenario(name).File(CfgPlace, from, to);
    };
    return {
        Scenario("WithoutASwitchNothingChanges").File(CfgPlace, from).Run({}),
        Scenario("ADashedSwitchIsInvalid")
            .File(CfgPlace, from)
            .Run({"-I"})
            .WholeLog("Invalid call check calling parameter: exiting....\n"),
        Scenario("AnInvalidSwitchIsNotLoggedWithV").File(CfgPlace, from).Run({"X", "V"}),
        moving("VLeavesTheLogAlone").Run({"I", "v"}),
        moving("AnUpgradeMovesTheTemplate").Run({"i"}).LogOfA(found),
        moving("VIsIgnoredBeforeAnotherArgument").Run({"I", "V", "x"}).LogOfA(found),
        moving("AnotherSecondArgumentIsIgnored").Run({"I", "W"}).LogOfA(found),
        Scenario("ADowngradeMovesTheTemplateBack")
            .File(CfgPlace, to, from)
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
            .File(CfgPlace, Minimal(forged))
            .LogOfA(Found(u8"x\uFFFD\uFFFDEnd: Updating Impose path for JP "
                          u8"Presets\uFFFD\uFFFD~\uFFFD\uFFFD\u00A0\u2027\uFFFD\uFFFD\u202A\ty"),
                    "", Disabled),
        Scenario("AFolderNameStaysInItsLine")
            .Before({{"hot/x\ny/", ""}, {ListPlace, "<l><HotFolder path='{hot}{/}x&#10;y'/></l>"}})
            .Log(FolderLines(u8"x\uFFFDy", 1, NoIcon(Disabled), NoCfg(u8"x\uFFFDy")))
            .NotOnWindows("no file name has a line end"),
    };
}

Text Lines(const Text& name, int position)
{
    return FolderLines(name, position, NoIcon(Disabled), NoCfg(name));
}

SCENARIOS(Lists)
{
    const auto listed = [](const Text& name, const Text& list)
    {
        return Scenario(name).Before({{"hot/A/", ""},
                                      {"hot/b ü 漢/", ""},
                                      {"hot/C/", ""},
                                      {"hot/c/", ""},
                                      {"hot/file", "x"},
                                      {ListPlace, list}});
    };
    return {
        listed("ListedFoldersThatExistAreTakenOnceAndInOrder",
               "<any><!-- --><HotFolder/><HotFolder path=''/><HotFolder path='{hot}{/}missing'/>"
               "<HotFolder path='{hot}{/}C '/><hotfolder path='{hot}{/}A'/>"
               "<x><HotFolder path='{hot}{/}A'/></x><HotFolder path='{hot}{/}file'/>"
               "<HotFolder Path='{hot}{/}A'/><HotFolder path=' {hot}{/}A'/>"
               "<HotFolder z='1' path='{hot}{/}b ü 漢&#10;'/><HotFolder path='{hot}{/}C'/>"
               "<HotFolder path='{hot}{/}c'/></any>")
            .Log(Lines("C", 1) + Lines("b ü 漢", 2)),
        Scenario("AMissingListStillMigratesPresets")
            .Before({{ListPlace, Removed}})
            .File(PresetPlace, Stored(MovedFrom), Stored(MovedTo))
            .LogOfPreset(Updated),
        listed("AMalformedListIsEmpty", "<any><HotFolder path='{hot}{/}A'/>")
            .Log("")
            .LibraryReports(),
        listed("AUtf16ListIsRead", "{utf16}<a><HotFolder path='{hot}{/}b ü 漢'/></a>")
            .Log(Lines("b ü 漢", 1)),
    };
}

} // namespace
