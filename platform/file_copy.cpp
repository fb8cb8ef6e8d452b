#include "platform/file_copy.h"

std::optional<FailedCall> CopyOver(const wxString& source, const PinnedDirectory& directory,
                                   const wxString& name)
{
    RegularFile from;
    RegularFile to;
    if (from.OpenForReading(source) != RegularFile::Status::Open)
        return from.GetFailure();
    RegularFile::Status status = to.OpenForUpdate(directory, name);
    if (status == RegularFile::Status::Refused)
        status = to.Replace(directory, name);
    if (status != RegularFile::Status::Open || !to.TakeContent(from))
        return to.GetFailure();
    to.TakeAttributes(from);
    return {};
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
    std::string found;
    return from.OpenForReading(source) == RegularFile::Status::Open &&
           to.OpenForReading(directory, name) == RegularFile::Status::Open &&
           to.HasAttributesOf(from) && to.Length() == from.Length() && from.Read(wanted) &&
           to.Read(found) && found == wanted;
}
