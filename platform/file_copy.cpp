#include "platform/file_copy.h"

#include "platform/access_rights.h"

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

std::optional<FailedCall> WhyNotCopied(const wxString& source, const PinnedDirectory& directory,
                                       const wxString& name)
{
    RegularFile from;
    RegularFile to;
    if (from.OpenForReading(source) != RegularFile::Status::Open)
        return from.GetFailure();
    const RegularFile::Status status = to.OpenForUpdate(directory, name);
    if (status == RegularFile::Status::Open ||
        (status == RegularFile::Status::Refused && RegularFile::CanReplace &&
         MayCreateIn(directory.Reach({}))))
        return {};
    return to.GetFailure();
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
