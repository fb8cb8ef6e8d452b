// How the library reads a document's encoding.
#pragma once

#include <wx/string.h>

#include <bitset>
#include <string>

/// For each byte, the character that the library gives a parser that does not know the encoding. It
/// does so under every name, and byte by byte. Returns the bytes for which that is wrong: all of
/// them if the library does not know the encoding; undefined ones, and those that are only a part
/// of a character (in Shift_JIS, for example); and ASCII that becomes something else.
std::bitset<256> FillEncodingMap(const wxString& encoding, int* map);

/// The encoding that the document declares; empty if it declares none.
wxString DeclaredEncoding(const std::string& document);

/// Whether the document is in UTF-8, or in ASCII.
bool IsUtf8(const std::string& document);
