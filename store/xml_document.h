// An XML document loaded from bytes.
#pragma once

#include <wx/xml/xml.h>

#include <string>

enum class XmlLoad
{
    Loaded,
    Malformed, // or without a root element; the library has reported the reason
    TooLarge   // the library would take too much time or memory; see IsWithinXmlLimits
};

/// Loads the document with wxXmlDocument::Load (encoding "UTF-8", and these flags).
XmlLoad LoadXml(const std::string& bytes, wxXmlDocument& document, int flags);
