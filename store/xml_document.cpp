#include "store/xml_document.h"

#include "store/xml_limits.h"

#include <wx/mstream.h>

XmlLoad LoadXml(const std::string& bytes, wxXmlDocument& document, int flags)
{
    if (!IsWithinXmlLimits(bytes))
        return XmlLoad::TooLarge;
    wxMemoryInputStream stream(bytes.data(), bytes.size());
    return document.Load(stream, L"UTF-8", flags) && document.GetRoot() ? XmlLoad::Loaded
                                                                        : XmlLoad::Malformed;
}
