#include "appearance/desktop_ini.h"

#include "platform/system.h"

#include <wx/dir.h>

#include <array>

namespace
{

const wchar_t* const Section = L".ShellClassInfo";
const wchar_t* const IconFileKey = L"IconFile";
const wchar_t* const IconIndexKey = L"IconIndex";
const wchar_t* const InfoTipKey = L"InfoTip";
const wchar_t* const IconIndexValue = L"00";
const wchar_t* const HotFolderInfoTip = L"This folder has been configured as an ORX hot folder.";
const wchar_t* const IconDir = L".\\[_ORX_HotFolder_]\\";
const wchar_t* const DefaultIconFile = L"00";

constexpr DWORD ReadOnlyAndSystem = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_SYSTEM;
constexpr DWORD IconFileCapacity = 200; // characters, the terminating NUL included

// Both bits go, also when only one is there: with the other bit set in its place the writes that
// follow would fail, and the icon that the user chose would be overwritten with a default.
void MakeWritable(const wxString& path)
{
    const DWORD attributes = GetFileAttributesW(path.wc_str());
    if (attributes != INVALID_FILE_ATTRIBUTES)
        SetFileAttributesW(path.wc_str(), attributes & ~ReadOnlyAndSystem);
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

wxString DesktopIniPath(const wxString& hotFolder)
{
    return hotFolder + L"\\Desktop.ini";
}

bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path)
{
    return WritePrivateProfileStringW(section.wc_str(), key.wc_str(), value.wc_str(),
                                      path.wc_str()) != 0;
}

bool CreateDesktopIni(const wxString& hotFolder, const wxString& iconName)
{
    if (!wxDir::Exists(hotFolder))
        return false;
    const wxString path = DesktopIniPath(hotFolder);
    WriteIniString(Section, IconFileKey, IconDir + iconName, path);
    WriteIniString(Section, IconIndexKey, IconIndexValue, path);
    WriteIniString(Section, InfoTipKey, HotFolderInfoTip, path);
    return true;
}

bool RefreshDesktopIni(const wxString& hotFolder, const wxString& iconName)
{
    if (!wxDir::Exists(hotFolder))
        return false;
    const wxString path = DesktopIniPath(hotFolder);
    MakeWritable(path);
    WriteIniString(Section, InfoTipKey, HotFolderInfoTip, path);
    WriteIniString(Section, IconFileKey, IconDir + iconName, path);

    std::array<wchar_t, IconFileCapacity> iconFile{};
    GetPrivateProfileStringW(Section, IconFileKey, DefaultIconFile, iconFile.data(),
                             IconFileCapacity, path.wc_str());
    SetFileAttributesW(path.wc_str(), FILE_ATTRIBUTE_NORMAL);
    ForceFolderIcon(hotFolder, iconFile.data());
    return true;
}
