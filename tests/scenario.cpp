#include "tests/scenario.h"

#include "tests/scenarios/texts.h"
#include "tests/text_files.h"

const char* const Removed = "(not there)";

Scenario& Scenario::Before(const Files& files)
{
    for (const auto& [place, text] : files)
        before[place] = text;
    return *this;
}

Scenario& Scenario::FolderCfg(const Text& text)
{
    before[CfgPlace] = text;
    return *this;
}

Scenario& Scenario::FolderCfg(const Text& text, const Text& textAfter)
{
    after[CfgPlace] = textAfter;
    return FolderCfg(text);
}

Scenario& Scenario::Preset(const Text& text)
{
    before[PresetPlace] = text;
    return *this;
}

Scenario& Scenario::Preset(const Text& text, const Text& textAfter)
{
    after[PresetPlace] = textAfter;
    return Preset(text);
}

Scenario& Scenario::AsOtherUser()
{
    asOtherUser = true;
    return *this;
}

Scenario& Scenario::Run(const std::vector<Text>& theArguments)
{
    arguments = theArguments;
    return *this;
}

Scenario& Scenario::After(const Files& files)
{
    for (const auto& [place, text] : files)
        after[place] = text;
    return *this;
}

Scenario& Scenario::WholeLog(const Text& text)
{
    log = text;
    return *this;
}

Scenario& Scenario::Log(const Text& folders, const Text& presets)
{
    return WholeLog("{start}" + Text(folders.empty() ? "No Hotfolder listed\n" : "") + "Start: HF updation\n" + folders +
                    "End: HF updation\nStart: Updating Impose path for JP Presets\n" + presets +
                    "End: Updating Impose path for JP Presets\n");
}

Scenario& Scenario::LogOfA(const Text& impose, const Text& presets)
{
    return Log(FolderLines("A", 1, NoIcon("hf_folder"), impose), presets);
}

Scenario& Scenario::LogOfDisabledA(const Text& impose, const Text& presets)
{
    return Log(FolderLines("A", 1, NoIcon("hf_folder_disabled"), impose), presets);
}

Scenario& Scenario::LogOfPreset(const Text& line)
{
    return Log("", PresetLine(line));
}

Scenario& Scenario::LibraryReports()
{
    libraryReports = true;
    return *this;
}

Scenario& Scenario::Within(double theSeconds, long theMegabytes)
{
    seconds = theSeconds;
    megabytes = theMegabytes;
    return *this;
}

Scenario& Scenario::NotUnderWine(const char* reason)
{
    notUnderWine = reason;
    return *this;
}

Files WorkstationBefore(const Scenario& scenario)
{
    Files files = scenario.before;
    Text list = "<HotFolders>";
    Text last;
    for (const auto& [place, text] : scenario.before)
    {
        const Text name = StartsWith(place, "hot/") ? place.substr(4, place.find('/', 4) - 4) : "";
        if (!name.empty() && name != last)
            list += "<HotFolder path=\"{hot}{/}" + name + "\"/>";
        last = name.empty() ? last : name;
    }
    files.insert({{ListPlace, list + "</HotFolders>"},
                  {LogPlace, "The log of an earlier run\r\n"},
                  {"user/ORX/JPData/", ""},
                  {MachineHive, MachineValue("\"InstallPath\"=\"{APP}\"")},
                  {UserHive, UserValue("\"Path\"=\"{PREVIOUS}\"")}});
    for (auto file = files.begin(); file != files.end();)
        file = file->second == Removed ? files.erase(file) : std::next(file);
    return files;
}

Text LogAfter(const Scenario& scenario)
{
    const bool isUpgrade = !scenario.arguments.empty() && (scenario.arguments[0] == "I" || scenario.arguments[0] == "i");
    Text log = scenario.log;
    ReplaceAll(log, "{start}",
               isUpgrade ? "Installation : Upgrade call with switch: I\n" : "Un-installation : Downgrade call with switch: U\n");
    ReplaceAll(log, "{icons}", isUpgrade ? "" : "BundleIcons{/}");
    return log;
}
