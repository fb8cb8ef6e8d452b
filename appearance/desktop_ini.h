// A hot folder's Desktop.ini, in which Explorer looks for the folder's icon and info tip.
#pragma once

#include "platform/pinned_directory.h"

#include <wx/string.h>

#include <vector>

constexpr const wchar_t* DesktopIniName = L"Desktop.ini";
constexpr const wchar_t* DesktopIniSection = L".ShellClassInfo";

struct DesktopIniKey
{
    const wchar_t* key;
    wxString value;
};

/// The keys that are written, in their order: all for a Desktop.ini that is not there yet, else
/// those that show the icon and the info tip.
std::vector<DesktopIniKey> DesktopIniKeys(bool isThere, const wxString& iconName);

/// Sets one key; the success flag of WritePrivateProfileStringW, which changes no other key and
/// creates a missing file.
bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path);

/// Makes a Desktop.ini with its keys. False, and nothing written, when the hot folder is not a
/// directory; failed writes are not reported. Nothing is written when anything of that name is
/// there.
bool CreateDesktopIni(const PinnedDirectory& directory, const wxString& iconName);

/// Takes read-only and system from a Desktop.ini, writes its keys and has the shell force the
/// folder's icon with SHGetSetFolderCustomSettings, to which the hot folder is known by its path.
/// All other keys stay; of the attributes none does. Result as above.
bool RefreshDesktopIni(const PinnedDirectory& directory, const wxString& hotFolder,
                       const wxString& iconName);
