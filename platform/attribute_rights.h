// Whether the attributes of a file or directory may be changed; one source for each system.
#pragma once

#include <wx/string.h>

/// Whether SetFileAttributesW would be let at it. Changes nothing; a link is looked at itself.
bool MayChangeAttributes(const wxString& path);
