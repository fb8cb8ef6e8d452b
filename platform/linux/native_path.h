// Paths as the system calls of this platform take them.
#pragma once

#include <wx/string.h>

/// The path with every backslash turned into a slash.
inline wxString NativePath(wxString path)
{
    path.Replace("\\", "/");
    return path;
}
