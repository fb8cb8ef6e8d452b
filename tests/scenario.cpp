#include "tests/scenario.h"

#include "tests/scenarios/texts.h"

#include <set>

Scenario& Scenario::Before(const Files& files)
{
    for (const auto& [place, text] : files)
        before[place] = text;
    return *this;
}

Scenario& Scenario::After(const Files& files)
{
    for (const auto& [place, text] : files)
        after[place] = text;
    return *this;
}

Scenario& Scenario::File(const Text& place, const Text& text, const Text& becomes)
{
    before[place] = text;
    if (!becomes.empty())
        after[place] = becomes;
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

Scenario& Scenario::LogOfPreset(const Text& line)
{
    return Log("", PresetLine(line));
}

Scenario& Scenario::Shell(const Text& version, const Text& calls)
{
    shellVersion = version;
    shellCalls = calls;
    return NotOnWindows("the system's own shell is called");
}

Scenario& Scenario::IsReported(const Text& lines)
{
    report = lines;
    for (const auto& [token, text] : Files{
             {"{moves}",
              "  change   Folder.cfg: {previous}{/}Booklet.tpl -> {default}{/}Booklet.tpl"},
             {"{nodisabled}", "  note     no copy of the icon to replace: hf_folder_disabled.ico"},
             {"{nothing}", ", for the account *; nothing moves. Run as the client's user, "
                           "after its installation"},
             {"{log}", "{user}{/}ORX_Installers{/}UpgradeDowngrade.log"},
             {"{list}", "{machine}{/}hotfolder{/}HotFolderList.cfg"},
             {"{Path}", "registry value Path in HKEY_CURRENT_USER\\SOFTWARE\\HF"}})
        report = Replaced(*report, token, text);
    return *this;
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
                  {"previous/", ""},
                  {MachineHive, MachineValue("\"InstallPath\"=\"{app}\"")},
                  {UserHive, UserValue("\"Path\"=\"{previous}\"")}});
    for (auto file = files.begin(); file != files.end();)
        file = file->second == Removed ? files.erase(file) : std::next(file);
    return files;
}
