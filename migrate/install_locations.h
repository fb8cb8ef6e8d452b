// The two template folders between which template paths move, from the Windows registry.
#pragma once

#include <wx/filename.h>

/// The registry value that was looked for, for messages.
struct ValueSource
{
    wxString name;   // with its key
    wxString whyNot; // why it could not be read; empty if it was
};

/// The default template folder of the installed software: "template" below the InstallPath of the
/// machine's key. Returns false and leaves the folder as it was if that cannot be read.
///
/// Every call reads the registry. Both lookups follow RegOpenKeyExW and RegQueryValueExW: the
/// 32-bit key comes first, the other is tried only if the first cannot be opened; at most 517 bytes
/// are read, as UTF-16 up to the first NUL whatever the value's type. The folder may be missing;
/// its last part becomes the file name.
bool GetDefaultImposeTemplatePath(wxFileName& folder, ValueSource& source);

/// The default template folder of the previous version: the Path of the current user's key. Returns
/// false and an empty file name if that cannot be read.
bool GetPreviousImposeTemplatePath(wxFileName& folder, ValueSource& source);
