#include "appearance/desktop_ini.h"

#include "appearance/attribute_change.h"
#include "platform/regular_file.h"
#include "platform/system.h"
#include "store/hot_folder.h"

#include <array>

namespace
{

const wchar_t* const IconFileKey = L"IconFile";
const wchar_t* const IconIndexKey = L"IconIndex";
const wchar_t* const InfoTipKey = L"InfoTip";
const wchar_t* const IconIndexValue = L"00";
const wchar_t* const HotFolderInfoTip = L"This folder has been configured as an ORX hot folder.";
const wchar_t* const DefaultIconFile = L"00";

constexpr DWORD IconFileCapacity = 200; // characters, including the terminating NUL

void WriteKeys(const wxString& path, const std::vector<DesktopIniKey>& keys)
{
    for (const DesktopIniKey& each : keys)
        WriteIniString(DesktopIniSection, each.key, each.value, path);
}

void ForceFolderIcon(const wxString& hotFolder, wchar_t* iconFile)
{
    // The shell's own buffers end here.
    if (hotFolder.length() >= MAX_PATH)
        return;
    SHFOLDERCUSTOMSETTINGS settings = {};
    settings.dwSize = sizeof settings;
    settings.dwMask = FCSM_ICONFILE;
    settings.pszIconFile = iconFile;
    SHGetSetFolderCustomSettings(&settings, hotFolder.wc_str(), FCS_FORCEWRITE);
}

} // namespace

std::vector<DesktopIniKey> DesktopIniKeys(bool isThere, const wxString& iconName)
{
    const wxString iconFile = wxString(L".\\") + PrivateDirName + L"\\" + iconName;
    if (isThere)
        return {{InfoTipKey, HotFolderInfoTip}, {IconFileKey, iconFile}};
    return {
        {IconFileKey, iconFile}, {IconIndexKey, IconIndexValue}, {InfoTipKey, HotFolderInfoTip}};
}

bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path)
{
    return WritePrivateProfileStringW(section.wc_str(), key.wc_str(), value.wc_str(),
                                      path.wc_str()) != 0;
}

bool CreateDesktopIni(const PinnedDirectory& directory, const wxString& iconName)
{
    if (!directory.IsOpen())
        return false;
    // The profile functions would also create the file through a link. While it is open for
    // reading, no link can replace it.
    const wxString path = directory.Reach(DesktopIniName);
    RegularFile ini;
    if (ini.CreateNew(path) == RegularFile::Status::Open &&
        ini.OpenForReading(path, Links::Refuse) == RegularFile::Status::Open)
        WriteKeys(path, DesktopIniKeys(false, iconName));
    return true;
}

bool RefreshDesktopIni(const PinnedDirectory& directory, const wxString& hotFolder,
                       const wxString& iconName)
{
    if (!directory.IsOpen())
        return false;
    const wxString path = directory.Reach(DesktopIniName);
    RegularFile ini; // as above; the profile functions cannot write what cannot be read
    if (ini.OpenForReading(path, Links::Refuse) != RegularFile::Status::Open)
        return true;
    // Both bits are removed even if only one is set. If read-only stayed, the writes would fail,
    // and the shell would be given an old icon or the default.
    ChangeAttributes(path, 0, ReadOnlyAndSystem);
    WriteKeys(path, DesktopIniKeys(true, iconName));

    std::array<wchar_t, IconFileCapacity> iconFile{};
    GetPrivateProfileStringW(DesktopIniSection, IconFileKey, DefaultIconFile, iconFile.data(),
                             IconFileCapacity, path.wc_str());
    ChangeAttributes(path, FILE_ATTRIBUTE_NORMAL, ~DWORD{FILE_ATTRIBUTE_NORMAL});
    ForceFolderIcon(hotFolder, iconFile.data());
    return true;
}
