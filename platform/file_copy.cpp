#include "platform/file_copy.h"

#include "platform/regular_file.h"

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
