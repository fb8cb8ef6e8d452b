// The two template folders between which template paths move, from the Windows registry.
#pragma once

#include <wx/filename.h>
#include <wx/string.h>

/// Where the two folders come from, for people.
extern const char* const DefaultFolderSource;
extern const char* const PreviousFolderSource;

/// The default template folder of the installed software: "template" below the InstallPath of the
/// machine's key. False, and the folder as it was, when that cannot be read.
///
/// Both lookups follow RegOpenKeyExW and RegQueryValueExW: the 32-bit key first, the other only
/// when that does not open; at most 517 bytes, taken as UTF-16 up to the first NUL whatever the
/// value's type; the registry is read at every call, and no folder is looked for on disk. The
/// folder's last component is held as the file name.
bool GetDefaultImposeTemplatePath(wxFileName& folder);

/// The default template folder of the previous version: the Path of the current user's key. False,
/// and an empty file name, when that cannot be read.
bool GetPreviousImposeTemplatePath(wxFileName& folder);
