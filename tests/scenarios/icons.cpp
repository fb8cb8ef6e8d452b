// The icon of a hot folder: which one, Desktop.ini, and the attributes.
#include "tests/scenarios/texts.h"

namespace
{

const Text Ini = "hot/A/Desktop.ini";
const Text Header = "[.ShellClassInfo]\r\n";
const char* const WineLosesSystem =
    "Wine loses SYSTEM on a read-only file of a user who is not root";
const Text InfoTip = "InfoTip=This folder has been configured as an ORX hot folder.\r\n";

Text Icon(const Text& name)
{
    return "hot/A/[P]/" + name + ".ico";
}

Text IconFile(const Text& name)
{
    return "IconFile=.\\[_ORX_HotFolder_]\\" + name + ".ico\r\n";
}

Text Cfg(const Text& enabled)
{
    return "<H name='' description='' server_ip='' server_name='' Enable='" + enabled + "'/>";
}

std::vector<Scenario> Icons()
{
    // The new icon is in the tool's folder, the previous version's in BundleIcons.
    const auto shows = [](const Text& name, const Text& icon, const Text& copied)
    {
        return Scenario(name)
            .Before({{Icon(icon), "old"},
                     {Icon("other"), "stays"},
                     {"hot/A/Error.er", ""},
                     {"tool/BundleIcons/" + icon + ".ico", "bundled"}})
            .After({{"hot/A#", "S"},
                    {Ini + "#", "RS"},
                    {Icon(icon), copied},
                    {Ini, Header + IconFile(icon) + "IconIndex=00\r\n" + InfoTip}})
            .Log(FolderLines("A", 1, Copied(icon), ""));
    };
    const auto upgradeShows = [&](const Text& name, const Text& icon)
    {
        return shows(name, icon, "{icon:" + icon + ".ico}")
            .Before({{"tool/" + icon + ".ico#", "R"}})
            .After({{Icon(icon) + "#", "R"}});
    };
    const auto downgradeShows = [&](const Text& name, const Text& icon)
    {
        return shows(name, icon, "bundled").Run({"U"});
    };
    const Files error = {{"hot/A/[P]/Error.er", ""}};
    const Files noError = {{"hot/A/[P]/Error.er/", ""}}; // a directory of that name
    return {
        upgradeShows("AnUpgradeShowsActive", "hf_folder").FolderCfg(Cfg("1")).Before(noError),
        downgradeShows("ADowngradeShowsActive", "hf_folder").FolderCfg(Cfg("1")).Before(noError),
        upgradeShows("AnUpgradeShowsDisabled", "hf_folder_disabled")
            .FolderCfg(Cfg("01"))
            .Before(noError),
        downgradeShows("ADowngradeShowsDisabled", "hf_folder_disabled")
            .FolderCfg(Cfg("01"))
            .Before(noError),
        upgradeShows("AnUpgradeShowsErrorActive", "hf_error_active")
            .FolderCfg(Cfg("1"))
            .Before(error),
        downgradeShows("ADowngradeShowsErrorActive", "hf_error_active")
            .FolderCfg(Cfg("1"))
            .Before(error),
        upgradeShows("AnUpgradeShowsErrorInactive", "hf_error_inactive")
            .FolderCfg(Cfg(""))
            .Before(error),
        downgradeShows("ADowngradeShowsErrorInactive", "hf_error_inactive")
            .FolderCfg(Cfg(""))
            .Before(error),
        Scenario("WithoutItsIconAFolderStays")
            .Before({{Icon("hf_folder_disabled"), "old"},
                     {"tool/BundleIcons/hf_folder_disabled.ico", "-"},
                     {Ini, "; mine\n"}})
            .FolderCfg(Cfg("1"))
            .LogOfA(""),
    };
}

// A folder that already has a user's Desktop.ini.
std::vector<Scenario> DesktopInis()
{
    const Text disabled = IconFile("hf_folder_disabled");
    const Text users =
        "; "
        "mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=x.ico\nIconIndex=3\n"
        "IconResource=y,1\n\n[.ShellClassInfo]\nInfoTip=second\n";
    const Text usersAfter =
        "; mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=" +
        disabled.substr(9) + "IconIndex=3\nIconResource=y,1\n" + InfoTip +
        "\n[.ShellClassInfo]\nInfoTip=second\n";
    const auto refresh = [](const Text& name, const Text& before, const Text& after)
    {
        return Scenario(name)
            .Before({{Icon("hf_folder_disabled"), "old"}, {Ini, before}})
            .After({{"hot/A#", "S"},
                    {Ini + "#", "RS"},
                    {Ini, after},
                    {Icon("hf_folder_disabled"), "{icon:hf_folder_disabled.ico}"}})
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()));
    };
    const auto has = [](const Text& letters)
    {
        return Files{{Ini + "#", letters}};
    };
    const auto folderHas = [](const Text& letters)
    {
        return Files{{"hot/A#", letters}};
    };
    return {
        refresh("OurDesktopIniIsRefreshed",
                Header + IconFile("hf_folder") + "IconIndex=00\r\nInfoTip=old\r\n",
                Header + disabled + "IconIndex=00\r\n" + InfoTip)
            .Before(has("RS"))
            .Before(folderHas("R")),
        refresh("AUsersDesktopIniKeepsEverythingElse", users, usersAfter).Before(folderHas("RS")),
        refresh("HiddenStaysOnTheFolderAlone", users, usersAfter)
            .Before(has("HRS"))
            .Before(folderHas("HR"))
            .After(folderHas("HS")),
        refresh("AReadOnlyDesktopIniIsWritten", users, usersAfter).Before(has("R")),
        refresh("ASystemDesktopIniIsWritten", users, usersAfter).Before(has("S")),
        refresh("AMissingSectionIsAddedAfterTheLastLine", "[x]\r\na=b",
                "[x]\r\na=b\r\n" + Header + InfoTip + disabled),
        refresh("AUtf16DesktopIniStaysUtf16",
                "{utf16}" + Header + "IconFile=ü.ico\r\nInfoTip=old\r\n",
                "{utf16}" + Header + disabled + InfoTip)
            .Before(has("RS")),
        refresh("AnEmptyDesktopIniIsFilled", "", Header + InfoTip + disabled).Before(has("RS")),
        refresh("AReadOnlyDesktopIniOfTheUsersIsWritten", "", Header + InfoTip + disabled)
            .Before(has("RS"))
            .AsOtherUser()
            .NotUnderWine(WineLosesSystem),
        refresh("ADesktopIniOfAnotherUserStays", "[x]\r\n", "[x]\r\n")
            .Before(has("X"))
            .After(has(Removed))
            .AsOtherUser()
            .NotUnderWine(WineLosesSystem),
        refresh("AReadOnlyIconIsReplaced", Header + InfoTip + disabled, Header + InfoTip + disabled)
            .Before({{Icon("hf_folder_disabled") + "#", "R"}})
            .After({{Icon("hf_folder_disabled") + "#", Removed}})
            .AsOtherUser()
            .NotUnderWine("Wine, like Windows, lets no user but root replace it"),
        Scenario("AFolderOfAnotherUserStays")
            .Before({{Icon("hf_folder_disabled"), "old"},
                     {Icon("hf_folder_disabled") + "#", "X"},
                     {"hot/A#", "X"},
                     {"hot/A/[P]#", "X"}})
            .AsOtherUser()
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()))
            .LibraryReports(),
    };
}

// What the shell is asked for and told.
std::vector<Scenario> ShellCalls()
{
    const Text version = "load shell32.dll\nfind DllGetVersion\nfree\n";
    const auto notices = [](const Text& folder) -> Text
    {
        const Text ini = "{hot}{/}" + folder + "{/}Desktop.ini";
        return "notify 800 1005 " + ini + " 0\ninfo " + ini +
               " 0 1 4000\nnotify 8000 1003  -7\nnotify 8 1005 " + ini +
               " 0\nnotify 8000000 1000  0\n";
    };
    const auto told = [&](const Text& name, const Text& shell, const Text& calls)
    {
        return Scenario(name)
            .Before({{Icon("hf_folder_disabled"), "{icon:hf_folder_disabled.ico}"}})
            .After({{Ini + "#", "RS"}})
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()))
            .Shell(shell, calls);
    };
    const Text force = "force {hot}{/}A 10 .\\[_ORX_HotFolder_]\\hf_folder_disabled.ico 0 0 2\n";
    const Text ini = Header + InfoTip + IconFile("hf_folder_disabled");
    const Files system = {{"hot/A#", "S"}};
    return {
        told("ANewDesktopIniIsAnnounced", "6.0", version + notices("A"))
            .After(system)
            .After({{Ini, Header + IconFile("hf_folder_disabled") + "IconIndex=00\r\n" + InfoTip}}),
        told("AnExistingDesktopIniIsForced", "4.72", version + force + notices("A"))
            .Before({{Ini, ""}})
            .After(system)
            .After({{Ini, ini}}),
        told("OnlyTheLowerHalfOfAVersionCounts", "65540.72", version + force + notices("A"))
            .Before({{Ini, ""}})
            .After(system)
            .After({{Ini, ini}}),
        told("AnOldShellIsNotTold", "4.71", version).Before({{Ini, ""}}),
        told("AnUnknownShellIsNotTold", "unknown", version).Before({{Ini, ""}}),
    };
}

TEST_SCENARIOS(ShellCalls);
TEST_SCENARIOS(Icons);
TEST_SCENARIOS(DesktopInis);

} // namespace
