#include "store/xml_encoding.h"

#include <wx/strconv.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <expat.h>
#include <memory>

std::bitset<256> FillEncodingMap(const wxString& encoding, int* map)
{
    const wxCSConv conversion(encoding);
    // The library reads every encoding that it does not know as Latin-1, which is right only for
    // "latin1" (unknown to it on Windows), and ASCII as well. It reads byte by byte even if the
    // encoding has wider units.
    const bool isAscii = encoding.CmpNoCase("ASCII") == 0;
    const bool isKnown =
        (conversion.IsOk() && conversion.GetMBNulLen() == 1) || encoding.CmpNoCase("latin1") == 0;
    std::bitset<256> misread;
    std::array<wchar_t, 10> wide{};
    for (int i = 1; i < 256; ++i)
    {
        // An undefined byte becomes the previous character, as in the library.
        const std::array<char, 10> narrow = {static_cast<char>(i)};
        conversion.MB2WC(wide.data(), narrow.data(), 2);
        map[i] = static_cast<int>(wide[0]);
        misread[static_cast<size_t>(i)] =
            !isKnown || (i < 0x80 ? map[i] != i : isAscii) ||
            std::strcmp(wxString(wide[0]).mb_str(conversion), narrow.data()) != 0;
    }
    return misread;
}

wxString DeclaredEncoding(const std::string& document)
{
    constexpr size_t LongestDeclaration = 256;
    wxString encoding;
    const std::unique_ptr<XML_ParserStruct, void (*)(XML_Parser)> parser(XML_ParserCreate(nullptr),
                                                                         XML_ParserFree);
    XML_SetUserData(parser.get(), &encoding);
    XML_SetXmlDeclHandler(parser.get(), [](void* declared, const char*, const char* name, int)
                          { *static_cast<wxString*>(declared) = wxString::FromUTF8(name); });
    XML_Parse(parser.get(), document.data(),
              static_cast<int>(std::min(document.size(), LongestDeclaration)), XML_FALSE);
    return encoding;
}

bool IsUtf8(const std::string& document)
{
    const wxString text = wxString::FromUTF8(document.data(), document.size());
    const wxString encoding = DeclaredEncoding(document);
    return !text.empty() &&
           (text.IsAscii() || encoding.empty() || encoding.CmpNoCase("UTF-8") == 0);
}
