#include "store/xml_file.h"

#include "store/xml_document.h"
#include "store/xml_limits.h"

#include <cstdint>

XmlFile::State XmlFile::Load(const wxString& path, Links links, const wxString& shownPath)
{
    m_shownPath = shownPath;
    const RegularFile::Status status = m_file.OpenForReading(path, links);
    if (status == RegularFile::Status::Refused)
        ReportNotOpened(shownPath);
    if (status != RegularFile::Status::Open)
        return status == RegularFile::Status::Refused ? State::NotReadable : State::Missing;
    if (m_file.Length() > static_cast<std::int64_t>(MaxXmlBytes))
        return State::TooLarge;
    if (m_file.Read(m_bytes))
        return Parse();
    ReportNotRead(shownPath);
    return State::NotReadable;
}

// Both steps of a hot folder read the same Folder.cfg one after another, and most of their time
// is the parser's. So the last document is kept, together with its bytes: the same bytes make the
// same document. A large one is not kept, since it would take memory while another is loaded.
XmlFile::State XmlFile::Parse()
{
    constexpr size_t LongestKept = size_t{64} * 1024;
    static std::string lastBytes;
    static std::shared_ptr<const wxXmlDocument> lastDocument;
    if (lastDocument && m_bytes == lastBytes)
    {
        m_document = lastDocument;
        return State::Loaded;
    }
    m_document = nullptr;
    lastDocument = nullptr;
    auto document = std::make_shared<wxXmlDocument>();
    const XmlLoad result = LoadXml(m_bytes, *document, wxXMLDOC_KEEP_WHITESPACE_NODES);
    if (result != XmlLoad::Loaded)
        return result == XmlLoad::TooLarge ? State::TooLarge : State::NotReadable;
    m_document = document;
    if (m_bytes.size() <= LongestKept)
    {
        lastBytes = m_bytes;
        lastDocument = m_document;
    }
    return State::Loaded;
}

RegularFile::Status XmlFile::ReopenForUpdate()
{
    const RegularFile::Status status = m_file.ReopenForUpdate();
    if (status == RegularFile::Status::Refused)
        m_file.ReportNotReopened(m_shownPath);
    return status;
}

bool XmlFile::LoadAgain()
{
    std::string now;
    if (m_file.Length() > static_cast<std::int64_t>(MaxXmlBytes) || !m_file.Read(now))
        return false;
    m_bytes.swap(now);
    return Parse() == State::Loaded;
}

void XmlFile::Rewrite(const std::string& bytes)
{
    if (!m_file.Rewrite(m_bytes, bytes))
        m_file.ReportNotWritten(m_shownPath);
}

const wxXmlNode* XmlFile::GetRoot() const
{
    return m_document ? m_document->GetRoot() : nullptr;
}

const wxXmlDocument& XmlFile::GetDocument() const
{
    return *m_document;
}

const std::string& XmlFile::GetBytes() const
{
    return m_bytes;
}
