#include "platform/regular_file.h"

#include <wx/intl.h>
#include <wx/log.h>

#include <algorithm>

RegularFile::~RegularFile()
{
    Close();
}

RegularFile::Status RegularFile::OpenForReading(const wxString& path, Links links)
{
    return Open(path, links, false);
}

RegularFile::Status RegularFile::OpenForUpdate(const wxString& path, Links links)
{
    return Open(path, links, true);
}

RegularFile::Status RegularFile::GetStatus() const
{
    return m_status;
}

bool RegularFile::Rewrite(const std::string& before, const std::string& after, Wait wait)
{
    const auto oldLength = static_cast<std::int64_t>(before.size());
    const auto newLength = static_cast<std::int64_t>(after.size());
    // Another program may have made it longer a moment ago.
    const auto longest = static_cast<size_t>(std::max({Length(), oldLength, newLength}));
    if (newLength > oldLength && !Reserve(oldLength, newLength - oldLength))
    {
        m_error = wxSysErrorCode();
        return false;
    }
    const bool isCut = longest > after.size();
    const bool isWritten =
        isCut ? Write(0, after + std::string(longest - after.size(), '\n')) : Write(0, after);
    if (isWritten && (!isCut || SetLength(newLength)))
    {
        if (wait == Wait::ForDisk)
            WaitForDisk();
        return true;
    }
    m_error = wxSysErrorCode();
    Write(0, before);
    SetLength(oldLength);
    return false;
}

void RegularFile::ReportNotWritten(const wxString& shownPath) const
{
    wxLogSysError(static_cast<long>(m_error), _("can't write to file '%s'"), shownPath);
}

bool RegularFile::Append(const std::string& bytes)
{
    const std::int64_t length = Length();
    if (length >= 0 && Write(length, bytes))
        return true;
    m_error = wxSysErrorCode();
    if (length >= 0)
        SetLength(length);
    return false;
}

void ReportNotOpened(const wxString& path)
{
    wxLogSysError(_("can't open file '%s'"), path);
}

void ReportNotRead(const wxString& path)
{
    wxLogSysError(_("can't read from file '%s'"), path);
}
