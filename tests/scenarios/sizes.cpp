// Contents that are made to exhaust memory, stack or time when they are loaded.
#include "tests/scenarios/texts.h"

namespace
{

Text Times(int count, const Text& text)
{
    return "{repeat:" + std::to_string(count) + ":" + text + "}";
}

// A Folder.cfg whose template moves if it can be loaded, with this additional content.
Text Cfg(const Text& content, const Text& documentType = "")
{
    return documentType + "<HotFolder name='n'><ImposeSetting><K k='ORXImposeTemplate' v='" +
           MovedFrom + "'/></ImposeSetting>" + content + "</HotFolder>";
}

Text DocumentType(const Text& content)
{
    return "<!DOCTYPE HotFolder [" + content + "]>";
}

// Entities that each repeat the previous one ten times, so that aN has 10 to the power of N
// characters.
Text Entities(int count)
{
    Text text = "<!ENTITY a0 'x'>";
    for (int i = 1; i <= count; ++i)
        text += "<!ENTITY a" + std::to_string(i) + " '" +
                Times(10, "&a" + std::to_string(i - 1) + ";") + "'>";
    return text;
}

// Hot folders with these contents, which either move or are too large; and one folder before and
// one after them.
Scenario Folders(const Text& name, const std::vector<Text>& contents, bool isLoaded)
{
    Scenario scenario(name);
    Text log;
    for (size_t i = 0; i <= contents.size() + 1; ++i)
    {
        const bool isGiven = i > 0 && i <= contents.size();
        const Text folder = "F" + std::to_string(i);
        const Text place = "hot/" + folder + "/[P]/Folder.cfg";
        const bool moves = isLoaded || !isGiven;
        scenario.Before({{place, isGiven ? contents[i - 1] : Cfg("")}});
        if (moves)
            scenario.After({{place, MinimalWritten(MovedTo)}});
        log += FolderLines(folder, static_cast<int>(i) + 1, NoIcon("hf_folder_disabled"),
                           moves ? Found(MovedFrom, folder)
                                 : "HF cfg file left as it is (too large to read safely): " +
                                       CfgOf(folder));
    }
    return scenario.Log(log);
}

std::vector<Scenario> Sizes()
{
    constexpr int Big = 64 * 1024 * 1024 - 500;
    const auto tooLarge = [](const Text& name, const std::vector<Text>& contents)
    {
        return Folders(name, contents, false);
    };
    const auto loaded = [](const Text& name, const std::vector<Text>& contents)
    {
        return Folders(name, contents, true);
    };
    const auto listed = [](const Text& name, const Text& list)
    {
        return Scenario(name).Before({{"hot/A/", ""}, {ListPlace, "<l>" + list + "</l>"}});
    };
    const Text entries =
        Times(100000,
              "    <KEYVALUE Key=\"K#\" Value=\"1\" KeyDisplayValue=\"\" LocDisplayValue=\"\"/>\n");
    const Text filter = "<FilterSetting>\n" + Times(100000, "    <x/>\n") + "  </FilterSetting>\n";
    const Text written =
        Replaced(Replaced(MinimalWritten(MovedTo), "<JobSetting/>\n",
                          "<JobSetting>\n" + entries + "  </JobSetting>\n"),
                 "  <PreflightSettings/>", "  " + filter + "  <PreflightSettings/>");
    return {
        tooLarge("ABigFolderCfgStays",
                 {Cfg(Times(Big / 4, "<a/>")), Cfg("<a b='" + Times(Big, "x") + "'/>")}),
        tooLarge("ADeepFolderCfgStays",
                 {Cfg(Times(2000000, "<e>") + Times(2000000, "</e>")), Times(2000000, "<e>")}),
        tooLarge("AWideFolderCfgStays", {Cfg("<a " + Times(80000, " b#=''") + "/>")}),
        tooLarge("ALongTextStays", {Cfg("<a>" + Times(40000, "short line\n") + "</a>"),
                                    Cfg("<a>" + Times(8000000, "x") + "</a>")}),
        tooLarge(
            "ManyLongDefaultsStay",
            {Cfg(Times(8000, "<a/>"),
                 DocumentType("<!ATTLIST a b CDATA '" + Times(32000, "x") + "'>")),
             Cfg(Times(3000, "<a/>"), DocumentType(Entities(5) + "<!ATTLIST a b CDATA '&a5;'>"))}),
        loaded("SixteenKilobytesAreHarmless",
               {Cfg(Times(2300, "<e>") + Times(2300, "</e>")),
                Cfg("<a>" + Times(16000, "\n") + "</a>"), Cfg("<a" + Times(1200, " b#=''") + "/>"),
                Cfg("<a b='&a6;'/>", DocumentType(Entities(6))),
                Cfg(Times(1900, "<a/>"),
                    DocumentType("<!ATTLIST a b CDATA '" + Times(8000, "x") + "'>"))}),
        loaded("ATextOf9000LinesIsLoaded", {Cfg("<a>" + Times(9000, "123456789\n") + "</a>")}),
        loaded("ADepthOf100000IsLoaded", {Cfg(Times(100000, "<e>") + Times(100000, "</e>"))}),
        loaded("ManyShortTextsAndCommentsAreLoaded",
               {Cfg("<a>" + Times(60000, "x<!--c-->") + "</a>", DocumentType(""))}),
        Scenario("100000EntriesAndElementsAreKept")
            .FolderCfg(Cfg("<JobSetting>" + entries + "</JobSetting>" + filter), written)
            .LogOfDisabledA(Found(MovedFrom)),
        listed("AListThatIsTooDeepIsEmpty", Times(2000000, "<e>")).Log(""),
        listed("AListThatIsTooBigIsEmpty", "<HotFolder path='{hot}{/}A'/>" + Times(Big / 4, "<a/>"))
            .Log(""),
        listed("AListOf100000EntriesIsRead",
               "<HotFolder path='{hot}{/}A'/>" +
                   Times(100000, "<HotFolder path='{hot}{/}missing'/>"))
            .Log(FolderLines("A", 1, NoIcon("hf_folder_disabled"), NoCfg("A"))),
    };
}

TEST_SCENARIOS(Sizes);

} // namespace
