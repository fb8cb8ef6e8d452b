#include "platform/file_copy.h"

#include "platform/regular_file.h"

bool CopyOver(const wxString& source, const PinnedDirectory& directory, const wxString& name)
{
    RegularFile from;
    RegularFile to;
    std::string before;
    std::string after;
    if (from.OpenForReading(source) != RegularFile::Status::Open || !from.Read(after))
        return false;
    RegularFile::Status status = to.OpenForUpdate(directory, name);
    if (status == RegularFile::Status::Refused)
        status = to.Replace(directory, name);
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

bool MayCopyOver(const wxString& source, const PinnedDirectory& directory, const wxString& name)
{
    RegularFile from;
    RegularFile to;
    if (from.OpenForReading(source) != RegularFile::Status::Open)
        return false;
    const RegularFile::Status status = to.OpenForUpdate(directory, name);
    return status == RegularFile::Status::Open ||
           (status == RegularFile::Status::Refused && RegularFile::MayReplace(directory));
}

bool IsCopy(const wxString& source, const PinnedDirectory& directory, const wxString& name)
{
    RegularFile from;
    RegularFile to;
    std::string wanted;
    std::string there;
    return from.OpenForReading(source) == RegularFile::Status::Open &&
           to.OpenForReading(directory, name) == RegularFile::Status::Open &&
           to.HasAttributesOf(from) && from.Read(wanted) && to.Read(there) && wanted == there;
}
