// What an XML document can hold.
#pragma once

#include <wx/string.h>

/// Whether an XML document can hold the text: no control characters except tab, line feed and
/// carriage return, no lone surrogate, neither U+FFFE nor U+FFFF, nothing above U+10FFFF.
bool IsXmlText(const wxString& text);
