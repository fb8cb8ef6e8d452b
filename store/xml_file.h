// An XML file that is opened and parsed once, and perhaps reopened and rewritten.
#pragma once

#include "platform/regular_file.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <memory>
#include <string>

class XmlFile
{
  public:
    enum class State
    {
        Missing,     // no regular file of that name, or a refused link
        NotReadable, // refused or malformed; the library has reported the reason
        TooLarge,    // see store/xml_limits.h
        Loaded
    };

    /// Opens the file for reading and parses it. The second path is for messages.
    State Load(const wxString& path, Links links, const wxString& shownPath);

    /// Also opens the same file for writing. If that is refused, has the library report it.
    RegularFile::Status ReopenForUpdate();

    /// Reads the file again, and parses it again unless an unchanged document was kept; returns
    /// false if that fails.
    bool LoadAgain();

    /// Makes these bytes the whole content, as RegularFile::Rewrite does; the library reports a
    /// failure.
    void Rewrite(const std::string& bytes);

    /// The root of the loaded document; it includes the text nodes that are only white space.
    const wxXmlNode* GetRoot() const;
    /// Of a loaded file only.
    const wxXmlDocument& GetDocument() const;
    /// The content as it was loaded.
    const std::string& GetBytes() const;

  private:
    State Parse();

    RegularFile m_file;
    wxString m_shownPath;
    std::string m_bytes;
    std::shared_ptr<const wxXmlDocument> m_document;
};
