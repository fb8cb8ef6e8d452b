// A hot folder's Desktop.ini, in which Explorer looks for the folder's icon and info tip.
#pragma once

#include <wx/string.h>

/// The path of the folder's Desktop.ini, the folder as it is given: one that ends in a separator
/// gives a doubled one, which names the same file.
wxString DesktopIniPath(const wxString& hotFolder);

/// Sets one key; the success flag of WritePrivateProfileStringW, which changes no other key and
/// creates a missing file.
bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path);

/// Writes the keys of a Desktop.ini that is not there yet: IconFile, IconIndex, InfoTip, in the
/// section .ShellClassInfo. False, and nothing written, when the hot folder is not a directory;
/// failed writes are not reported.
bool CreateDesktopIni(const wxString& hotFolder, const wxString& iconName);

/// Takes read-only and system from a Desktop.ini, writes its keys InfoTip and IconFile and has the
/// shell force the folder's icon with SHGetSetFolderCustomSettings. All other keys stay; of the
/// attributes none does. Result as above.
bool RefreshDesktopIni(const wxString& hotFolder, const wxString& iconName);
