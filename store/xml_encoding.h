// Whether the library read a document in an encoding that it really knows.
#pragma once

#include <wx/string.h>

/// wxXmlDocument::Load takes every encoding name: of one that it does not know, or whose characters
/// take more than one byte (Shift_JIS, say), it makes nonsense and still reports success. True when
/// the file at the path comes out as it is: UTF-8, UTF-16, Latin-1, ASCII, or a single-byte
/// encoding in which all of its bytes have a meaning.
bool IsReadFaithfully(const wxString& path);
