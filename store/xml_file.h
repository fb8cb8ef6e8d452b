// An XML file that is opened and parsed once, and perhaps rewritten through the same file.
#pragma once

#include "platform/regular_file.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>

class XmlFile
{
  public:
    enum class State
    {
        Missing,     // no regular file of that name, or a link
        NotReadable, // refused or malformed; the library has reported why
        TooLarge,    // see store/xml_limits.h
        Loaded
    };

    /// Opens the file for reading and parses it. People know it by the second path.
    State Load(const wxString& path, Links links, const wxString& shownPath);

    /// Opens the same file for writing, too. Where that is refused, reports it with the library.
    RegularFile::Status ReopenForUpdate();

    /// Reads the file once more, and parses it unless it is the same to the byte; false when that
    /// fails.
    bool LoadAgain();

    /// Makes these bytes the whole content, as RegularFile::Rewrite does; a failure is reported
    /// with the library.
    void Rewrite(const std::string& bytes);

    /// The root of the loaded document; every text node of nothing but white space is there.
    const wxXmlNode* GetRoot() const;
    const wxXmlDocument& GetDocument() const;
    /// The content as it was loaded.
    const std::string& GetBytes() const;

  private:
    State Parse();

    RegularFile m_file;
    wxString m_shownPath;
    std::string m_bytes;
    wxXmlDocument m_document;
};
