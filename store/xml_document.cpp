#include "store/xml_document.h"

#include "platform/memory.h"

#include <wx/log.h>
#include <wx/mstream.h>

XmlLoad LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document)
{
    const bool isHarmless = IsHarmlessXml(bytes);
    XmlLook look{true, HarmlessMemory, {}};
    if (!isHarmless)
        look = LookAtXml(bytes, limits);
    if (!look.isWithinLimits)
        return {XmlLoad::State::TooLarge, {}};
    RequireMemory(look.memory * limits.copies);
    const wxLogNull noSyntaxErrors;
    wxMemoryInputStream stream(bytes.data(), bytes.size());
    if (document.Load(stream, L"UTF-8", wxXMLDOC_KEEP_WHITESPACE_NODES) && document.GetRoot())
        return {};
    return {XmlLoad::State::Malformed, isHarmless ? LookAtXml(bytes, limits).error : look.error};
}
