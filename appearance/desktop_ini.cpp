#include "appearance/desktop_ini.h"

#include <wx/filename.h>

#include <array>

namespace
{

const wchar_t* const Section = L".ShellClassInfo";
const wchar_t* const IconFileKey = L"IconFile";
const wchar_t* const IconIndexKey = L"IconIndex";
const wchar_t* const InfoTipKey = L"InfoTip";
const wchar_t* const IconIndexValue = L"00";
const wchar_t* const HotFolderInfoTip = L"This folder has been configured as an ORX hot folder.";
const wchar_t* const DefaultIconFile = L"00";

// Bytes. Every change of a key reads and writes the whole file; Explorer's own has some hundred.
constexpr std::int64_t LongestIni = std::int64_t{4} * 1024 * 1024;

using Kind = DesktopIniChange::Kind;

// Whether the shell takes a folder's settings from Desktop.ini, as it does from version 4.72 on.
bool IsReadByShell()
{
    const HMODULE shell = LoadLibraryW(L"shell32.dll");
    if (!shell)
        return false;
    DLLVERSIONINFO version = {};
    version.cbSize = sizeof version;
    // By way of void*, since the two function types are unrelated.
    const auto getVersion = reinterpret_cast<DLLGETVERSIONPROC>(
        reinterpret_cast<void*>(GetProcAddress(shell, "DllGetVersion")));
    const bool isKnown = getVersion && SUCCEEDED(getVersion(&version));
    FreeLibrary(shell);
    const DWORD packed =
        (version.dwMajorVersion & 0xFFFF) << 16 | (version.dwMinorVersion & 0xFFFF);
    return isKnown && packed >= 0x00040048;
}

void DecideKind(const HotFolder& folder, DesktopIniChange& change)
{
    const wxString path = folder.directory.Reach(DesktopIniName);
    RegularFile ini;
    if (IsLink(path))
        change.reasonToStay = L"reached over a link";
    else if (!change.isCustomised)
        change.kind = Kind::Nothing;
    else if (!wxFileName::Exists(path))
        change.kind = Kind::Create;
    else if (!wxFileExists(path))
        change.kind = Kind::NotAFile;
    else if (ini.OpenForReading(folder.directory, DesktopIniName) != RegularFile::Status::Open)
        change.kind = Kind::NotReadable;
    else if (ini.Length() > LongestIni)
        change.reasonToStay = L"too large";
    else
        change.kind = Kind::Refresh;
    if (change.reasonToStay)
        change.kind = Kind::Stays;
    change.failure = ini.GetFailure();
}

std::vector<DesktopIniKey> Keys(Kind kind, const wxString& iconName)
{
    const wxString iconFile = wxString(L".\\") + PrivateDirName + L"\\" + iconName;
    if (kind == Kind::Create)
        return {{IconFileKey, iconFile},
                {IconIndexKey, IconIndexValue},
                {InfoTipKey, HotFolderInfoTip}};
    if (kind == Kind::Refresh)
        return {{InfoTipKey, HotFolderInfoTip}, {IconFileKey, iconFile}};
    return {};
}

wxString ReadKey(const wxString& path, const wchar_t* key)
{
    constexpr DWORD Capacity = 200; // characters, including the terminating NUL
    std::array<wchar_t, Capacity> value{};
    GetPrivateProfileStringW(Section, key, DefaultIconFile, value.data(), Capacity, path.wc_str());
    return value.data();
}

void WriteKeys(const wxString& path, const std::vector<DesktopIniKey>& keys)
{
    for (const DesktopIniKey& each : keys)
        WriteIniString(Section, each.key, each.value, path);
}

void ForceFolderIcon(const HotFolder& folder, const wxString& iconFile)
{
    // The shell's own buffers end at that length. A link in the path may lead elsewhere by now.
    if (folder.path.length() >= MAX_PATH ||
        PinnedDirectory(folder.path, Links::Follow).Identity() != folder.directory.Identity())
        return;
    std::wstring text = iconFile.ToStdWstring();
    SHFOLDERCUSTOMSETTINGS settings = {};
    settings.dwSize = sizeof settings;
    settings.dwMask = FCSM_ICONFILE;
    settings.pszIconFile = text.data();
    SHGetSetFolderCustomSettings(&settings, folder.path.wc_str(), FCS_FORCEWRITE);
}

} // namespace

DesktopIniChange DecideDesktopIni(const HotFolder& folder, const wxString& iconName)
{
    const wxString path = folder.directory.Reach(DesktopIniName);
    DesktopIniChange change;
    change.isCustomised = IsReadByShell();
    DecideKind(folder, change);
    if (change.isCustomised)
        change.folder = DecideAttributes(folder.directory.Reach({}), FILE_ATTRIBUTE_SYSTEM,
                                         FILE_ATTRIBUTE_READONLY);
    // A refresh first removes all attributes.
    const DWORD removed = change.kind == Kind::Refresh ? ~ReadOnlyAndSystem : 0;
    if (change.kind == Kind::Create)
        change.ini.after = ReadOnlyAndSystem;
    else if (change.kind != Kind::Stays)
        change.ini = DecideAttributes(path, ReadOnlyAndSystem, removed);
    for (const DesktopIniKey& key : Keys(change.kind, iconName))
    {
        if (change.kind == Kind::Create || ReadKey(path, key.key) != key.value)
            change.keys.push_back(key);
    }
    return change;
}

bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path)
{
    return WritePrivateProfileStringW(section.wc_str(), key.wc_str(), value.wc_str(),
                                      path.wc_str()) != 0;
}

bool CreateDesktopIni(const HotFolder& folder, const std::vector<DesktopIniKey>& keys)
{
    if (!folder.directory.IsOpen())
        return false;
    // The profile functions would also create the file through a link. While it is open for
    // reading, no link can replace it.
    RegularFile ini;
    if (ini.CreateNew(folder.directory, DesktopIniName) == RegularFile::Status::Open &&
        ini.OpenForReading(folder.directory, DesktopIniName) == RegularFile::Status::Open)
        WriteKeys(folder.directory.Reach(DesktopIniName), keys);
    return true;
}

bool RefreshDesktopIni(const HotFolder& folder, const std::vector<DesktopIniKey>& keys)
{
    if (!folder.directory.IsOpen())
        return false;
    const wxString path = folder.directory.Reach(DesktopIniName);
    RegularFile ini; // as above; the profile functions cannot write what cannot be read
    if (ini.OpenForReading(folder.directory, DesktopIniName) != RegularFile::Status::Open)
        return true;
    // Both bits are removed even if only one is set. If read-only stayed, the writes would fail,
    // and the shell would be given an old icon or the default.
    ChangeAttributes(path, 0, ReadOnlyAndSystem);
    WriteKeys(path, keys);
    const wxString iconFile = ReadKey(path, IconFileKey);
    ChangeAttributes(path, FILE_ATTRIBUTE_NORMAL, ~DWORD{FILE_ATTRIBUTE_NORMAL});
    ForceFolderIcon(folder, iconFile);
    return true;
}
