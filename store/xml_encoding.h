// Whether the library reads a document in an encoding that it really knows.
#pragma once

#include <wx/string.h>

#include <array>
#include <string>

/// For each byte the character that the library has the parser take for it, in an encoding that the
/// parser does not know by itself; -1 for none.
using EncodingMap = std::array<int, 256>;

EncodingMap GetEncodingMap(const wxString& encoding);

/// The encoding that the document declares: UTF-8 without a declaration (as in UTF-16, which the
/// parser recognises by itself), none for an empty document.
wxString DeclaredEncoding(const std::string& document);

/// Whether the document is in UTF-8, or in ASCII.
bool IsUtf8(const std::string& document);

/// wxXmlDocument::Load takes every encoding name: of one that it does not know, or whose characters
/// take more than one byte (Shift_JIS, say), it makes nonsense and still reports success. True when
/// the document comes out as it is: UTF-8, UTF-16, Latin-1, ASCII; a single-byte encoding in which
/// all of its bytes have a meaning; or any encoding, when all of its bytes are ASCII and are read
/// as that.
bool IsReadFaithfully(const std::string& document);
