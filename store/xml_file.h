// An XML file that is read and parsed, and perhaps rewritten.
#pragma once

#include "platform/regular_file.h"
#include "store/xml_document.h"

#include <wx/string.h>

#include <memory>
#include <string>

class XmlFile
{
  public:
    enum class State
    {
        Missing,     // no regular file of that name, or a refused link
        NotReadable, // refused by the system, or malformed; see WhyNotReadable
        TooLarge,    // see store/xml_limits.h
        Loaded
    };

    enum class Saved
    {
        Done,
        Refused,      // it cannot be opened for writing, or not be written; see GetFile
        NotReadAgain, // it is gone, or cannot be read
        Changed       // its bytes are no longer those that were loaded
    };

    /// Opens the file and reads it. Parses it unless its bytes are those of the document that is
    /// already here. The file stays open.
    State Load(const wxString& path);
    State Load(const PinnedDirectory& directory, const wxString& name);
    void Close();

    /// Makes these bytes the whole content, as RegularFile::Rewrite does, if the content is still
    /// what was loaded.
    Saved Save(const std::string& bytes);

    State GetState() const;
    /// The library's words for the call that failed or for the syntax error.
    wxString WhyNotReadable(const wxString& shownPath) const;

    RegularFile& GetFile();
    /// The root of the loaded document, or null; it includes the text nodes that are only white
    /// space.
    const wxXmlNode* GetRoot() const;
    /// Of a loaded file only.
    const wxXmlDocument& GetDocument() const;
    /// The content as it was loaded.
    const std::string& GetBytes() const;
    /// Whether the document is what its author meant; see IsReadFaithfully in store/xml_encoding.h.
    bool IsFaithful() const;

  private:
    State Load(RegularFile::Status status);
    State Parse();

    RegularFile m_file;
    std::string m_bytes;
    std::unique_ptr<const wxXmlDocument> m_document;
    State m_state = State::Missing;
    XmlSyntaxError m_error;
    bool m_isFaithful = false;
};
