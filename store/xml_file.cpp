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

XmlFile::State XmlFile::Parse()
{
    switch (LoadXml(m_bytes, m_document, wxXMLDOC_KEEP_WHITESPACE_NODES))
    {
    case XmlLoad::Loaded:
        return State::Loaded;
    case XmlLoad::TooLarge:
        return State::TooLarge;
    case XmlLoad::Malformed:
        break;
    }
    return State::NotReadable;
}

RegularFile::Status XmlFile::ReopenForUpdate()
{
    const RegularFile::Status status = m_file.ReopenForUpdate();
    if (status == RegularFile::Status::Refused)
        ReportNotOpened(m_shownPath);
    return status;
}

bool XmlFile::LoadAgain()
{
    std::string now;
    if (m_file.Length() > static_cast<std::int64_t>(MaxXmlBytes) || !m_file.Read(now))
        return false;
    if (now == m_bytes)
        return true;
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
    return m_document.GetRoot();
}

const wxXmlDocument& XmlFile::GetDocument() const
{
    return m_document;
}

const std::string& XmlFile::GetBytes() const
{
    return m_bytes;
}
