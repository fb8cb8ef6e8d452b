#include "store/xml_encoding.h"

#include <wx/ffile.h>
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

// The encoding that the file declares: UTF-8 without a declaration (as in UTF-16, which the parser
// tells by itself), none when it cannot be read. The library's answer is no use where blanks stand
// around the equals sign: it is UTF-8 or nonsense then, while its parser knows better.
wxString DeclaredEncoding(const wxString& path)
{
    wxFFile file(path, "rb");
    std::array<char, 256> start{};
    const size_t length = file.IsOpened() ? file.Read(start.data(), start.size()) : 0;
    wxString declaration = wxString::From8BitData(start.data(), length).BeforeFirst('>');
    if (declaration.StartsWith(L"\u00EF\u00BB\u00BF"))
        declaration.Remove(0, 3);
    const size_t name = declaration.find("encoding");
    if (!declaration.StartsWith("<?xml") || name == wxString::npos)
        return length > 0 ? "UTF-8" : "";
    const wxString value = declaration.Mid(name).AfterFirst('=').Trim(false);
    return value.Mid(1).BeforeFirst(value[0]);
}

} // namespace

bool IsReadFaithfully(const wxString& path)
{
    const wxString encoding = DeclaredEncoding(path);
    if (IsBuiltIn(encoding))
        return true;
    if (!IsSingleByte(encoding))
        return false;
    // A byte without a meaning in the encoding would come out as the character before it.
    wxString text;
    wxFFile file(path, "rb");
    return file.IsOpened() && file.ReadAll(&text, wxCSConv(encoding)) && !text.empty();
}
