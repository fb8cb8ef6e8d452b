#include "run/run_log.h"

#include "platform/path_normal_form.h"
#include "platform/regular_file.h"
#include "platform/standard_folders.h"
#include "platform/unicode_text.h"

#include <wx/filename.h>

bool RunLogEnabled = true;

namespace
{

const char* const LogDirName = "ORX_Installers";
const char* const LogFileName = "UpgradeDowngrade.log";

wxString LogDirPath()
{
    wxFileName directory(GetUserDataFolder() + wxFileName::GetPathSeparator());
    directory.AppendDir(LogDirName);
    directory.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return directory.GetPath(wxPATH_GET_VOLUME) + wxFileName::GetPathSeparator();
}

std::string FormatLine(const wxString& message, int count)
{
    const wxString line = count == NoCount ? wxString::Format("%s", message)
                                           : wxString::Format("%s count:  %d", message, count);
    return ToOneLine(line).utf8_string() + "\r\n";
}

// The first line makes the file, or empties it, a byte-order mark included.
RegularFile::Status OpenLog(RegularFile& file, const PinnedDirectory& directory, bool isFirstLine)
{
    const wxString path = directory.Reach(LogFileName);
    const RegularFile::Status status = file.OpenForUpdate(path, Links::Refuse);
    if (!isFirstLine)
        return status;
    if (status == RegularFile::Status::NotThere)
        return file.CreateNew(path) == RegularFile::Status::Open ? RegularFile::Status::Open : status;
    if (status == RegularFile::Status::Open)
        file.SetLength(0);
    return status;
}

} // namespace

void RunLog(const wxString& message, int count)
{
    if (!RunLogEnabled)
        return;
    static const wxString directoryPath = LogDirPath();
    static bool isFirstLine = true;
    static bool isReported = false;
    const PinnedDirectory directory(directoryPath, Links::Refuse);
    RegularFile file;
    const RegularFile::Status status = OpenLog(file, directory, isFirstLine);
    isFirstLine = false;
    if (status == RegularFile::Status::Open && file.Append(FormatLine(message, count)))
        return;
    if (status == RegularFile::Status::Open && !isReported)
        file.ReportNotWritten(directoryPath + LogFileName);
    else if (status == RegularFile::Status::Refused && !isReported)
        ReportNotOpened(directoryPath + LogFileName);
    isReported = isReported || status != RegularFile::Status::NotThere;
}
