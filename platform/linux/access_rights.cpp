#include "platform/access_rights.h"

#include <sys/stat.h>
#include <unistd.h>

// The owner may change the mode. All attributes of a directory are extended attributes, for which
// write permission is enough.
bool MayChangeAttributes(const wxString& path)
{
    struct stat status = {};
    if (lstat(path.utf8_str(), &status) != 0 || S_ISLNK(status.st_mode))
        return false;
    return geteuid() == 0 || geteuid() == status.st_uid ||
           (S_ISDIR(status.st_mode) && access(path.utf8_str(), W_OK) == 0);
}

bool MayCreateIn(const wxString& directory)
{
    return access(directory.utf8_str(), W_OK | X_OK) == 0;
}

std::optional<FailedCall> WhyNotListed(const wxString& directory)
{
    if (access(directory.utf8_str(), R_OK) == 0)
        return {};
    return FailedCall::Now(FailedCall::List);
}
