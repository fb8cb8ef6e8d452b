// An XML file that is read and parsed, and perhaps rewritten.
#pragma once

#include "platform/regular_file.h"
#include "store/xml_document.h"

#include <memory>

struct XmlFile
{
    enum class State
    {
        Missing,     // no regular file of that name, or a refused link
        NotReadable, // refused by the system, or malformed; see WhyNotReadable
        TooLarge,    // see XmlLimits
        Loaded
    };

    enum class Saved
    {
        Done,
        Refused,      // the file cannot be opened for writing, or not be written; it knows why
        NotReadAgain, // it is gone, or cannot be read
        Changed       // its bytes are no longer those that were loaded
    };

    explicit XmlFile(const XmlLimits& itsLimits);

    /// Reads a file that was just opened. Parses it unless its bytes are those of the document that
    /// is already here.
    State Load(RegularFile::Status opened);

    /// Makes these bytes the whole content, as RegularFile::Rewrite does, if the content is still
    /// what was loaded.
    Saved Save(const std::string& newBytes);

    /// The library's words for the call that failed or for the syntax error.
    wxString WhyNotReadable(const wxString& shownPath) const;

    /// The root of the loaded document, or null; it includes the text nodes that are only white
    /// space.
    const wxXmlNode* Root() const;

    const XmlLimits& limits;
    RegularFile file;
    State state = State::Missing;
    std::string bytes; // as they were loaded
    std::unique_ptr<const wxXmlDocument> document;
    bool isFaithful = false; // whether the document is what its author meant: see XmlLook
    XmlSyntaxError error;
};
