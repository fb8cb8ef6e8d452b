#include "store/xml_document.h"

#include <wx/log.h>
#include <wx/mstream.h>

XmlLoad LoadXml(const std::string& bytes, wxXmlDocument& document)
{
    XmlLook look = LookAtXml(bytes);
    if (!look.isWithinLimits)
        return {XmlLoad::State::TooLarge, {}};
    const wxLogNull noSyntaxErrors;
    wxMemoryInputStream stream(bytes.data(), bytes.size());
    if (document.Load(stream, L"UTF-8", wxXMLDOC_KEEP_WHITESPACE_NODES) && document.GetRoot())
        return {};
    if (look.error.message.empty())
        look = LookAtXml(bytes, Harmless::LookToo);
    return {XmlLoad::State::Malformed, look.error};
}
