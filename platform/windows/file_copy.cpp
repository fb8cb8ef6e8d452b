#include "platform/file_copy.h"

#include "platform/regular_file.h"

bool CopyOver(const wxString& source, const wxString& destination)
{
    RegularFile from;
    RegularFile to;
    std::string before;
    std::string after;
    if (from.OpenForReading(source, Links::Follow) != RegularFile::Status::Open ||
        !from.Read(after) ||
        to.OpenForUpdate(destination, Links::Refuse) != RegularFile::Status::Open)
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
    return from.OpenForReading(source, Links::Follow) == RegularFile::Status::Open &&
           to.OpenForUpdate(destination, Links::Refuse) == RegularFile::Status::Open;
}
