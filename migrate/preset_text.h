// The text of a job preset.
#pragma once

#include <wx/string.h>

/// Replaces the folder by the other one in every template path of the text that lies in it: where
/// the search text ORXImposeTemplate">" and the folder's text follow each other, and a path
/// separator or the closing double quote follows them. Separators at the end of either folder do
/// not count. An empty folder, or a new one that XML text cannot hold, replaces nothing.
/// Returns the number of replacements; takes a time in proportion to the text.
size_t MovePresetPaths(wxString& text, wxString from, wxString to);
