#include "tests/scenario.h"

#include "tests/scenarios/texts.h"

Scenario& Scenario::Log(const std::vector<FolderLog>& folders, const Text& presets)
{
    const bool isUpgrade = arguments[0] != "U" && arguments[0] != "u";
    Text lines = isUpgrade ? "Installation : Upgrade call with switch: I\n"
                           : "Un-installation : Downgrade call with switch: U\n";
    lines += Text(folders.empty() ? "No Hotfolder listed\n" : "") + "Start: HF updation\n";
    int position = 0;
    for (const auto& [folder, impose, icon] : folders)
    {
        const Text end = "{hot}{/}A count:  " + std::to_string(++position) + "\n";
        const auto copy = before.find("hot/" + folder + "/[P]/" + icon + ".ico");
        const bool isThere = copy != before.end() && copy->second != Removed;
        const Text ofIcon = icon.back() == '\n' ? icon : isThere ? Copied(icon) : NoIcon(icon);
        lines += Replaced(ofIcon + "Updated icon for hf" + end + impose +
                              "updated Impose path for hf" + end,
                          "{hot}{/}A", "{hot}{/}" + folder);
    }
    lines += "End: HF updation\nStart: Updating Impose path for JP Presets\n" + presets +
             "End: Updating Impose path for JP Presets\n";
    return WholeLog(Replaced(lines, "{icons}", isUpgrade ? "" : "BundleIcons{/}"));
}

Scenario& Scenario::IsReported(const Text& lines)
{
    report = lines.empty() || lines[0] == '\n' ? lines : "\n" + lines;
    for (const auto& [token, text] :
         Files{{"{moves}", "change   Folder.cfg: " + MovedFrom + " -> " + MovedTo},
               {"{presetmoves}", "change   .P{xml}: " + MovedFrom + " -> " + MovedTo},
               {"{xml}", "{/}Presets{/}presets.xml"},
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
    for (const auto& [place, text] : scenario.before)
    {
        const size_t end = place.find('/', 4);
        const Text entry = "<HotFolder path=\"{hot}{/}" + place.substr(4, end - 4) + "\"/>";
        if (StartsWith(place, "hot/") && end != Text::npos && list.find(entry) == Text::npos)
            list += entry;
    }
    files.insert({{ListPlace, list + "</HotFolders>"},
                  {LogPlace, "The log of an earlier run\r\n"},
                  {"user/ORX/JPData/", ""},
                  {"previous/Booklet.tpl", ""},
                  {"default/Booklet.tpl", ""},
                  {MachineHive, Hive(MachineKey, "\"InstallPath\"=\"{app}\"")},
                  {UserHive, Hive(UserKey, "\"Path\"=\"{previous}\"")}});
    for (auto file = files.begin(); file != files.end();)
        file = file->second == Removed ? files.erase(file) : std::next(file);
    return files;
}
