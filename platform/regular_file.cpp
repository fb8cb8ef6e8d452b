#include "platform/regular_file.h"

#include <wx/intl.h>
#include <wx/log.h>

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

bool RegularFile::Rewrite(const std::string& before, const std::string& after, Wait wait)
{
    const auto oldLength = static_cast<std::int64_t>(before.size());
    const auto newLength = static_cast<std::int64_t>(after.size());
    if (newLength > oldLength && !Reserve(oldLength, newLength - oldLength))
    {
        m_error = wxSysErrorCode();
        return false;
    }
    const bool isShorter = newLength < oldLength;
    const bool isWritten =
        Write(0, isShorter ? after + std::string(before.size() - after.size(), '\n') : after);
    // Another program may have made it longer a moment ago.
    if (isWritten && (Length() == newLength || SetLength(newLength)))
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

void RegularFile::ReportNotReopened(const wxString& shownPath) const
{
    wxLogSysError(static_cast<long>(m_error), _("can't open file '%s'"), shownPath);
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
