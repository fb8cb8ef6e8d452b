// How large an XML document the library is given.
#pragma once

#include <string>

/// The longest document, in bytes, that is examined at all.
constexpr size_t MaxXmlBytes = size_t{64} * 1024 * 1024;

/// Whether wxXmlDocument can load these bytes and destroy the document without exhausting the
/// stack, taking more than a few hundred megabytes or more than a few seconds. Does not check that
/// they are well-formed: a malformed document is judged up to the place where the library will also
/// stop.
///
/// Takes time proportional to the number of bytes. See xml_limits.cpp for the limits.
bool IsWithinXmlLimits(const std::string& bytes);
