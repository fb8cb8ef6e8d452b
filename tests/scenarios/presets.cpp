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
    // These presets are the only files; each has one line in the log, and one in the report.
    const auto only =
        [](const Text& name, const Text& preset, const Text& logged, const Text& reported)
    {
        return Scenario(name)
            .File(PresetPlace, preset)
            .Log({}, PresetLine(logged))
            .IsReported("Job presets: " + reported);
    };
    const auto updated =
        [&](const Text& name, const Text& before, const Text& after, const Text& reported)
    {
        return only(name, before, Updated, reported).After({{PresetPlace, after}});
    };
    const Text utf8 = "\nJob presets: change   .P{xml}: comes out as UTF-8";
    const Text eol = IsWindows ? "\r\n" : "\n";
    return {
        Scenario("EveryPathInTheFolderMoves", {{PresetPlace + "#", "HS"}})
            .File(PresetPlace,
                  "\r\n" + from + near + "\r\n" + Stored("{previous}{/}Sub{/}x") +
                      Stored("{previous}") + near,
                  "\r\n" + to + near + "\r\n" + Stored("{default}{/}Sub{/}x") +
                      Stored("{default}") + near)
            .Log({}, PresetLine(Updated)),
        Scenario("AnEmptyPresetIsUpdated").File(PresetPlace, "").Log({}, PresetLine(Updated)),
        updated("AByteOrderMarkAloneGoes", "\xEF\xBB\xBF", "",
                "change   .P{xml}: loses its byte-order mark"),
        updated("LineEndsBecomeThoseOfTheSystem", "\xEF\xBB\xBF<p>\n</p>", "<p>" + eol + "</p>",
                Text("change   .P{xml}: loses its byte-order mark") +
                    (IsWindows ? ", and its line ends become CR LF" : "")),
        Scenario("LineEndsAloneBecomeThoseOfTheSystem", {{PresetPlace, "<p>\n</p>"}})
            .After({{PresetPlace, "<p>" + eol + "</p>"}})
            .Log({}, PresetLine(Updated))
            .IsReported(IsWindows ? "Job presets: change   .P{xml}: its line ends become CR LF"
                                  : ""),
        updated("AUtf16PresetMovesToo", "{utf16}" + from, to, "{presetmoves}"),
        updated("AUtf16PresetComesOutInUtf8", "{utf16}\r\nĚ\x1A", "\r\nĚ\x1A",
                "change   .P{xml}: comes out as UTF-8, without byte-order mark"),
        updated("NulAndCtrlZEndNothing", Text("a\0b\x1A\r\n", 6) + from + "end",
                Text("a\0b\x1A\r\n", 6) + to + "end", "{presetmoves}"),
        updated("BytesThatAreNotUtf8AreTakenAsLatin1", "\xE4\r\n", "ä\r\n",
                "problem  .P{xml}: is not UTF-8, so the whole file is read as Latin-1; accented "
                "characters come out wrong" +
                    utf8),
        updated(
            "ADeclaredEncodingStays", "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><p>\xE4</p>",
            "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><p>ä</p>",
            "problem  .P{xml}: declares the encoding ISO-8859-1, but comes out as UTF-8" + utf8),
        only("HalfAUtf16UnitStays", Text("\xFF\xFE") + Text("a\0b", 3),
             "preset.xml left as it is (cannot be decoded): ",
             "problem  .P{xml}: left as it is (cannot be decoded)"),
        only("ALoneSurrogateStays", Text("\xFF\xFE\0\0\0\xD8\0\0a\0\0\0", 12),
             "preset.xml left as it is (cannot be encoded again): ",
             "problem  .P{xml}: left as it is (cannot be encoded again)"),
        Scenario("FoldersInPlaceOfStoredFilesAreSkipped",
                 {{CfgPlace + "/", ""}, {PresetPlace + "/", ""}})
            .Log({{"A", NoCfg, Disabled}}, PresetLine("Unable to open preset.xml for read : "))
            .IsReported(R"(
A: problem  Folder.cfg: is not a file
Job presets: problem  .P{xml}: reached over a link, or not a file)"),
        Scenario("OnlyDirectSubdirectoriesAreSearchedEvenIfTheListIsAFolder",
                 {{ListPlace, Removed}, {ListPlace + "/", ""}})
            .Before(
                {{JobPresets + "/Presets/presets.xml", from}, {JobPresets + "/presets.xml", from}})
            .Before({{JobPresets + "/P/Q/Presets/presets.xml", from}})
            .Log()
            .IsReported(R"(
Workstation: problem  HotFolderList.cfg: is not a file
Job presets: note     there are no presets in {user}{/}ORX{/}JPData{/})"),
    };
}

} // namespace
