#include "appearance/folder_icon.h"

#include "run/run_log.h"
#include "appearance/desktop_ini.h"
#include "appearance/folder_icon_state.h"
#include "platform/system.h"
#include "store/folder_cfg_reader.h"

#include <wx/file.h>
#include <wx/filename.h>
#include <wx/stdpaths.h>

#include <cstdint>

namespace
{

constexpr DWORD ReadOnlyAndSystem = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_SYSTEM;

// The first shell that takes a folder's settings from Desktop.ini: version 4.72.
constexpr std::uint32_t CustomFolderVersion = 0x00040048;

// What the library calls wxPATH_NORM_ALL: everything but the letter case.
constexpr int NormalizeAll = wxPATH_NORM_ENV_VARS | wxPATH_NORM_DOTS | wxPATH_NORM_TILDE |
                             wxPATH_NORM_ABSOLUTE | wxPATH_NORM_LONG | wxPATH_NORM_SHORTCUT;

wxString SourceIcon(const FolderUpgradeApp& app, const wxString& iconName)
{
    const wxString separator = wxFileName::GetPathSeparator();
    static const wxString executable = wxStandardPaths::Get().GetExecutablePath();
    wxString path = executable + L"/../";
    if (!app.m_isUpgrade)
        path += separator + app.m_bundleIconsDir + separator;
    wxFileName source(path + iconName);
    source.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return source.GetFullPath();
}

// The shell's version, major in the upper 16 bits and minor in the lower; 0 when it is not to be
// learnt.
std::uint32_t GetPackedShellVersion()
{
    const HMODULE shell = LoadLibraryW(L"shell32.dll");
    if (!shell)
        return 0;
    std::uint32_t packed = 0;
    const FARPROC entry = GetProcAddress(shell, "DllGetVersion");
    if (entry)
    {
        DLLVERSIONINFO version = {};
        version.cbSize = sizeof version;
        // By way of void*, since the two types of function have nothing in common.
        const auto getVersion = reinterpret_cast<DLLGETVERSIONPROC>(reinterpret_cast<void*>(entry));
        if (SUCCEEDED(getVersion(&version)))
            packed = (version.dwMajorVersion & 0xFFFF) << 16 | (version.dwMinorVersion & 0xFFFF);
    }
    FreeLibrary(shell);
    return packed;
}

void MakeSystemFolder(const wxString& hotFolder)
{
    const DWORD attributes = GetFileAttributesW(hotFolder.wc_str());
    if (attributes != 0 && (attributes & ReadOnlyAndSystem) != ReadOnlyAndSystem)
        SetFileAttributesW(hotFolder.wc_str(), attributes | ReadOnlyAndSystem);
}

void TellShell(const wxString& iniPath)
{
    SHChangeNotify(SHCNE_ATTRIBUTES, SHCNF_PATHW | SHCNF_FLUSH, iniPath.wc_str(), nullptr);
    // Cleared, so that a failed call leaves the index of an icon and not chance.
    SHFILEINFOW info = {};
    SHGetFileInfoW(iniPath.wc_str(), 0, &info, sizeof info, SHGFI_SYSICONINDEX);
    const auto* const image = reinterpret_cast<const void*>(static_cast<std::intptr_t>(info.iIcon));
    SHChangeNotify(SHCNE_UPDATEIMAGE, SHCNF_DWORD | SHCNF_FLUSH, image, nullptr);
    SHChangeNotify(SHCNE_MKDIR, SHCNF_PATHW | SHCNF_FLUSH, iniPath.wc_str(), nullptr);
    SHChangeNotify(SHCNE_ASSOCCHANGED, SHCNF_IDLIST | SHCNF_FLUSH, nullptr, nullptr);
}

void MakeFolderWritable(const wxString& hotFolder)
{
    if (hotFolder.empty())
        return;
    const DWORD attributes = GetFileAttributesW(hotFolder.wc_str());
    if (attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_READONLY) != 0)
        SetFileAttributesW(hotFolder.wc_str(), attributes & ~FILE_ATTRIBUTE_READONLY);
}

bool ProtectDesktopIni(const wxString& iniPath)
{
    const DWORD attributes = GetFileAttributesW(iniPath.wc_str());
    return attributes != INVALID_FILE_ATTRIBUTES &&
           SetFileAttributesW(iniPath.wc_str(), attributes | ReadOnlyAndSystem) != 0;
}

} // namespace

bool ApplyFolderIcon(const wxString& hotFolder, const wxString& iconName)
{
    wxFileName ini;
    ini.AssignDir(hotFolder);
    ini.SetFullName(L"Desktop.ini");
    const wxString iniPath = ini.GetFullPath();
    if (GetPackedShellVersion() >= CustomFolderVersion)
    {
        if (wxFile::Exists(iniPath))
            RefreshDesktopIni(hotFolder, iconName);
        else
            CreateDesktopIni(hotFolder, iconName);
        MakeSystemFolder(hotFolder);
        TellShell(iniPath);
        MakeFolderWritable(hotFolder);
    }
    return ProtectDesktopIni(iniPath);
}

void UpdateFolderIcon(const FolderUpgradeApp& app, const wxString& hotFolder)
{
    wxString iconName;
    if (!GetFolderIconName(hotFolder, iconName))
    {
        RunLog(L"Unable to get Icon filename " + iconName, NoCount);
        return;
    }
    const wxString source = SourceIcon(app, iconName);
    const wxString destination = PrivateDirPath(hotFolder) + iconName;
    if (!wxFileExists(source) || !wxFileExists(destination))
    {
        RunLog(L"Icon path  not exist: " + source, NoCount);
        return;
    }
    wxCopyFile(source, destination, true);
    ApplyFolderIcon(hotFolder, iconName);
    RunLog(L"Icon  copied from : " + source + L" To " + destination + L" ", NoCount);
}
