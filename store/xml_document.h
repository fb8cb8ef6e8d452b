// An XML document loaded from bytes.
#pragma once

#include "store/xml_limits.h"

#include <wx/xml/xml.h>

#include <string>

/// Loads the document with wxXmlDocument::Load (encoding "UTF-8"), text nodes that are only white
/// space included. It has no root afterwards if it is not within the limits, or malformed. The
/// library reports nothing. Throws std::bad_alloc if there is not enough memory to work with the
/// document.
XmlLook LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document);
