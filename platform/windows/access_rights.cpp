#include "platform/access_rights.h"

#include "platform/system.h"

namespace
{

bool MayOpen(const wxString& path, DWORD access, DWORD flags)
{
    const HANDLE handle =
        CreateFileW(path.wc_str(), access, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE,
                    nullptr, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS | flags, nullptr);
    if (handle == INVALID_HANDLE_VALUE)
        return false;
    CloseHandle(handle);
    return true;
}

} // namespace

bool MayChangeAttributes(const wxString& path)
{
    return MayOpen(path, FILE_WRITE_ATTRIBUTES, FILE_FLAG_OPEN_REPARSE_POINT);
}

bool MayCreateIn(const wxString& directory)
{
    return MayOpen(directory, FILE_ADD_FILE, 0);
}

std::optional<FailedCall> WhyNotListed(const wxString& directory)
{
    if (MayOpen(directory, FILE_LIST_DIRECTORY, 0))
        return {};
    return FailedCall::Now(FailedCall::List);
}
