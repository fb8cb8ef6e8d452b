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

HotFolder Moving(const Text& cfg)
{
    return {cfg, MinimalWritten(MovedTo), Found(MovedFrom)};
}

HotFolder TooLarge(const Text& cfg)
{
    return {cfg, "", Untouched("too large to read safely")};
}

// It could not be read again after a rewrite.
HotFolder Outgrown(const Text& inFilter)
{
    return {Cfg("<FilterSetting>" + inFilter + "</FilterSetting>"), "",
            Found(MovedFrom) + Untouched("the new content would be too large")};
}

HotFolder Elsewhere(const Text& stored, const Text& path)
{
    const Text dollars = DocumentType(Replaced(Entities(5), "'x'", "'$'"));
    return {Replaced(Cfg("", dollars), MovedFrom, stored), "", Found(path)};
}

SCENARIOS(Sizes)
{
    const Text lines = Times(3000, "123456789\n");
    const Text oneMillion = Text(1000001, 'x');
    const Text entries = Times(10000, "    <KEYVALUE Key=\"K#\" Value=\"" + Text(90, 'v') +
                                          "\" KeyDisplayValue=\"\" LocDisplayValue=\"\"/>\n");
    const Text filter = "<FilterSetting>\n" + Times(10000, "    <x/>\n") + "  </FilterSetting>\n";
    const Text written =
        Replaced(Replaced(MinimalWritten(MovedTo), "<JobSetting/>\n",
                          "<JobSetting>\n" + entries + "  </JobSetting>\n"),
                 "  <PreflightSettings/>", "  " + filter + "  <PreflightSettings/>");
    const Text defaults = DocumentType("<!ATTLIST a b CDATA '" + Text(8000, 'x') + "'>");
    const Text million = DocumentType(Entities(5) + "<!ATTLIST a b CDATA '&a5;'>");
    const Text declared = DocumentType(Times(600, "<!ATTLIST a b# CDATA 'default'>"));
    return {
        HotFolders("WhatIsTooLargeStays",
                   {{"Bytes", TooLarge(Cfg(Text(2400000, ' ')))},
                    {"Elements", TooLarge(Cfg(Times(120000, "<a/>")))},
                    {"Levels", TooLarge(Cfg(Times(2100, "<e>") + Times(2100, "</e>")))},
                    {"Attributes", TooLarge(Cfg("<a " + Times(15000, " b#=''") + "/>"))},
                    {"Value", TooLarge(Cfg("<a b='" + oneMillion + "'/>"))},
                    {"Lines", TooLarge(Cfg("<a>" + lines + lines + "</a>"))},
                    {"Text", TooLarge(Cfg("<a>" + oneMillion + "</a>"))},
                    {"Long defaults", TooLarge(Cfg(Times(800, "<a/>"), defaults))},
                    {"Many defaults", TooLarge(Cfg("<a/>", declared))},
                    {"Entities", TooLarge(Cfg(Times(300, "<a/>"), million))},
                    {"Quotes", Outgrown("<a b='" + Text(350000, '"') + "'/>")},
                    {"Filter levels", Outgrown(Times(1025, "<e>") + Times(1025, "</e>"))},
                    {"Indentation",
                     Outgrown(Times(1020, "<e>") + Times(2000, "<a/>") + Times(1020, "</e>"))}}),
        HotFolders("WhatIsJustSmallEnoughMoves",
                   {{"Bytes", Moving(Cfg(Text(240000, ' ')))},
                    {"Elements", Moving(Cfg(Times(90000, "<a/>")))},
                    {"Levels", Moving(Cfg(Times(2000, "<e>") + Times(2000, "</e>")))},
                    {"Attributes", Moving(Cfg("<a " + Times(6000, " b#=''") + "/>"))},
                    {"Lines", Moving(Cfg("<a>" + lines + "</a>"))},
                    {"Value", Moving(Cfg("<a b='" + Text(300000, 'x') + "'/>"))},
                    {"Comments", Moving(Cfg("<a>" + Times(20000, "x<!--c-->") + "</a>"))},
                    {"Long defaults", Moving(Cfg(Times(500, "<a/>"), defaults))},
                    {"Entities", Moving(Cfg("<a b='&a4;'/>", DocumentType(Entities(4))))},
                    {"Entries",
                     {Cfg("<JobSetting>" + entries + "</JobSetting>" + filter), written,
                      Found(MovedFrom)}},
                    {"Variables", Elsewhere(Text(200000, '$'), Text(200000, '$'))},
                    {"Expanded variables", Elsewhere("&a5;&a5;&a5;", Text(300000, '$'))}}),
        Scenario("AListThatIsTooBigIsEmpty", {{"hot/A/", ""},
                                              {ListPlace, "<l><HotFolder path='{hot}{/}A'/>" +
                                                              Times(1600000, "<a/>") + "</l>"}})
            .Log()
            .IsReported("Workstation: problem  HotFolderList.cfg: too large to read safely"),
    };
}

} // namespace
