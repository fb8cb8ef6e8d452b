// Paths as the system calls of this platform take them.
#pragma once

#include <wx/string.h>

/// The path with every backslash turned into a slash.
wxString NativePath(const wxString& path);
