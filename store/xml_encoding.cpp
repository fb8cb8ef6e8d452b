#include "store/xml_encoding.h"

#include <wx/fontmap.h>
#include <wx/strconv.h>

#include <algorithm>
#include <array>

namespace
{

// The encodings that wxXmlDocument's parser reads by itself.
bool IsBuiltIn(const wxString& encoding)
{
    static const std::array<const char*, 6> names = {"UTF-8",    "UTF-16",     "UTF-16LE",
                                                     "UTF-16BE", "ISO-8859-1", "US-ASCII"};
    return std::any_of(names.begin(), names.end(),
                       [&](const char* name) { return encoding.CmpNoCase(name) == 0; });
}

bool IsSingleByte(const wxString& encoding)
{
    const wxFontEncoding code = wxFontMapperBase::Get()->CharsetToEncoding(encoding, false);
    return (code >= wxFONTENCODING_ISO8859_1 && code <= wxFONTENCODING_ISO8859_15) ||
           code == wxFONTENCODING_KOI8 || code == wxFONTENCODING_KOI8_U ||
           (code >= wxFONTENCODING_CP437 && code <= wxFONTENCODING_CP874) ||
           (code >= wxFONTENCODING_CP1250 && code <= wxFONTENCODING_CP1258);
}

// The library reads an encoding that it does not know as Latin-1, which is right only for "latin1"
// (unknown to it on Windows).
bool IsReadAsAscii(const std::string& document, const wxString& encoding)
{
    if (!wxCSConv(encoding).IsOk() && encoding.CmpNoCase("latin1") != 0)
        return false;
    const EncodingMap map = GetEncodingMap(encoding);
    return std::all_of(document.begin(), document.end(),
                       [&](char each)
                       {
                           const auto code = static_cast<unsigned char>(each);
                           return code < 0x80 && map[code] == code;
                       });
}

// Whether every byte is defined in the encoding. An undefined one would be read as the previous
// character.
bool HasMeaning(const std::string& document, const wxString& encoding)
{
    std::array<bool, 256> isThere{};
    for (const char each : document)
        isThere[static_cast<unsigned char>(each)] = true;
    const wxCSConv conversion(encoding);
    std::array<wchar_t, 10> wide{};
    for (size_t i = 1; i < isThere.size(); ++i)
    {
        const std::array<char, 2> narrow = {static_cast<char>(i), '\0'};
        if (isThere[i] &&
            conversion.MB2WC(wide.data(), narrow.data(), wide.size()) == wxCONV_FAILED)
            return false;
    }
    return true;
}

} // namespace

wxString DeclaredEncoding(const std::string& document)
{
    // The library's answer is useless if there is white space around the equals sign: it is then
    // UTF-8 or nonsense, although its parser reads the name correctly.
    constexpr size_t LongestDeclaration = 256;
    wxString declaration =
        wxString::From8BitData(document.data(), std::min(document.size(), LongestDeclaration))
            .BeforeFirst('>');
    if (declaration.StartsWith(L"\u00EF\u00BB\u00BF"))
        declaration.Remove(0, 3);
    const size_t name = declaration.find("encoding");
    if (!declaration.StartsWith("<?xml") || name == wxString::npos)
        return document.empty() ? "" : "UTF-8";
    const wxString value = declaration.Mid(name).AfterFirst('=').Trim(false);
    return value.Mid(1).BeforeFirst(value[0]);
}

bool IsUtf8(const std::string& document)
{
    const bool isAscii =
        std::all_of(document.begin(), document.end(),
                    [](char each) { return static_cast<unsigned char>(each) < 0x80; });
    return isAscii || (DeclaredEncoding(document).CmpNoCase("UTF-8") == 0 &&
                       !wxString::FromUTF8(document.data(), document.size()).empty());
}

EncodingMap GetEncodingMap(const wxString& encoding)
{
    const wxCSConv conversion(encoding);
    EncodingMap map{};
    std::array<wchar_t, 10> wide{};
    for (size_t i = 1; i < map.size(); ++i)
    {
        // An undefined byte becomes the previous character, as in the library.
        const std::array<char, 2> narrow = {static_cast<char>(i), '\0'};
        conversion.MB2WC(wide.data(), narrow.data(), 2);
        map[i] = static_cast<int>(wide[0]);
    }
    return map;
}

bool IsReadFaithfully(const std::string& document)
{
    const wxString encoding = DeclaredEncoding(document);
    if (IsBuiltIn(encoding) || IsReadAsAscii(document, encoding))
        return true;
    return IsSingleByte(encoding) && HasMeaning(document, encoding);
}
