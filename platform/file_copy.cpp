#include "platform/file_copy.h"

#include "platform/regular_file.h"

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
    if (status == RegularFile::Status::Refused)
        status = to.Replace(destination);
    if (status != RegularFile::Status::Open)
        return false;
    if (!to.Read(before))
    {
        // Too long for an icon, so not worth restoring.
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
    return status == RegularFile::Status::Open ||
           (status == RegularFile::Status::Refused && RegularFile::MayReplace(destination));
}

bool IsCopy(const wxString& source, const wxString& destination)
{
    RegularFile from;
    RegularFile to;
    std::string wanted;
    std::string there;
    return from.OpenForReading(source, Links::Follow) == RegularFile::Status::Open &&
           to.OpenForReading(destination, Links::Refuse) == RegularFile::Status::Open &&
           to.HasAttributesOf(from) && from.Read(wanted) && to.Read(there) && wanted == there;
}
