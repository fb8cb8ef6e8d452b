// Changing the attributes of a file or directory.
#pragma once

#include "platform/system.h"

#include <wx/string.h>

/// The two attributes by which Explorer recognises what it is to treat specially.
constexpr DWORD ReadOnlyAndSystem = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_SYSTEM;

/// Adds and removes attributes with GetFileAttributesW and SetFileAttributesW. Nothing is written
/// when the attributes cannot be read, or are right already. False when one of the two calls fails.
bool ChangeAttributes(const wxString& path, DWORD add, DWORD remove);
