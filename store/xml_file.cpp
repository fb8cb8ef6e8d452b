#include "store/xml_file.h"

#include "store/xml_encoding.h"

#include <cstdint>

XmlFile::State XmlFile::Load(const wxString& path)
{
    return m_state = Load(m_file.OpenForReading(path));
}

XmlFile::State XmlFile::Load(const PinnedDirectory& directory, const wxString& name)
{
    return m_state = Load(m_file.OpenForReading(directory, name));
}

// Most of the time of a run is the parser's, and the steps of a hot folder read the same file one
// after another. The same bytes make the same document.
XmlFile::State XmlFile::Load(RegularFile::Status status)
{
    std::string bytes;
    State state = State::Loaded;
    if (status != RegularFile::Status::Open)
        state = status == RegularFile::Status::Refused ? State::NotReadable : State::Missing;
    else if (m_file.Length() > static_cast<std::int64_t>(MaxXmlBytes))
        state = State::TooLarge;
    else if (!m_file.Read(bytes))
        state = State::NotReadable;
    if (state == State::Loaded && m_document && bytes == m_bytes)
        return state;
    m_document = nullptr;
    m_error = {};
    m_bytes.swap(bytes);
    return state == State::Loaded ? Parse() : state;
}

XmlFile::State XmlFile::Parse()
{
    auto document = std::make_unique<wxXmlDocument>();
    const XmlLoad load = LoadXml(m_bytes, *document);
    m_error = load.error;
    if (load.state != XmlLoad::State::Loaded)
        return load.state == XmlLoad::State::TooLarge ? State::TooLarge : State::NotReadable;
    m_isFaithful = IsReadFaithfully(m_bytes);
    m_document = std::move(document);
    return State::Loaded;
}

void XmlFile::Close()
{
    m_file.Close();
}

XmlFile::Saved XmlFile::Save(const std::string& bytes)
{
    const RegularFile::Status status = m_file.ReopenForUpdate();
    if (status == RegularFile::Status::Refused)
        return Saved::Refused;
    std::string now;
    if (status != RegularFile::Status::Open ||
        !m_file.Read(now, static_cast<std::int64_t>(MaxXmlBytes)))
        return Saved::NotReadAgain;
    if (now != m_bytes)
        return Saved::Changed;
    return m_file.Rewrite(m_bytes, bytes) ? Saved::Done : Saved::Refused;
}

XmlFile::State XmlFile::GetState() const
{
    return m_state;
}

wxString XmlFile::WhyNotReadable(const wxString& shownPath) const
{
    return m_error.message.empty() ? m_file.GetFailure().Describe(shownPath) : m_error.Describe();
}

RegularFile& XmlFile::GetFile()
{
    return m_file;
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

bool XmlFile::IsFaithful() const
{
    return m_isFaithful;
}
