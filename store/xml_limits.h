// How much of an XML document the library is let at.
#pragma once

#include <string>

/// The longest document, in bytes, that is looked at at all.
constexpr size_t MaxXmlBytes = size_t{64} * 1024 * 1024;

/// Whether wxXmlDocument can load these bytes, and destroy them again, without exhausting the
/// stack, taking more than a few hundred megabytes or more than a second or two. Says nothing about
/// whether they are well-formed: what is not is judged up to the place where the library will stop,
/// too.
///
/// Takes a time in proportion to the bytes. See xml_limits.cpp for the limits.
bool IsWithinXmlLimits(const std::string& bytes);
