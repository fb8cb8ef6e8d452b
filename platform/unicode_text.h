// Text in the wide characters of the system: UTF-16 units on Windows, code points elsewhere.
#pragma once

#include <wx/string.h>

#include <cstddef>

/// Whether the text is Unicode: no surrogate without its partner, nothing above U+10FFFF. Just then
/// it encodes as UTF-8 and comes back from it as it was.
bool IsUnicodeText(const wxString& text);

/// The text of UTF-16LE bytes up to the first NUL or the last whole unit. A surrogate without its
/// partner stays what it is.
wxString FromUtf16Bytes(const unsigned char* bytes, size_t count);

/// The text with U+FFFD in the place of every character that is not Unicode.
wxString ToUnicodeText(const wxString& text);
