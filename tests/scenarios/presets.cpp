// The job presets.
#include "tests/scenarios/texts.h"

namespace
{

SCENARIOS(Presets)
{
    const Text near = "x ORXImposeTemplate\">\"{previous}er{/}x\" ORXImposeTemplate\">\"{previous} "
                      "orximposetemplate\">\"{previous}\" ORXImposeTemplate='>\"{previous}\" "
                      "ORXImposeTemplate\">\"{previous}";
    const Text from = Stored(MovedFrom);
    const Text to = Stored(MovedTo);
    const auto updated = [](const Text& name, const Text& before, const Text& after)
    {
        return Scenario(name)
            .File(PresetPlace, before)
            .After({{PresetPlace, after}})
            .LogOfPreset(Updated);
    };
    const auto left = [](const Text& name, const Text& preset, const Text& reason)
    {
        return Scenario(name)
            .File(PresetPlace, preset)
            .LogOfPreset("preset.xml left as it is (" + reason + "): ");
    };
    return {
        updated("EveryPathInTheFolderMoves",
                "\r\n" + from + near + "\r\n" + Stored("{previous}{/}Sub{/}x") +
                    Stored("{previous}") + near,
                "\r\n" + to + near + "\r\n" + Stored("{default}{/}Sub{/}x") + Stored("{default}") +
                    near),
        updated("AnEmptyPresetIsUpdated", "", ""),
        updated("AByteOrderMarkAloneGoes", "\xEF\xBB\xBF", ""),
        updated("AByteOrderMarkGoes", "\xEF\xBB\xBF" + from, to),
        updated("AUtf16PresetComesOutInUtf8", "{utf16}\r\n" + from + "Ě\x1A",
                "\r\n" + to + "Ě\x1A"),
        updated("NulAndCtrlZEndNothing", Text("a\0b\x1A\r\n", 6) + from + "end",
                Text("a\0b\x1A\r\n", 6) + to + "end"),
        updated("BytesThatAreNotUtf8AreTakenAsLatin1", "\xE4\r\n", "ä\r\n"),
        left("HalfAUtf16UnitStays", Text("\xFF\xFE") + Text("a\0b", 3), "cannot be decoded"),
        left("ALoneSurrogateStays", Text("\xFF\xFE\0\0\0\xD8\0\0a\0\0\0", 12),
             "cannot be encoded again"),
        Scenario("AFolderInPlaceOfAPresetIsSkipped")
            .Before({{PresetPlace + "/", ""}})
            .LogOfPreset("Unable to open preset.xml for read : "),
        Scenario("OnlyDirectSubdirectoriesAreSearched")
            .Before({{"user/ORX/JPData/Presets/presets.xml", from},
                     {"user/ORX/JPData/P/Q/Presets/presets.xml", from},
                     {"user/ORX/JPData/presets.xml", from}})
            .Log(""),
        Scenario("WithoutAPresetRootItsPathIsLogged")
            .Before({{"user/ORX/JPData/", Removed}, {UserHive, Removed}})
            .Log("", "Preset dirctory  not exist: {user}{/}ORX{/}JPData{/}\n" + NoPrevious),
    };
}

} // namespace
