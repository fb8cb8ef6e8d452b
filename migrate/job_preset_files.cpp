#include "migrate/job_preset_files.h"

#include "platform/standard_folders.h"

#include <wx/dir.h>
#include <wx/filename.h>

namespace
{

const char* const DataDirName = "ORX";
const char* const PresetRootName = "JPData";
const char* const PresetDirName = "Presets";
const char* const PresetFileName = "presets.xml";

// Collects the sub-directories of the directory being traversed, without entering them.
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

} // namespace

wxString JobPresetRoot()
{
    wxFileName root(GetUserDataFolder() + wxFileName::GetPathSeparator());
    root.AppendDir(DataDirName);
    root.AppendDir(PresetRootName);
    return root.GetFullPath();
}

bool ListJobPresetDirs(const wxString& root, wxArrayString& directories)
{
    if (!wxFileName::DirExists(root))
        return false;
    const wxDir directory(root);
    wxDirTraverserSimple collector(directories);
    if (directory.IsOpened())
        directory.Traverse(collector, wxString(), wxDIR_FILES | wxDIR_DIRS | wxDIR_HIDDEN);
    return true;
}

JobPresetFile::JobPresetFile(const wxString& directory)
    : m_path(PresetPath(directory)), m_directory(directory, Links::Follow),
      m_presets(m_directory.Reach(PresetDirName), Links::Refuse),
      m_isLinked(IsLink(m_directory.Reach(PresetDirName)))
{
}

const wxString& JobPresetFile::GetPath() const
{
    return m_path;
}

bool JobPresetFile::IsThere() const
{
    return m_isLinked || wxFileName::Exists(m_presets.Reach(PresetFileName),
                                            wxFILE_EXISTS_ANY | wxFILE_EXISTS_NO_FOLLOW);
}

RegularFile::Status JobPresetFile::OpenForReading()
{
    const RegularFile::Status status =
        m_file.OpenForReading(m_presets.Reach(PresetFileName), Links::Refuse);
    if (status == RegularFile::Status::Refused)
        ReportNotOpened(m_path);
    return status;
}

RegularFile& JobPresetFile::GetFile()
{
    return m_file;
}
