// How large an XML document the library is given.
#pragma once

#include <wx/string.h>

#include <cstdint>
#include <string>

struct XmlLimits
{
    size_t bytes;         // of the document
    std::uint64_t memory; // bytes that the library takes; see xml_limits.cpp
    unsigned copies;      // how often it is in memory at the same time, in one form or another
    std::uint64_t steps;  // that the library takes beside reading each byte once
};

/// A Folder.cfg is parsed, copied, written and parsed again. Within these limits a run and a check
/// each take at most 0.5 s and 200 MB for it. The sample has 7 KB; 10,000 job settings and 10,000
/// elements of a filter setting take about 16 million bytes of memory.
constexpr XmlLimits FolderCfgLimits = {size_t{2} * 1024 * 1024, 24'000'000, 6, 100'000'000};

/// The list of hot folders is parsed once. 250,000 folders of 60 characters take about 250 million
/// bytes of memory.
constexpr XmlLimits ListLimits = {size_t{64} * 1024 * 1024, 320'000'000, 2, 1'000'000'000};

/// Where and why a document is not well-formed, in the parser's words.
struct XmlSyntaxError
{
    wxString message;       // empty if it is well-formed
    unsigned long line = 0; // from 1

    /// The words in which the library reports it.
    wxString Describe() const;
};

constexpr std::uint64_t HarmlessMemory = 2'000'000; // bytes

struct XmlLook
{
    bool isWithinLimits = true;
    bool isFaithful = true; // whether the library reads every character of its encoding correctly
    std::uint64_t memory = HarmlessMemory; // that the library takes
    XmlSyntaxError error;
};

/// Whether wxXmlDocument can load these bytes within the limits, with at most 2,048 levels and no
/// text or value of more than a million characters; and the first syntax error. A malformed
/// document is judged up to the place where the library will also stop. Takes time proportional to
/// the number of bytes.
XmlLook LookAtXml(const std::string& bytes, const XmlLimits& limits);

/// Whether every document like this one is within all limits, is read faithfully and takes at most
/// HarmlessMemory, so that looking at it is not worth the time.
bool IsHarmlessXml(const std::string& bytes);
