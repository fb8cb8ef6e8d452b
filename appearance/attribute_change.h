// Changing the attributes of a file or directory.
#pragma once

#include "platform/system.h"

#include <wx/string.h>

/// The two attributes by which Explorer recognises a customised folder or file.
constexpr DWORD ReadOnlyAndSystem = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_SYSTEM;

/// Adds and removes attributes with GetFileAttributesW and SetFileAttributesW. Writes nothing if
/// the attributes cannot be read or are already right. Returns false if either call fails.
bool ChangeAttributes(const wxString& path, DWORD add, DWORD remove);

/// What becomes of the attributes that SetFileAttributesW can change, but for those that the system
/// itself sets: archive and normal.
struct AttributeChange
{
    DWORD before = 0;
    DWORD after = 0;
};

/// The change from the present attributes; none if they cannot be read.
AttributeChange DecideAttributes(const wxString& path, DWORD add, DWORD remove);
