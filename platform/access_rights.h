// What the process may do, without doing it; one source for each system.
#pragma once

#include <wx/string.h>

/// Whether SetFileAttributesW would be let at it. Changes nothing; a link is looked at itself.
bool MayChangeAttributes(const wxString& path);

/// Whether a file may be made in the directory.
bool MayCreateIn(const wxString& directory);
