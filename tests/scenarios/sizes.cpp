// Contents that are made to exhaust memory, stack or time when they are loaded.
#include "tests/scenarios/texts.h"

namespace
{

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
        const Text folder = "F" + std::to_string(10 + i);
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
    const auto listed = [](const Text& name, const Text& list)
    {
        return Scenario(name).Before({{"hot/A/", ""}, {ListPlace, "<l>" + list + "</l>"}});
    };
    const Text listedA = "<HotFolder path='{hot}{/}A'/>";
    const Text lines = Times(3000, "123456789\n");
    const Text oneMillion = Times(1000001, "x");
    const Text entries = Times(10000, "    <KEYVALUE Key=\"K#\" Value=\"1\" KeyDisplayValue=\"\" "
                                      "LocDisplayValue=\"\"/>\n");
    const Text filter = "<FilterSetting>\n" + Times(10000, "    <x/>\n") + "  </FilterSetting>\n";
    const Text written =
        Replaced(Replaced(MinimalWritten(MovedTo), "<JobSetting/>\n",
                          "<JobSetting>\n" + entries + "  </JobSetting>\n"),
                 "  <PreflightSettings/>", "  " + filter + "  <PreflightSettings/>");
    const auto defaults = [](int characters)
    {
        return DocumentType("<!ATTLIST a b CDATA '" + Times(characters, "x") + "'>");
    };
    // A Folder.cfg that could not be read again after a rewrite.
    const auto outgrown = [](const Text& name, const Text& inFilter)
    {
        return Scenario(name)
            .FolderCfg(Cfg("<FilterSetting>" + inFilter + "</FilterSetting>"))
            .LogOfDisabledA(
                Found(MovedFrom) +
                "HF cfg file left as it is (the new content would be too large): " + CfgOf("A"));
    };
    const auto elsewhere = [](const Text& name, const Text& stored, const Text& path = "")
    {
        return Scenario(name)
            .FolderCfg(Replaced(Cfg("", DocumentType(Replaced(Entities(5), "'x'", "'$'"))),
                                MovedFrom, stored))
            .LogOfDisabledA(Found(path.empty() ? stored : path));
    };
    return {
        Folders(
            "WhatIsTooLargeStays",
            {Cfg(Times(600000, "    ")), Cfg(Times(120000, "<a/>")),
             Cfg(Times(2100, "<e>") + Times(2100, "</e>")), Times(6000, "<e>"),
             Cfg("<a " + Times(15000, " b#=''") + "/>"), Cfg("<a b='" + oneMillion + "'/>"),
             Cfg("<a>" + lines + lines + "</a>"), Cfg("<a>" + oneMillion + "</a>"),
             Cfg(Times(800, "<a/>"), defaults(8000)),
             Cfg("<a/>", DocumentType(Times(600, "<!ATTLIST a b# CDATA 'default'>"))),
             Cfg(Times(300, "<a/>"), DocumentType(Entities(5) + "<!ATTLIST a b CDATA '&a5;'>"))},
            false),
        Folders("WhatIsJustSmallEnoughMoves",
                {Cfg(Times(60000, "    ")), Cfg(Times(90000, "<a/>")),
                 Cfg(Times(2000, "<e>") + Times(2000, "</e>")),
                 Cfg("<a " + Times(6000, " b#=''") + "/>"), Cfg("<a>" + lines + "</a>"),
                 Cfg("<a b='" + Times(300000, "x") + "'/>"),
                 Cfg("<a>" + Times(20000, "x<!--c-->") + "</a>"),
                 Cfg(Times(500, "<a/>"), defaults(8000)),
                 Cfg("<a b='&a4;'/>", DocumentType(Entities(4)))},
                true),
        Scenario("TenThousandEntriesAndElementsAreKept")
            .FolderCfg(Cfg("<JobSetting>" + entries + "</JobSetting>" + filter), written)
            .LogOfDisabledA(Found(MovedFrom)),
        outgrown("ManyQuotesWouldBeTooLarge", "<a b='" + Times(350000, "\"") + "'/>"),
        outgrown("DeepIndentationWouldBeTooLarge",
                 Times(1020, "<e>") + Times(2000, "<a/>") + Times(1020, "</e>")),
        elsewhere("APathOf200000VariablesIsElsewhere", Times(200000, "$")),
        elsewhere("AnExpandedPathOf300000VariablesIsElsewhere", "&a5;&a5;&a5;", Times(300000, "$")),
        listed("AListThatIsTooDeepIsEmpty", Times(6000, "<e>")).Log(""),
        listed("AListThatIsTooBigIsEmpty", listedA + Times(1600000, "<a/>")).Log(""),
        listed("AListOf20000EntriesIsRead",
               listedA + Times(20000, "<HotFolder path='{/}missing'/>"))
            .Log(FolderLines("A", 1, NoIcon("hf_folder_disabled"), NoCfg("A"))),
    };
}

TEST_SCENARIOS(Sizes);

} // namespace
