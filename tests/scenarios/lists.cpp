// The list of hot folders.
#include "tests/scenarios/texts.h"

namespace
{

Text Lines(const Text& name, int position)
{
    return FolderLines(name, position, NoIcon(Disabled), NoCfg(name));
}

std::vector<Scenario> Lists()
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
            .Preset(Stored(MovedFrom), Stored(MovedTo))
            .LogOfPreset(Updated),
        listed("AMalformedListIsEmpty", "<any><HotFolder path='{hot}{/}A'/>")
            .Log("")
            .LibraryReports(),
        listed("AUtf16ListIsRead", "{utf16}<a><HotFolder path='{hot}{/}b ü 漢'/></a>")
            .Log(Lines("b ü 漢", 1)),
    };
}

TEST_SCENARIOS(Lists);

} // namespace
