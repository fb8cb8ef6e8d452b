#include "platform/regular_file.h"

#include <wx/intl.h>
#include <wx/log.h>

#include <array>

FailedCall FailedCall::Now(const char* what)
{
    return {what, wxSysErrorCode()};
}

wxString FailedCall::Describe(const wxString& shownPath) const
{
    return wxString::Format(wxGetTranslation(what), shownPath) + Reason();
}

wxString FailedCall::Reason() const
{
    return wxString::Format(_(" (error %ld: %s)"), static_cast<long>(error),
                            wxSysErrorMsgStr(error));
}

RegularFile::~RegularFile()
{
    Close();
}

RegularFile::Status RegularFile::OpenForReading(const wxString& path)
{
    return Open(nullptr, path, false);
}

RegularFile::Status RegularFile::OpenForReading(const PinnedDirectory& directory,
                                                const wxString& name)
{
    return Open(&directory, directory.Reach(name), false);
}

RegularFile::Status RegularFile::OpenForUpdate(const PinnedDirectory& directory,
                                               const wxString& name)
{
    return Open(&directory, directory.Reach(name), true);
}

bool RegularFile::OpenEmpty(const PinnedDirectory& directory, const wxString& name)
{
    return (OpenForUpdate(directory, name) == Status::Open && SetLength(0)) ||
           CreateNew(directory, name) == Status::Open;
}

size_t RegularFile::ReadAt(std::int64_t offset, char* bytes, size_t count) const
{
    size_t done = 0;
    for (size_t some = 1; some > 0 && done < count; done += some)
        some = ReadSome(offset + static_cast<std::int64_t>(done), bytes + done, count - done);
    return done;
}

bool RegularFile::Write(std::int64_t offset, const char* bytes, size_t count)
{
    size_t done = 0;
    for (size_t some = 1; some > 0 && done < count; done += some)
        some = WriteSome(offset + static_cast<std::int64_t>(done), bytes + done, count - done);
    return done == count;
}

bool RegularFile::Read(std::string& bytes, std::int64_t most) const
{
    const std::int64_t length = Length();
    const bool isShort = length >= 0 && length <= most;
    bytes.resize(isShort ? static_cast<size_t>(length) : 0);
    if (isShort && ReadAt(0, bytes.data(), bytes.size()) == bytes.size())
        return true;
    m_failure = FailedCall::Now(FailedCall::Read);
    return false;
}

bool RegularFile::TakeContent(const RegularFile& source)
{
    const std::int64_t oldLength = Length();
    const std::int64_t newLength = source.Length();
    bool isDone =
        newLength >= 0 && (newLength <= oldLength || Reserve(oldLength, newLength - oldLength));
    std::array<char, size_t{64} * 1024> piece{}; // the file may be too long for the memory
    for (std::int64_t done = 0; isDone && done < newLength;)
    {
        const size_t count = source.ReadAt(done, piece.data(), piece.size());
        isDone = count > 0 && Write(done, piece.data(), count);
        done += static_cast<std::int64_t>(count);
    }
    isDone = isDone && SetLength(newLength);
    if (!isDone)
        m_failure = FailedCall::Now(FailedCall::Write);
    return isDone;
}

bool RegularFile::Rewrite(const std::string& before, const std::string& after)
{
    const auto oldLength = static_cast<std::int64_t>(before.size());
    const auto newLength = static_cast<std::int64_t>(after.size());
    const bool isShorter = newLength < oldLength;
    const std::string filled =
        isShorter ? after + std::string(before.size() - after.size(), '\n') : std::string();
    const std::string& written = isShorter ? filled : after;
    if (newLength > oldLength && !Reserve(oldLength, newLength - oldLength))
    {
        m_failure = FailedCall::Now(FailedCall::Write);
        return false;
    }
    // Another program may have made it longer a moment ago.
    if (Write(0, written.data(), written.size()) && (Length() == newLength || SetLength(newLength)))
    {
        WaitForDisk();
        return true;
    }
    m_failure = FailedCall::Now(FailedCall::Write);
    Write(0, before.data(), before.size());
    SetLength(oldLength);
    return false;
}

bool RegularFile::Append(const std::string& bytes)
{
    const std::int64_t length = Length();
    if (length >= 0 && Write(length, bytes.data(), bytes.size()))
        return true;
    m_failure = FailedCall::Now(FailedCall::Write);
    if (length >= 0)
        SetLength(length);
    return false;
}

const FailedCall& RegularFile::GetFailure() const
{
    return m_failure;
}
