// How large an XML document the library is given.
#pragma once

#include <wx/string.h>

#include <cstdint>
#include <string>

/// The longest document, in bytes, that is examined at all.
constexpr std::int64_t LongestXml = std::int64_t{64} * 1024 * 1024;

/// Where and why a document is not well-formed, in the parser's words.
struct XmlSyntaxError
{
    wxString message;       // empty if it is well-formed
    unsigned long line = 0; // from 1

    /// The words in which the library reports it.
    wxString Describe() const;
};

struct XmlLook
{
    bool isWithinLimits = true;
    XmlSyntaxError error;
};

/// Whether documents that are certain to be within all limits are looked at.
enum class Harmless
{
    Skip,
    LookToo
};

/// Whether wxXmlDocument can load these bytes and destroy the document without exhausting the
/// stack, taking more than a few hundred megabytes or more than a few seconds; and the first syntax
/// error. A malformed document is judged up to the place where the library will also stop.
///
/// Takes time proportional to the number of bytes. See xml_limits.cpp for the limits.
XmlLook LookAtXml(const std::string& bytes, Harmless harmless = Harmless::Skip);
