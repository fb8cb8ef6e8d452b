// The icon of a hot folder: which one, Desktop.ini, and the attributes.
#include "tests/scenarios/texts.h"

namespace
{

const Text Ini = "hot/A/Desktop.ini";
const Text Header = "[.ShellClassInfo]\r\n";
const char* const WineLosesSystem = "Wine loses SYSTEM on a read-only file of a user who is not root";
const Text InfoTip = "InfoTip=This folder has been configured as an ORX hot folder.\r\n";

Text Icon(const Text& name) { return "hot/A/[P]/" + name + ".ico"; }

Text IconFile(const Text& name) { return "IconFile=.\\[_ORX_HotFolder_]\\" + name + ".ico\r\n"; }

Text Cfg(const Text& enabled) { return "<H name='' description='' server_ip='' server_name='' Enable='" + enabled + "'/>"; }

std::vector<Scenario> Icons()
{
    const auto shows = [](const Name& name, const Text& icon, const Text& letter, const Text& enabled, bool isInError)
    {
        return Scenario(name)
            .Before({{Icon(icon), "old"},
                     {Icon("other"), "stays"},
                     {"hot/A/Error.er", ""},
                     {Text("hot/A/[P]/Error.er") + (isInError ? "" : "/"), ""},
                     {"tool/BundleIcons/" + icon + ".ico", "bundled"}})
            .FolderCfg(Cfg(enabled))
            .Run({letter})
            .After({{"hot/A#", "S"},
                    {Ini + "#", "RS"},
                    {Icon(icon), letter == "I" ? "{icon:" + icon + ".ico}" : "bundled"},
                    {Ini, Header + IconFile(icon) + "IconIndex=00\r\n" + InfoTip}})
            .Log(FolderLines("A", 1, Copied(icon), ""));
    };
    return {
        shows("AnUpgradeShowsActive", "hf_folder", "I", "1", false),
        shows("ADowngradeShowsActive", "hf_folder", "U", "1", false),
        shows("AnUpgradeShowsDisabled", "hf_folder_disabled", "I", "01", false),
        shows("ADowngradeShowsDisabled", "hf_folder_disabled", "U", "01", false),
        shows("AnUpgradeShowsErrorActive", "hf_error_active", "I", "1", true),
        shows("ADowngradeShowsErrorActive", "hf_error_active", "U", "1", true),
        shows("AnUpgradeShowsErrorInactive", "hf_error_inactive", "I", "", true),
        shows("ADowngradeShowsErrorInactive", "hf_error_inactive", "U", "", true),
        Scenario("WithoutItsIconAFolderStays")
            .Before({{Icon("hf_folder_disabled"), "old"}, {"tool/BundleIcons/hf_folder_disabled.ico", "-"}, {Ini, "; mine\n"}})
            .FolderCfg(Cfg("1"))
            .LogOfA(""),
    };
}

// A folder that already has a user's Desktop.ini.
std::vector<Scenario> DesktopInis()
{
    const Text disabled = IconFile("hf_folder_disabled");
    const Text users = "; mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=x.ico\nIconIndex=3\n"
                       "IconResource=y,1\n\n[.ShellClassInfo]\nInfoTip=second\n";
    const Text usersAfter = "; mine\n[ViewState]\nMode=\n[.shellclassinfo]\n\n;IconFile=no\nICONFILE=" + disabled.substr(9) +
                            "IconIndex=3\nIconResource=y,1\n" + InfoTip + "\n[.ShellClassInfo]\nInfoTip=second\n";
    const auto refresh = [](const Name& name, const Text& before, const Text& attributes, const Text& after,
                            const Text& folderAttributes = "", const Text& folderAttributesAfter = "S")
    {
        return Scenario(name)
            .Before({{Icon("hf_folder_disabled"), "old"}, {Ini, before}, {Ini + "#", attributes}, {"hot/A#", folderAttributes}})
            .After({{"hot/A#", folderAttributesAfter},
                    {Ini + "#", "RS"},
                    {Ini, after},
                    {Icon("hf_folder_disabled"), "{icon:hf_folder_disabled.ico}"}})
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()));
    };
    return {
        refresh("OurDesktopIniIsRefreshed", Header + IconFile("hf_folder") + "IconIndex=00\r\nInfoTip=old\r\n", "RS",
                Header + disabled + "IconIndex=00\r\n" + InfoTip, "R"),
        refresh("AUsersDesktopIniKeepsEverythingElse", users, "", usersAfter, "RS"),
        refresh("HiddenStaysOnTheFolderAlone", users, "HRS", usersAfter, "HR", "HS"),
        refresh("AReadOnlyDesktopIniIsWritten", users, "R", usersAfter),
        refresh("ASystemDesktopIniIsWritten", users, "S", usersAfter),
        refresh("AMissingSectionIsAddedAfterTheLastLine", "[x]\r\na=b", "", "[x]\r\na=b\r\n" + Header + InfoTip + disabled),
        refresh("AUtf16DesktopIniStaysUtf16", "{utf16}" + Header + "IconFile=ü.ico\r\nInfoTip=old\r\n", "RS",
                "{utf16}" + Header + disabled + InfoTip),
        refresh("AnEmptyDesktopIniIsFilled", "", "RS", Header + InfoTip + disabled),
        refresh("AReadOnlyDesktopIniOfTheUsersIsWritten", "", "RS", Header + InfoTip + disabled)
            .AsOtherUser()
            .NotUnderWine(WineLosesSystem),
        refresh("ADesktopIniOfAnotherUserStays", "[x]\r\n", "X", "[x]\r\n")
            .After({{Ini + "#", ""}})
            .AsOtherUser()
            .NotUnderWine(WineLosesSystem),
        refresh("AReadOnlyIconIsReplaced", Header + InfoTip + disabled, "", Header + InfoTip + disabled)
            .Before({{Icon("hf_folder_disabled") + "#", "R"}})
            .After({{Icon("hf_folder_disabled") + "#", ""}})
            .AsOtherUser()
            .NotUnderWine("Wine refuses another user than root to replace it, as Windows does"),
        Scenario("AFolderOfAnotherUserStays")
            .Before({{Icon("hf_folder_disabled"), "old"}, {Icon("hf_folder_disabled") + "#", "X"}, {"hot/A#", "X"}, {"hot/A/[P]#", "X"}})
            .AsOtherUser()
            .Log(FolderLines("A", 1, Copied("hf_folder_disabled"), NoCfg()))
            .LibraryReports(),
    };
}

TEST_SCENARIOS(Icons);
TEST_SCENARIOS(DesktopInis);

} // namespace
