#include "run/run_log.h"

#include "platform/regular_file.h"
#include "platform/unicode_text.h"
#include "run/run_log_place.h"

bool RunLogEnabled = true;

namespace
{

std::string FormatLine(const wxString& message, int count)
{
    const wxString line = count == NoCount ? wxString::Format("%s", message)
                                           : wxString::Format("%s count:  %d", message, count);
    return ToOneLine(line).utf8_string() + "\r\n";
}

// The first line creates the file or empties it, including a byte-order mark.
RegularFile::Status OpenLog(RegularFile& file, const PinnedDirectory& directory, bool isFirstLine)
{
    const wxString path = directory.Reach(RunLogFileName);
    const RegularFile::Status status = file.OpenForUpdate(path, Links::Refuse);
    if (!isFirstLine)
        return status;
    if (status == RegularFile::Status::NotThere)
        return file.CreateNew(path) == RegularFile::Status::Open ? RegularFile::Status::Open
                                                                 : status;
    if (status == RegularFile::Status::Open)
        file.SetLength(0);
    return status;
}

} // namespace

void RunLog(const wxString& message, int count)
{
    if (!RunLogEnabled)
        return;
    static const wxString directoryPath = RunLogDirPath();
    static bool isFirstLine = true;
    static bool isReported = false;
    const PinnedDirectory directory(directoryPath, Links::Refuse);
    RegularFile file;
    const RegularFile::Status status = OpenLog(file, directory, isFirstLine);
    isFirstLine = false;
    if (status == RegularFile::Status::Open && file.Append(FormatLine(message, count)))
        return;
    if (status == RegularFile::Status::Open && !isReported)
        file.ReportNotWritten(directoryPath + RunLogFileName);
    else if (status == RegularFile::Status::Refused && !isReported)
        ReportNotOpened(directoryPath + RunLogFileName);
    isReported = isReported || status != RegularFile::Status::NotThere;
}
