// The text of a job preset, and its migrated form.
#pragma once

#include <wx/string.h>

#include <optional>
#include <string>
#include <vector>

/// Replaces the first folder with the second in every template path of the text that lies in it:
/// where the search text ORXImposeTemplate">" is directly followed by the folder's text, and that
/// by a path separator or the closing double quote. Separators at the end of a folder are ignored.
/// Replaces nothing if either is empty, or if XML cannot hold the second. Returns the number of
/// replacements; nothing if the text would have more than LongestFile characters, and so could not
/// be read again. Takes time proportional to the length of the text.
std::optional<size_t> MovePresetPaths(wxString& text, const wxString& oldFolder,
                                      const wxString& newFolder);

/// The template paths of the text, each with what MovePresetPaths makes of it; what follows the
/// search text up to the next double quote. isCutOff: the last one has no double quote.
struct PresetPath
{
    wxString stored;
    wxString moved;
    bool isCutOff = false;
};
std::vector<PresetPath> FindPresetPaths(const wxString& text, const wxString& from,
                                        const wxString& to);

/// What MovePresetPaths makes of this path.
wxString MovedPresetPath(const wxString& path, const wxString& from, const wxString& to);

/// Decodes a preset file's bytes. Returns why it stays as it is, or null.
const wchar_t* DecodePreset(const std::string& bytes, wxString& text);

/// A preset file's new content, or why the file has to stay as it is.
struct RewrittenPreset
{
    const wchar_t* reasonToStay = nullptr;
    std::string before;
    std::string bytes;
};

/// The content that replaces these bytes: with moved paths, in UTF-8 without byte-order mark, and
/// with every line ending in CR LF if the system's lines do.
RewrittenPreset RewritePreset(const std::string& before, const wxString& from, const wxString& to);
