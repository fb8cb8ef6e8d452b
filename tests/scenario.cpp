#include "tests/scenario.h"

#include "tests/scenarios/texts.h"
#include "tests/text_files.h"

#include <set>

Scenario& Scenario::Add(Files& to, const Files& files)
{
    for (const auto& [place, text] : files)
        to[place] = text;
    return *this;
}

Scenario& Scenario::Log(const Text& folders, const Text& presets)
{
    return WholeLog("{start}" + Text(folders.empty() ? "No Hotfolder listed\n" : "") +
                    "Start: HF updation\n" + folders +
                    "End: HF updation\nStart: Updating Impose path for JP Presets\n" + presets +
                    "End: Updating Impose path for JP Presets\n");
}

Scenario& Scenario::LogOfA(const Text& impose, const Text& presets, const Text& icon)
{
    return Log(FolderLines("A", 1, NoIcon(icon), impose), presets);
}

Scenario& Scenario::LogOfDisabledA(const Text& impose, const Text& presets)
{
    return LogOfA(impose, presets, "hf_folder_disabled");
}

Scenario& Scenario::LogOfPreset(const Text& line)
{
    return Log("", PresetLine(line));
}

Files WorkstationBefore(const Scenario& scenario)
{
    Files files = scenario.before;
    Text list = "<HotFolders>";
    std::set<Text> names;
    for (const auto& [place, text] : scenario.before)
    {
        const size_t end = place.find('/', 4);
        if (StartsWith(place, "hot/") && end != Text::npos &&
            names.insert(place.substr(4, end - 4)).second)
            list += "<HotFolder path=\"{hot}{/}" + place.substr(4, end - 4) + "\"/>";
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
    const bool isUpgrade = !scenario.arguments.empty() &&
                           (scenario.arguments[0] == "I" || scenario.arguments[0] == "i");
    Text log = scenario.log;
    ReplaceAll(log, "{start}",
               isUpgrade ? "Installation : Upgrade call with switch: I\n"
                         : "Un-installation : Downgrade call with switch: U\n");
    ReplaceAll(log, "{icons}", isUpgrade ? "" : "BundleIcons{/}");
    return log;
}

void TestOn(const Scenario& scenario, const std::string& program,
            const std::function<void(Workstation&)>& test)
{
    if (IsWindowsProgram() && !scenario.notUnderWine.empty())
        GTEST_SKIP() << scenario.notUnderWine;
    Text description = scenario.name.what + ": " + program;
    for (const Text& argument : scenario.arguments)
        description += " " + argument;
    const testing::ScopedTrace trace(scenario.name.file, scenario.name.line, description);
    try
    {
        Workstation workstation(scenario.asOtherUser);
        workstation.LayOut(WorkstationBefore(scenario));
        test(workstation);
    }
    catch (const std::exception& exception)
    {
        FAIL() << exception.what();
    }
}
