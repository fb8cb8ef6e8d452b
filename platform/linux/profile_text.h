// The text of a profile file (.ini), or of what the registry editor exports, which has the same
// form.
#pragma once

#include <wx/string.h>

#include <string>

/// The text in characters of one byte, or of two after a UTF-16LE byte-order mark. So a text in any
/// encoding stays as it is, its byte-order mark included.
struct ProfileText
{
    explicit ProfileText(const std::string& bytes);

    std::string Bytes() const;

    size_t width; // of a character, in bytes
    wxString text;
    std::string end; // half a character, if any
};

/// Where a key is, or where it has to be added.
struct ProfilePlace
{
    bool hasSection = false;
    bool hasKey = false;
    size_t begin = 0; // of the key's line, or after the section's last line that is not empty
    size_t next = 0;  // where the line after it begins
    wxString value;   // without white space around it
};

/// Compares names ignoring case; of a repeated section or key, the first counts.
ProfilePlace FindInProfile(const wxString& text, const wxString& section, const wxString& key);
