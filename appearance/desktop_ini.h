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

/// The keys to write, in order: all of them for a new Desktop.ini, otherwise those that show the
/// icon and the info tip.
std::vector<DesktopIniKey> DesktopIniKeys(bool isThere, const wxString& iconName);

/// Sets one key and returns the success flag of WritePrivateProfileStringW, which changes no other
/// key and creates a missing file.
bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path);

/// Creates a Desktop.ini with its keys. Returns false and writes nothing if the hot folder is not a
/// directory; failed writes are not reported. Writes nothing if anything of that name exists.
bool CreateDesktopIni(const PinnedDirectory& directory, const wxString& iconName);

/// Removes read-only and system from a Desktop.ini, writes its keys and has the shell force the
/// folder's icon with SHGetSetFolderCustomSettings, which is given the hot folder's path. All other
/// keys stay; no attribute does. Returns the same as above.
bool RefreshDesktopIni(const PinnedDirectory& directory, const wxString& hotFolder,
                       const wxString& iconName);
