// XML documents: which text they can hold, how large one may be, and loading it from bytes.
#pragma once

#include <wx/xml/xml.h>

#include <cstdint>
#include <string>

/// Reasons why a file stays as it is, for the log and for reports.
constexpr const wchar_t* TooLargeToRead = L"too large to read safely";
constexpr const wchar_t* NewContentTooLarge = L"the new content would be too large";

struct XmlLimits
{
    std::int64_t bytes;   // of the document
    std::uint64_t memory; // bytes that the library takes; see xml_document.cpp
    unsigned copies;      // how often it is in memory at the same time, in one form or another
    std::uint64_t steps;  // that the library takes beside reading each byte once
};

/// A Folder.cfg is parsed, copied, written and parsed again. Within these limits a run and a check
/// each take at most 0.5 s and 200 MB for it. The sample has 7 KB; 10,000 job settings and 10,000
/// elements of a filter setting take about 16 million bytes of memory.
constexpr XmlLimits FolderCfgLimits = {std::int64_t{2} * 1024 * 1024, 24'000'000, 6, 100'000'000};

/// The list of hot folders is parsed once. 250,000 folders of 60 characters take about 250 million
/// bytes of memory.
constexpr XmlLimits ListLimits = {std::int64_t{64} * 1024 * 1024, 320'000'000, 2, 1'000'000'000};

/// Where and why a document is not well-formed, in the parser's words.
struct XmlSyntaxError
{
    wxString message;       // empty if it is well-formed
    unsigned long line = 0; // from 1

    /// The words in which the library reports it.
    wxString Describe() const;
};

/// What is known of a document before the library loads it.
struct XmlLook
{
    bool isWithinLimits = true;
    bool isFaithful = true;   // whether the library reads every character of its encoding correctly
    std::uint64_t memory = 0; // that the library takes; not known of a small document
    XmlSyntaxError error;     // the first
};

/// Loads the document with wxXmlDocument::Load (encoding "UTF-8"), text nodes that are only white
/// space included. It has no root afterwards if it is malformed, has more than 2,048 levels or a
/// million characters in a text or value, or exceeds the limits; but the caller compares the number
/// of bytes. The library reports nothing. Throws std::bad_alloc if there is not enough memory to
/// work with the document.
XmlLook LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document);

/// Whether LoadXml would load these bytes, unless they are malformed. Takes time proportional to
/// their number.
bool IsWithinLimits(const std::string& bytes, const XmlLimits& limits);

/// Whether an XML document can hold the text: no control characters except tab, line feed and
/// carriage return, no lone surrogate, neither U+FFFE nor U+FFFF, nothing above U+10FFFF.
bool IsXmlText(const wxString& text);
