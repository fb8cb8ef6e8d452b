#include "store/xml_encoding.h"

#include <wx/fontmap.h>
#include <wx/strconv.h>

#include <algorithm>
#include <array>

namespace
{

// The encodings that the parser behind wxXmlDocument reads by itself.
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

// Where the library does not know the encoding at all, nothing is read as what it is: it takes it
// for Latin-1, which is right only for a name of that which it does not know on Windows.
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

} // namespace

wxString DeclaredEncoding(const std::string& document)
{
    // The library's answer is no use where white space surrounds the equals sign: it is UTF-8 or
    // nonsense then, while its parser knows better.
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
        // A byte that has no meaning comes out as the character before it, as in the library.
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
    // A byte without a meaning in the encoding would come out as the character before it.
    return IsSingleByte(encoding) &&
           !wxString(document.data(), wxCSConv(encoding), document.size()).empty();
}
