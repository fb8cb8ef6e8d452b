// Whether the library reads a document's encoding faithfully.
#pragma once

#include <wx/string.h>

#include <array>
#include <string>

/// For each byte, the character that the library passes to the parser for it, in an encoding that
/// the parser does not know by itself; the previous one for an undefined byte.
using EncodingMap = std::array<int, 256>;

EncodingMap GetEncodingMap(const wxString& encoding);

/// The encoding that the document declares: UTF-8 without a declaration (also for UTF-16, which the
/// parser recognises by itself), empty for an empty document.
wxString DeclaredEncoding(const std::string& document);

/// Whether the document is in UTF-8, or in ASCII.
bool IsUtf8(const std::string& document);

/// wxXmlDocument::Load accepts every encoding name. If it does not know the encoding, or if
/// characters take more than one byte (Shift_JIS, for example), it reads nonsense and still reports
/// success. Returns true if the document is read correctly: in UTF-8, UTF-16, Latin-1 or ASCII; in
/// a single-byte encoding in which all of its bytes are defined; or in any encoding, if all of its
/// bytes are ASCII and are read as ASCII.
bool IsReadFaithfully(const std::string& document);
