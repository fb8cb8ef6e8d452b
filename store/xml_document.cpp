#include "store/xml_document.h"

#include "platform/memory.h"

#include <wx/log.h>
#include <wx/mstream.h>

XmlLook LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document)
{
    const bool isHarmless = IsHarmlessXml(bytes);
    XmlLook look = isHarmless ? XmlLook() : LookAtXml(bytes, limits);
    if (!look.isWithinLimits)
        return look;
    RequireMemory(look.memory * limits.copies);
    const wxLogNull noSyntaxErrors;
    wxMemoryInputStream stream(bytes.data(), bytes.size());
    const bool isLoaded = document.Load(stream, L"UTF-8", wxXMLDOC_KEEP_WHITESPACE_NODES);
    if (isHarmless && !isLoaded)
        look = LookAtXml(bytes, limits);
    return look;
}
