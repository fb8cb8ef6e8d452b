#include "platform/regular_file.h"

#include <wx/intl.h>
#include <wx/log.h>

namespace
{

wxString Words(FailedCall::Kind kind)
{
    switch (kind)
    {
    case FailedCall::Kind::Open:
        return _("can't open file '%s'");
    case FailedCall::Kind::List:
        return _("Cannot enumerate files in directory '%s'");
    case FailedCall::Kind::Read:
        return _("can't read from file '%s'");
    case FailedCall::Kind::Write:
        break;
    }
    return _("can't write to file '%s'");
}

} // namespace

FailedCall FailedCall::Now(Kind kind)
{
    return {kind, wxSysErrorCode()};
}

wxString FailedCall::Describe(const wxString& shownPath) const
{
    return wxString::Format(Words(kind), shownPath) + wxString::Format(_(" (error %ld: %s)"),
                                                                       static_cast<long>(error),
                                                                       wxSysErrorMsgStr(error));
}

RegularFile::~RegularFile()
{
    Close();
}

RegularFile::Status RegularFile::OpenForReading(const wxString& path)
{
    return Open(path, Links::Follow, false);
}

RegularFile::Status RegularFile::OpenForReading(const PinnedDirectory& directory,
                                                const wxString& name)
{
    return Open(directory.Reach(name), Links::Refuse, false);
}

RegularFile::Status RegularFile::OpenForUpdate(const PinnedDirectory& directory,
                                               const wxString& name)
{
    return Open(directory.Reach(name), Links::Refuse, true);
}

bool RegularFile::Read(std::string& bytes, std::int64_t most) const
{
    const std::int64_t length = Length();
    bool isRead = length >= 0 && length <= most;
    bytes.resize(isRead ? static_cast<size_t>(length) : 0);
    for (size_t done = 0; isRead && done < bytes.size();)
    {
        const size_t count =
            ReadSome(static_cast<std::int64_t>(done), &bytes[done], bytes.size() - done);
        done += count;
        isRead = count > 0;
    }
    if (!isRead)
        m_failure = FailedCall::Now(FailedCall::Kind::Read);
    return isRead;
}

bool RegularFile::Write(std::int64_t offset, const std::string& bytes)
{
    for (size_t done = 0; done < bytes.size();)
    {
        const size_t count =
            WriteSome(offset + static_cast<std::int64_t>(done), &bytes[done], bytes.size() - done);
        if (count == 0)
            return false;
        done += count;
    }
    return true;
}

bool RegularFile::Rewrite(const std::string& before, const std::string& after, Wait wait)
{
    const auto oldLength = static_cast<std::int64_t>(before.size());
    const auto newLength = static_cast<std::int64_t>(after.size());
    const bool isShorter = newLength < oldLength;
    const std::string filled =
        isShorter ? after + std::string(before.size() - after.size(), '\n') : std::string();
    if (newLength > oldLength && !Reserve(oldLength, newLength - oldLength))
    {
        m_failure = FailedCall::Now(FailedCall::Kind::Write);
        return false;
    }
    // Another program may have made it longer a moment ago.
    if (Write(0, isShorter ? filled : after) && (Length() == newLength || SetLength(newLength)))
    {
        if (wait == Wait::ForDisk)
            WaitForDisk();
        return true;
    }
    m_failure = FailedCall::Now(FailedCall::Kind::Write);
    Write(0, before);
    SetLength(oldLength);
    return false;
}

bool RegularFile::Append(const std::string& bytes)
{
    const std::int64_t length = Length();
    if (length >= 0 && Write(length, bytes))
        return true;
    m_failure = FailedCall::Now(FailedCall::Kind::Write);
    if (length >= 0)
        SetLength(length);
    return false;
}

const FailedCall& RegularFile::GetFailure() const
{
    return m_failure;
}
