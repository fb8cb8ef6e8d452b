#include "run/run_log.h"

#include "platform/standard_folders.h"
#include "platform/unicode_text.h"

#include <wx/convauto.h>
#include <wx/filename.h>
#include <wx/textfile.h>

bool RunLogEnabled = true;

namespace
{

const char* const LogDirName = "ORX_Installers";
const char* const LogFileName = "UpgradeDowngrade.log";

// What the library calls wxPATH_NORM_ALL: everything but the letter case.
constexpr int NormalizeAll = wxPATH_NORM_ENV_VARS | wxPATH_NORM_DOTS | wxPATH_NORM_TILDE |
                             wxPATH_NORM_ABSOLUTE | wxPATH_NORM_LONG | wxPATH_NORM_SHORTCUT;

// Where the folder is missing, or a folder bears the log's name, the library would log an error:
// on Windows a message box that holds an unattended installer up.
void CreateEmptyLog(const wxFileName& directory, const wxString& path)
{
    if (!directory.DirExists() || wxDirExists(path))
        return;
    wxTextFile file(path);
    if (!file.Exists())
        file.Create();
    if (wxFileExists(path) && file.Open(wxConvAuto()))
    {
        file.Clear();
        file.Write(wxTextFileType_None, wxConvAuto());
        file.Close();
    }
}

wxString PrepareLog()
{
    wxFileName directory(GetUserDataFolder() + wxFileName::GetPathSeparator());
    directory.AppendDir(LogDirName);
    directory.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    const wxString path =
        directory.GetPath(wxPATH_GET_VOLUME) + wxFileName::GetPathSeparator() + LogFileName;
    CreateEmptyLog(directory, path);
    return path;
}

const wxString& RunLogPath()
{
    static const wxString path = PrepareLog();
    return path;
}

} // namespace

void RunLog(const wxString& message, int count)
{
    if (!RunLogEnabled)
        return;
    const wxString& path = RunLogPath();
    if (!wxFileExists(path))
        return;
    wxTextFile file(path);
    if (!file.Open(wxConvAuto()))
        return;
    const wxString line = count == NoCount ? wxString::Format("%s", message)
                                           : wxString::Format("%s count:  %d", message, count);
    // One character that does not encode would cost the library all lines, not only its own.
    file.AddLine(ToUnicodeText(line), wxTextFileType_Dos);
    file.Write(wxTextFileType_None, wxConvAuto());
    file.Close();
}
