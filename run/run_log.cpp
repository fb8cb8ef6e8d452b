#include "run/run_log.h"

#include "platform/library_log.h"
#include "platform/path_normal_form.h"
#include "platform/regular_file.h"
#include "platform/standard_folders.h"
#include "platform/unicode_text.h"

#include <exception>
#include <new>

bool RunLogEnabled = true;

namespace
{

std::string FormatLine(const wxString& message, int count)
{
    const wxString line = count == NoCount ? wxString::Format("%s", message)
                                           : wxString::Format("%s count:  %d", message, count);
    const std::string bytes = ToOneLine(line).utf8_string();
    if (bytes.empty() && !line.empty())
        throw std::bad_alloc(); // the library gives an empty text then
    return bytes + "\r\n";
}

class LogFile
{
  public:
    void Append(const std::string& line)
    {
        const PinnedDirectory directory(m_directory, Links::Refuse);
        RegularFile file;
        const RegularFile::Status status = Open(file, directory);
        m_isFirstLine = false;
        if ((status == RegularFile::Status::Open && file.Append(line)) ||
            status == RegularFile::Status::NotThere || m_isReported)
            return;
        ReportError(file.GetFailure().Describe(m_directory + RunLogFileName));
        m_isReported = true;
    }

  private:
    // The first line creates the file or empties it, including a byte-order mark.
    RegularFile::Status Open(RegularFile& file, const PinnedDirectory& directory) const
    {
        const RegularFile::Status status = file.OpenForUpdate(directory, RunLogFileName);
        if (m_isFirstLine && status == RegularFile::Status::Open)
            file.SetLength(0);
        if (m_isFirstLine && status == RegularFile::Status::NotThere &&
            file.CreateNew(directory, RunLogFileName) == RegularFile::Status::Open)
            return RegularFile::Status::Open;
        return status;
    }

    const wxString m_directory = RunLogDirPath();
    bool m_isFirstLine = true;
    bool m_isReported = false; // once for a run
};

} // namespace

wxString RunLogDirPath()
{
    wxFileName directory(GetUserDataFolder() + wxFileName::GetPathSeparator());
    directory.AppendDir(L"ORX_Installers");
    directory.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return directory.GetPath(wxPATH_GET_VOLUME) + wxFileName::GetPathSeparator();
}

void RunLog(const wxString& message, int count)
{
    if (!RunLogEnabled)
        return;
    try
    {
        static LogFile log;
        log.Append(FormatLine(message, count));
    }
    catch (const std::exception&)
    {
        return; // without memory for it, the line is left out
    }
}
