// The standard output and the standard error of a program without windows; one source for each
// system.
#pragma once

#include <wx/string.h>

enum class StandardStream
{
    Output,
    Error
};

/// Writes the text in UTF-8, or to a Windows console as Unicode, whatever its code page. Returns
/// false if it could not be written completely.
bool WriteTo(StandardStream stream, const wxString& text);
