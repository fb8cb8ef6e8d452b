// An XML document loaded from bytes.
#pragma once

#include "store/xml_limits.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>

struct XmlLoad
{
    enum class State
    {
        Loaded,
        Malformed, // or without a root element
        TooLarge   // the library would take too much time or memory; see store/xml_limits.h
    };

    State state = State::Loaded;
    XmlSyntaxError error; // of a malformed document
};

/// Loads the document with wxXmlDocument::Load (encoding "UTF-8"), text nodes that are only white
/// space included. The library reports nothing. Throws std::bad_alloc if there is not enough memory
/// to work with the document.
XmlLoad LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document);
