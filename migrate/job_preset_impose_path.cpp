#include "migrate/job_preset_impose_path.h"

#include "migrate/install_locations.h"
#include "migrate/job_preset_files.h"
#include "migrate/preset_text.h"
#include "run/run_log.h"

#include <wx/filename.h>

namespace
{

// Opened for update before it is read, so that one handle serves both. If both fail, only the fault
// in the content is logged.
void UpdatePreset(JobPresetFile& preset, const wxString& from, const wxString& to)
{
    const wxString& path = preset.GetPath();
    if (preset.OpenForReading() != RegularFile::Status::Open)
    {
        RunLog("Unable to open preset.xml for read : " + path);
        return;
    }
    RegularFile& file = preset.GetFile();
    const RegularFile::Status status = file.ReopenForUpdate();
    std::string before;
    RewrittenPreset after;
    if (file.Read(before))
        after = RewritePreset(before, from, to);
    else
        after.reasonToStay = "cannot be read";
    if (after.reasonToStay)
        RunLog(wxString::Format("preset.xml left as it is (%s): %s", after.reasonToStay, path));
    else if (status != RegularFile::Status::Open)
    {
        if (status == RegularFile::Status::Refused)
            file.ReportNotReopened(path);
        RunLog("Unable to open preset.xml for write : " + path);
    }
    else
    {
        if (!file.Rewrite(before, after.bytes))
            file.ReportNotWritten(path);
        RunLog("Updated preset.xml  : " + path);
    }
}

// Always makes both lookups, in this order; returns false if either fails.
bool LookUpFolders(wxFileName& previousFolder, wxFileName& defaultFolder)
{
    const bool previousFound = GetPreviousImposeTemplatePath(previousFolder);
    const bool defaultFound = GetDefaultImposeTemplatePath(defaultFolder);
    if (!defaultFound)
        RunLog("Unable to read: Default Impose Template Path");
    if (!previousFound)
        RunLog("Unable to read: Previous Version  Default Impose Template Path");
    return previousFound && defaultFound;
}

} // namespace

void FindJobPresetDirs(wxArrayString& directories)
{
    const wxString root = JobPresetRoot();
    if (!ListJobPresetDirs(root, directories))
        RunLog("Preset dirctory  not exist: " + root);
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
        JobPresetFile preset(directory);
        if (preset.IsThere())
            UpdatePreset(preset, from, to);
    }
}
