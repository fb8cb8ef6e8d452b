#include "store/xml_file.h"

XmlFile::XmlFile(const XmlLimits& itsLimits) : limits(itsLimits)
{
}

// Most of the time of a run is the parser's, and the steps of a hot folder read the same file one
// after another. The same bytes make the same document.
XmlFile::State XmlFile::Load(RegularFile::Status opened)
{
    const std::string bytesBefore = std::move(bytes);
    std::unique_ptr<const wxXmlDocument> documentBefore = std::move(document);
    bytes.clear();
    state = State::Loaded;
    if (opened != RegularFile::Status::Open)
        state = opened == RegularFile::Status::Refused ? State::NotReadable : State::Missing;
    else if (file.Length() > limits.bytes)
        state = State::TooLarge;
    else if (!file.Read(bytes, limits.bytes)) // it may have grown meanwhile
        state = file.Length() > limits.bytes ? State::TooLarge : State::NotReadable;
    if (state == State::Loaded && documentBefore && bytes == bytesBefore)
    {
        document = std::move(documentBefore);
        return state;
    }
    documentBefore = nullptr; // another one takes its memory
    error = {};
    if (state != State::Loaded)
        return state;
    auto parsed = std::make_unique<wxXmlDocument>();
    const XmlLook look = LoadXml(bytes, limits, *parsed);
    error = look.error;
    isFaithful = look.isFaithful;
    if (!look.isWithinLimits)
        state = State::TooLarge;
    else if (!parsed->IsOk())
        state = State::NotReadable;
    else
        document = std::move(parsed);
    return state;
}

XmlFile::Saved XmlFile::Save(const std::string& newBytes)
{
    const RegularFile::Status reopened = file.ReopenForUpdate();
    if (reopened == RegularFile::Status::Refused)
        return Saved::Refused;
    std::string now;
    if (reopened != RegularFile::Status::Open || !file.Read(now, limits.bytes))
        return Saved::NotReadAgain;
    if (now != bytes)
        return Saved::Changed;
    return file.Rewrite(bytes, newBytes) ? Saved::Done : Saved::Refused;
}

wxString XmlFile::WhyNotReadable(const wxString& shownPath) const
{
    return error.message.empty() ? file.GetFailure().Describe(shownPath) : error.Describe();
}

const wxXmlNode* XmlFile::Root() const
{
    return document ? document->GetRoot() : nullptr;
}
