// What the library shows to the user: in a message box on Windows, on standard error elsewhere.
#pragma once

#include <wx/string.h>

/// Reports an error as one line (wxLogError); see ToOneLine.
void ReportError(const wxString& message);
