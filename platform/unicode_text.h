// Text in the wide characters of the system: UTF-16 units on Windows, code points elsewhere.
#pragma once

#include <wx/string.h>

/// Whether the text is Unicode: no surrogate without its partner, nothing above U+10FFFF. Only such
/// text survives encoding as UTF-8 and decoding.
bool IsUnicodeText(const wxString& text);

/// The text of UTF-16LE bytes up to the first NUL or the last whole unit. A surrogate without its
/// partner stays as it is.
wxString FromUtf16Bytes(const unsigned char* bytes, size_t count);

/// The text as one line of Unicode, for a log or a report: U+FFFD replaces the line ends U+2028 and
/// U+2029, what is not Unicode, and every control character (U+0000 to U+001F, U+007F to U+009F)
/// but tab.
wxString ToOneLine(const wxString& text);
