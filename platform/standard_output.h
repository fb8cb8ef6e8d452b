// The standard output and the standard error of a program without windows; one source for each
// system.
#pragma once

#include <wx/string.h>

/// Writes the text in UTF-8, on a Windows console as Unicode, whatever its code page. False when it
/// could not be written whole.
bool WriteStandardOutput(const wxString& text);
void WriteStandardError(const wxString& text);
