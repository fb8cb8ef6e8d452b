#include "appearance/folder_icon.h"

#include "appearance/icon_copy.h"
#include "platform/file_copy.h"
#include "platform/library_log.h"
#include "run/attempt.h"

#include <wx/filename.h>
#include <wx/intl.h>

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

} // namespace

bool ApplyFolderIcon(const HotFolder& folder, const wxString& iconName)
{
    const wxString iniPath = IniPath(folder.path);
    const wxString reachedIni = folder.directory.Reach(DesktopIniName);
    const wxString reachedFolder = folder.directory.Reach({});
    const DesktopIniChange change = DecideDesktopIni(folder, iconName);
    if (change.kind == DesktopIniChange::Kind::Stays)
        RunLog(
            wxString::Format(L"Desktop.ini left as it is (%s): %s", change.reasonToStay, iniPath));
    else if (change.kind == DesktopIniChange::Kind::Create)
        CreateDesktopIni(folder, change.keys);
    else if (change.kind == DesktopIniChange::Kind::Refresh)
        RefreshDesktopIni(folder, change.keys);
    if (change.isCustomised)
    {
        ChangeAttributes(reachedFolder, ReadOnlyAndSystem, 0);
        TellShell(iniPath);
        ChangeAttributes(reachedFolder, 0, FILE_ATTRIBUTE_READONLY);
    }
    return change.kind != DesktopIniChange::Kind::Stays &&
           ChangeAttributes(reachedIni, ReadOnlyAndSystem, 0);
}

void UpdateFolderIcon(const FolderUpgradeApp& app, HotFolder& folder)
{
    const IconCopy copy = DecideIconCopy(folder, app.m_isUpgrade, app.m_bundleIconsDir);
    if (folder.cfg.state == XmlFile::State::NotReadable)
        ReportError(folder.cfg.WhyNotReadable(FolderCfgPath(folder.path)));
    if (copy.name.empty())
    {
        RunLog(L"Unable to get Icon filename " + copy.name);
        return;
    }
    if (copy.outcome != IconCopy::Outcome::Replaces)
    {
        RunLog(L"Icon path  not exist: " + copy.source);
        return;
    }
    const wxString destination = PrivateDirPath(folder.path) + copy.name;
    if (const auto failure = CopyOver(copy.source, folder.privateDir, copy.name))
        ReportError(
            wxString::Format(_("Failed to copy the file '%s' to '%s'"), copy.source, destination) +
            failure->Reason());
    Attempt(DesktopIniName, folder.path, [&]() { ApplyFolderIcon(folder, copy.name); });
    RunLog(L"Icon  copied from : " + copy.source + L" To " + destination + L" ");
}
