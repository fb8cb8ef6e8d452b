#include "migrate/job_preset_impose_path.h"

#include "run/run_log.h"
#include "migrate/install_locations.h"
#include "migrate/preset_text.h"
#include "platform/standard_folders.h"
#include "platform/unicode_text.h"

#include <wx/convauto.h>
#include <wx/dir.h>
#include <wx/ffile.h>
#include <wx/filename.h>
#include <wx/textbuf.h>

#include <string>

namespace
{

const char* const DataDirName = "ORX";
const char* const PresetRootName = "JPData";
const char* const PresetDirName = "Presets";
const char* const PresetFileName = "presets.xml";

// Collects the sub-directories of the directory that it traverses, and enters none.
class wxDirTraverserSimple : public wxDirTraverser
{
  public:
    explicit wxDirTraverserSimple(wxArrayString& directories) : m_directories(directories)
    {
    }

    wxDirTraverseResult OnFile(const wxString& /*path*/) override
    {
        return wxDIR_CONTINUE;
    }

    wxDirTraverseResult OnDir(const wxString& path) override
    {
        m_directories.Add(path);
        return wxDIR_IGNORE;
    }

  private:
    wxArrayString& m_directories;
};

wxString PresetPath(const wxString& directory)
{
    wxFileName folder(directory + wxFileName::GetPathSeparator());
    folder.AppendDir(PresetDirName);
    return wxFileName(folder.GetFullPath(), PresetFileName).GetFullPath();
}

// Whether a file of those bytes holds nothing but a byte-order mark, if anything.
bool IsEmptyText(const wxCharBuffer& bytes)
{
    size_t markLength = 0;
    const wxBOM mark = wxConvAuto::DetectBOM(bytes.data(), bytes.length());
    if (mark != wxBOM_None && mark != wxBOM_Unknown)
        wxConvAuto::GetBOMChars(mark, &markLength);
    // Two bytes alone may be the beginning of another mark, but then there is no text either.
    return bytes.length() == markLength ||
           (mark == wxBOM_Unknown && std::string(bytes.data(), bytes.length()) == "\xFF\xFE");
}

bool ReadBytes(wxFFile& file, wxCharBuffer& bytes)
{
    const wxFileOffset length = file.Length();
    if (length < 0)
        return false;
    bytes = wxCharBuffer(static_cast<size_t>(length));
    bytes.shrink(file.Read(bytes.data(), bytes.length()));
    return !file.Error() && bytes.length() == static_cast<size_t>(length);
}

// Returns why the file has to stay as it is, or nothing. The bytes are read as they are and line
// ends treated as text mode does, where the system has one: text mode itself would end the file at
// the first Ctrl-Z, and see line ends inside UTF-16.
const char* ReadPreset(wxFFile& file, wxString& text)
{
    wxCharBuffer bytes;
    if (!ReadBytes(file, bytes))
        return "cannot be read";
    if (IsEmptyText(bytes))
        return nullptr;
    wxString(bytes, wxConvAuto()).swap(text); // to assign it would copy it
    if (text.empty())
        return "cannot be decoded";
    if (wxTextBuffer::typeDefault == wxTextFileType_Dos)
        text.Replace("\r\n", "\n");
    return IsUnicodeText(text) ? nullptr : "cannot be encoded again";
}

// A file that did not close well counts as open for the library, which then closes it once more.
void CloseOnce(wxFFile& file)
{
    if (!file.Close())
        file.Detach();
}

void UpdatePreset(const wxString& path, const wxString& from, const wxString& to)
{
    wxFFile file;
    if (!wxFileExists(path) || !file.Open(path, "rb"))
        return RunLog("Unable to open preset.xml for read : " + path, NoCount);
    wxString text;
    if (const char* reason = ReadPreset(file, text))
        return RunLog(wxString::Format("preset.xml left as it is (%s): %s", reason, path), NoCount);
    MovePresetPaths(text, from, to);
    CloseOnce(file);
    const wxScopedCharBuffer bytes = text.utf8_str(); // before the file is emptied

    if (!file.Open(path, "w"))
        return RunLog("Unable to open preset.xml for write : " + path, NoCount);
    file.Write(bytes.data(), bytes.length());
    CloseOnce(file);
    RunLog("Updated preset.xml  : " + path, NoCount);
}

// Both lookups are always made, in this order; false when one failed.
bool LookUpFolders(wxFileName& previous, wxFileName& current)
{
    const bool previousFound = GetPreviousImposeTemplatePath(previous);
    const bool defaultFound = GetDefaultImposeTemplatePath(current);
    if (!defaultFound)
        RunLog(NoDefaultPathMessage, NoCount);
    if (!previousFound)
        RunLog(NoPreviousPathMessage, NoCount);
    return previousFound && defaultFound;
}

} // namespace

void FindJobPresetDirs(wxArrayString& directories)
{
    wxFileName root(GetUserDataFolder() + wxFileName::GetPathSeparator());
    root.AppendDir(DataDirName);
    root.AppendDir(PresetRootName);
    if (!root.DirExists())
    {
        RunLog("Preset dirctory  not exist: " + root.GetFullPath(), NoCount);
        return;
    }
    const wxDir directory(root.GetFullPath());
    wxDirTraverserSimple collector(directories);
    if (directory.IsOpened())
        directory.Traverse(collector, wxString(), wxDIR_FILES | wxDIR_DIRS | wxDIR_HIDDEN);
}

void UpdateJobPresetImposePath(const FolderUpgradeApp& app)
{
    wxArrayString directories;
    FindJobPresetDirs(directories);
    wxFileName previousFolder;
    wxFileName defaultFolder;
    if (!LookUpFolders(previousFolder, defaultFolder))
        return;

    const wxString from = (app.m_isUpgrade ? previousFolder : defaultFolder).GetFullPath();
    const wxString to = (app.m_isUpgrade ? defaultFolder : previousFolder).GetFullPath();
    for (const wxString& directory : directories)
    {
        const wxString path = PresetPath(directory);
        if (wxFileName::Exists(path, wxFILE_EXISTS_ANY))
            UpdatePreset(path, from, to);
    }
}
