#include "appearance/folder_icon.h"

#include "appearance/attribute_change.h"
#include "appearance/desktop_ini.h"
#include "appearance/folder_icon_state.h"
#include "appearance/icon_source.h"
#include "appearance/shell_version.h"
#include "platform/file_copy.h"
#include "platform/system.h"
#include "run/run_log.h"
#include "store/hot_folder.h"

#include <wx/filename.h>
#include <wx/intl.h>
#include <wx/log.h>

#include <cstdint>

namespace
{

// The path to show to people and to give to the shell.
wxString IniPath(const wxString& hotFolder)
{
    wxFileName ini;
    ini.AssignDir(hotFolder);
    ini.SetFullName(DesktopIniName);
    return ini.GetFullPath();
}

void TellShell(const wxString& iniPath)
{
    SHChangeNotify(SHCNE_ATTRIBUTES, SHCNF_PATHW | SHCNF_FLUSH, iniPath.wc_str(), nullptr);
    // Cleared, so that the index is defined even if the call fails.
    SHFILEINFOW info = {};
    SHGetFileInfoW(iniPath.wc_str(), 0, &info, sizeof info, SHGFI_SYSICONINDEX);
    const auto* const image = reinterpret_cast<const void*>(static_cast<std::intptr_t>(info.iIcon));
    SHChangeNotify(SHCNE_UPDATEIMAGE, SHCNF_DWORD | SHCNF_FLUSH, image, nullptr);
    SHChangeNotify(SHCNE_MKDIR, SHCNF_PATHW | SHCNF_FLUSH, iniPath.wc_str(), nullptr);
    SHChangeNotify(SHCNE_ASSOCCHANGED, SHCNF_IDLIST | SHCNF_FLUSH, nullptr, nullptr);
}

void WriteDesktopIni(const PinnedDirectory& directory, const wxString& hotFolder,
                     const wxString& iconName)
{
    if (wxFileExists(directory.Reach(DesktopIniName)))
        RefreshDesktopIni(directory, hotFolder, iconName);
    else
        CreateDesktopIni(directory, iconName);
}

bool Apply(const PinnedDirectory& directory, const wxString& hotFolder, const wxString& iconName)
{
    const wxString iniPath = IniPath(hotFolder);
    const bool isLinked = IsLink(directory.Reach(DesktopIniName));
    if (isLinked)
        RunLog(L"Desktop.ini left as it is (reached over a link): " + iniPath);
    if (GetPackedShellVersion() >= CustomFolderVersion)
    {
        if (!isLinked)
            WriteDesktopIni(directory, hotFolder, iconName);
        ChangeAttributes(directory.Reach(L""), ReadOnlyAndSystem, 0);
        TellShell(iniPath);
        ChangeAttributes(directory.Reach(L""), 0, FILE_ATTRIBUTE_READONLY);
    }
    return !isLinked && ChangeAttributes(directory.Reach(DesktopIniName), ReadOnlyAndSystem, 0);
}

bool IsFileItself(const wxString& path)
{
    return wxFileExists(path) && !IsLink(path);
}

} // namespace

bool ApplyFolderIcon(const wxString& hotFolder, const wxString& iconName)
{
    return Apply(PinnedDirectory(hotFolder, Links::Follow), hotFolder, iconName);
}

void UpdateFolderIcon(const FolderUpgradeApp& app, const wxString& hotFolder)
{
    const PinnedHotFolder folder(hotFolder);
    wxString iconName;
    if (!GetFolderIconName(folder, hotFolder, iconName))
    {
        RunLog(L"Unable to get Icon filename " + iconName);
        return;
    }
    const wxString source = SourceIconPath(iconName, app.m_isUpgrade, app.m_bundleIconsDir);
    const wxString destination = folder.privateDir.Reach(iconName);
    if (!wxFileExists(source) || !IsFileItself(destination))
    {
        RunLog(L"Icon path  not exist: " + source);
        return;
    }
    const wxString shownDestination = PrivateDirPath(hotFolder) + iconName;
    if (!CopyOver(source, destination))
        wxLogSysError(_("Failed to copy the file '%s' to '%s'"), source, shownDestination);
    Apply(folder.directory, hotFolder, iconName);
    RunLog(L"Icon  copied from : " + source + L" To " + shownDestination + L" ");
}
