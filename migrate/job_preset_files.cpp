#include "migrate/job_preset_files.h"

#include "platform/access_rights.h"
#include "platform/memory.h"
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

wxString PathIn(const wxString& directory)
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

JobPresetDirs ListJobPresetDirs(const wxString& root)
{
    JobPresetDirs directories;
    directories.isThere = wxFileName::DirExists(root);
    if (directories.isThere)
        directories.failure = WhyNotListed(root); // the library would report it by itself
    if (!directories.isThere || directories.failure)
        return directories;
    const wxDir directory(root);
    wxDirTraverserSimple collector(directories.paths);
    if (directory.IsOpened())
        directory.Traverse(collector, wxString(), wxDIR_FILES | wxDIR_DIRS | wxDIR_HIDDEN);
    return directories;
}

JobPresetFile::JobPresetFile(const wxString& itsDirectory)
    : path(PathIn(itsDirectory)), directory(itsDirectory, Links::Follow),
      presetDir(directory.Reach(PresetDirName), Links::Refuse),
      isLinked(IsLink(directory.Reach(PresetDirName)))
{
}

bool JobPresetFile::IsThere() const
{
    return isLinked || wxFileName::Exists(presetDir.Reach(PresetFileName),
                                          wxFILE_EXISTS_ANY | wxFILE_EXISTS_NO_FOLLOW);
}

RegularFile::Status JobPresetFile::OpenForReading()
{
    return file.OpenForReading(presetDir, PresetFileName);
}

RewrittenPreset JobPresetFile::Decide(const wxString& from, const wxString& to)
{
    // As it is, as wide characters twice, and one byte to spare.
    constexpr std::uint64_t MemoryForEachByte = 10;
    std::string before;
    RewrittenPreset preset;
    const std::int64_t length = file.Length();
    if (length > 0 && length <= LongestFile)
        RequireMemory(static_cast<std::uint64_t>(length) * MemoryForEachByte);
    if (file.Read(before))
        preset = RewritePreset(before, from, to);
    else
        preset.reasonToStay = L"cannot be read";
    preset.before.swap(before);
    return preset;
}
