#include "platform/file_copy.h"

#include "platform/regular_file.h"

#include <unistd.h>

bool CopyOver(const wxString& source, const wxString& destination)
{
    RegularFile from;
    RegularFile to;
    std::string before;
    std::string after;
    if (from.OpenForReading(source, Links::Follow) != RegularFile::Status::Open ||
        !from.Read(after))
        return false;
    RegularFile::Status status = to.OpenForUpdate(destination, Links::Refuse);
    if (status == RegularFile::Status::Refused && unlink(destination.utf8_str()) == 0)
        status = to.CreateNew(destination);
    if (status != RegularFile::Status::Open)
        return false;
    if (!to.Read(before))
    {
        // Too long for an icon: nothing that is worth to be put back.
        before.clear();
        to.SetLength(0);
    }
    if (!to.Rewrite(before, after, RegularFile::Wait::ForNothing))
        return false;
    to.TakeAttributes(from);
    return true;
}

bool MayCopyOver(const wxString& source, const wxString& destination)
{
    RegularFile from;
    RegularFile to;
    if (from.OpenForReading(source, Links::Follow) != RegularFile::Status::Open)
        return false;
    const RegularFile::Status status = to.OpenForUpdate(destination, Links::Refuse);
    // What cannot be written is replaced.
    return status == RegularFile::Status::Open ||
           (status == RegularFile::Status::Refused &&
            access(destination.BeforeLast('/').utf8_str(), W_OK | X_OK) == 0);
}
