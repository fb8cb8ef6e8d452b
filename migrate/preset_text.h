// The text of a job preset, and what becomes of it.
#pragma once

#include <wx/string.h>

#include <string>

/// Replaces the folder by the other one in every template path of the text that lies in it: where
/// the search text ORXImposeTemplate">" and the folder's text follow each other, and a path
/// separator or the closing double quote follows them. Separators at the end of either folder do
/// not count. An empty folder, or a new one that XML text cannot hold, replaces nothing.
/// Returns the number of replacements; takes a time in proportion to the text.
size_t MovePresetPaths(wxString& text, wxString from, wxString to);

/// A preset file's new content, or why the file has to stay as it is.
struct RewrittenPreset
{
    const char* reasonToStay = nullptr;
    size_t movedPaths = 0;
    std::string bytes;
};

/// The content that replaces these bytes: the paths moved, in UTF-8 without byte-order mark, and
/// where the system ends lines with CR LF, so ends every line.
RewrittenPreset RewritePreset(const std::string& before, const wxString& from, const wxString& to);
