// The icon of a hot folder: which one, Desktop.ini, and the attributes.
#include "tests/scenarios/texts.h"

#include <array>

namespace
{

Text Cfg(const Text& enabled)
{
    return "<H name='' description='' server_ip='' server_name='' Enable='" + enabled + "'/>";
}

// A hot folder for each state, with the name of its icon.
Scenario States(const Text& name, const Text& letter)
{
    // Its icon (in the order of the list), Enable, and a place; a directory there does not count.
    using State = std::array<Text, 3>;
    const bool isUpgrade = letter == "I";
    Scenario scenario(name);
    std::vector<FolderLog> log;
    for (const auto& [icon, enabled, error] : {State{"hf_error_active", "1", "Error.er"},
                                               {"hf_error_inactive", "", "Error.er"},
                                               {"hf_folder", "1", "Error.er/"},
                                               {Disabled, "01", "Error.er/"}})
    {
        const Text folder = "hot/" + icon;
        const Text ini = folder + "/Desktop.ini";
        const Text copy = folder + "/[P]/" + icon + ".ico";
        const Text previous = "of the previous version";
        scenario
            .Before({{folder + "/[P]/Folder.cfg", Cfg(enabled)}, {folder + "/[P]/" + error, ""}})
            .Before(
                {{folder + "/[P]/other.ico", "stays"}, {folder + "/Error.er", ""}, {copy, "old"}})
            .Before(
                {{"tool/" + icon + ".ico#", "R"}, {"tool/BundleIcons/" + icon + ".ico", previous}})
            .After({{folder + "#", "S"}, {copy, isUpgrade ? "{icon:" + icon + ".ico}" : previous}})
            .After({{ini, IniHeader + IconFile(icon) + "IconIndex=00\r\n" + InfoTip},
                    {ini + "#", "RS"}});
        log.push_back({icon, "", icon});
    }
    return scenario.Run({letter}).Log(log);
}

SCENARIOS(Icons)
{
    const Text disabled = IconFile(Disabled);
    const Text users =
        "; mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=x.ico\n"
        "IconIndex=3\nIconResource=y,1\n\n[.ShellClassInfo]\nInfoTip=second\n";
    const Text usersAfter =
        Replaced(Replaced(users, "x.ico\n", disabled.substr(9)), "y,1\n", "y,1\n" + InfoTip);
    const auto refresh = [](const Text& name, const Text& before, const Text& after)
    {
        return Scenario(name, {{Icon, "old"}, {Ini, before}})
            .After({{"hot/A#", "S"}, {Ini + "#", "RS"}})
            .After({{Ini, after}, {Icon, "{icon:hf_folder_disabled.ico}"}})
            .Log({{"A", NoCfg, Disabled}});
    };
    return {
        States("AnUpgradeShowsEachState", "I"),
        States("ADowngradeShowsEachState", "U"),
        Scenario(
            "WithoutItsIconAFolderStays",
            {{Icon, "old"}, {"tool/BundleIcons/hf_folder_disabled.ico", ""}, {Ini, "; mine\n"}})
            .File(CfgPlace, Cfg("1"))
            .Log({{"A", ""}})
            .IsReported("A: note     no copy of the icon to replace: hf_folder.ico"),
        Scenario("WithoutTheNewIconsFoldersStay", DoneFolder("A", Written("")))
            .Before(DoneFolder("B", Written("")))
            .Before({{"tool/BundleIcons#", "0"}})
            .Run({"U"})
            .AsOtherUser()
            .Log({{"A", Found(""), NoIcon("hf_folder")}, {"B", Found(""), NoIcon("hf_folder")}})
            .IsReported("A: problem  source icon missing: {tool}{/}BundleIcons{/}hf_folder.ico"),
        refresh("OurDesktopIniIsRefreshed",
                IniHeader + IconFile("hf_folder") + "IconIndex=00\r\nInfoTip=old\r\n",
                IniHeader + disabled + "IconIndex=00\r\n" + InfoTip)
            .Before({{Ini + "#", "RS"}, {"hot/A#", "R"}}),
        refresh("AUsersDesktopIniKeepsEverythingElseButIsNotHidden", users, usersAfter)
            .Before({{Ini + "#", "HRS"}, {"hot/A#", "H"}})
            .After({{"hot/A#", "HS"}})
            .IsReported(R"(
A: change   hf_folder_disabled.ico
A: change   Desktop.ini: InfoTip, IconFile
A: change   Desktop.ini: attributes READONLY HIDDEN SYSTEM -> READONLY SYSTEM
A: change   hot folder: attributes HIDDEN -> HIDDEN SYSTEM
A: note     no Folder.cfg)"),
        Scenario("ARefreshClearsEveryOtherAttribute", DoneFolder("A", "<H/>", Disabled))
            .Before({{Ini + "#", "RSN"}, {"hot/A#", "SN"}})
            .After({{Ini + "#", "RS"}})
            .Log({{"A", "", Disabled}})
            .NotUnderWine("Wine does not keep that attribute")
            .IsReported("A: change   Desktop.ini: attributes READONLY SYSTEM NOT_CONTENT_INDEXED "
                        "-> READONLY SYSTEM"),
        refresh("AMissingSectionIsAddedAfterTheLastLine", "[x]\r\na=b",
                "[x]\r\na=b\r\n" + IniHeader + InfoTip + disabled)
            .Before({{Ini + "#", "R"}, {"hot/A#", "RS"}}),
        refresh("AUtf16DesktopIniStaysUtf16",
                "{utf16}" + IniHeader + "IconFile=ü.ico\r\nInfoTip=old\r\n",
                "{utf16}" + IniHeader + disabled + InfoTip)
            .Before({{Ini + "#", "S"}}),
        refresh("AReadOnlyDesktopIniAndIconOfTheUsersAreWritten", "",
                IniHeader + InfoTip + disabled)
            .Before({{Ini + "#", "RS"}, {Icon + "#", "R"}})
            .After({{Icon + "#", Removed}})
            .AsOtherUser()
            .NotOnWindows("a copy onto a read-only file is refused"),
        refresh("ADesktopIniOfAnotherUserStays", "[x]\r\n", "[x]\r\n")
            .Before({{Ini + "#", "X"}})
            .After({{Ini + "#", Removed}})
            .AsOtherUser()
            .NotUnderWine("there a read-only file of a user who is not root loses SYSTEM"),
        Scenario("FoldersOfAnotherUserAndPresetsThatCannotBeListed",
                 DoneFolder("A", "<H/>", Disabled))
            .Before(DoneFolder("B", "<H/>", Disabled))
            .Before({{Ini, Removed}, {Ini + "#", Removed}})
            .Before({{JobPresets + "#", "L"}, {PresetPlace, ""}})
            .Before({{"hot/A#", "SX"}, {"hot/B#", "X"}})
            .AsOtherUser()
            .NotUnderWine("Wine lets every user list a directory")
            .IsReported(R"(
A: problem  Desktop.ini: cannot be created, because the hot folder cannot be written to
B: problem  hot folder: its attributes cannot be changed
Job presets: problem  {user}{/}ORX{/}JPData{/} cannot be listed)"),
        Refused("AFolderOfAnotherUserStays",
                {{Icon, "old"}, {Icon + "#", "X"}, {"hot/A#", "X"}, {"hot/A/[P]#", "X"}})
            .Log({{"A", NoCfg, Disabled}}),
    };
}

// What the shell is asked for and told.
SCENARIOS(ShellCalls)
{
    const Text force = "force {hot}{/}A 10 .\\[_ORX_HotFolder_]\\hf_folder_disabled.ico 0 0 2\n";
    const Text notices = Replaced("notify 800 1005 {ini} 0\ninfo {ini} 0 1 4000\n"
                                  "notify 8000 1003  -7\nnotify 8 1005 {ini} 0\n"
                                  "notify 8000000 1000  0\n",
                                  "{ini}", "{hot}{/}A{/}Desktop.ini");
    const auto told = [&](const Text& name, const Text& shell, const Text& calls, const Text& ini)
    {
        Scenario scenario(name);
        scenario.shellVersion = shell;
        scenario.shellCalls = "load shell32.dll\nfind DllGetVersion\nfree\n" + calls;
        return scenario.Before({{Icon, "{icon:hf_folder_disabled.ico}"}, {Ini, ""}})
            .After({{Ini + "#", "RS"}, {"hot/A#", ini.empty() ? Removed : "S"}, {Ini, ini}})
            .Log({{"A", NoCfg, Disabled}})
            .NotOnWindows("the system's own shell is called");
    };
    return {
        told("ANewDesktopIniIsAnnounced", "6.0", notices,
             IniHeader + IconFile(Disabled) + "IconIndex=00\r\n" + InfoTip)
            .Before({{Ini, Removed}}),
        // Only the lower half of the version counts.
        told("AnExistingDesktopIniIsForced", "65540.72", force + notices,
             IniHeader + InfoTip + IconFile(Disabled)),
        told("AnOldShellIsNotTold", "4.71", "", ""),
        told("AnUnknownShellIsNotTold", "unknown", "", ""),
    };
}

} // namespace
