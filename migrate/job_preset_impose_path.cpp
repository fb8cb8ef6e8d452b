#include "migrate/job_preset_impose_path.h"

#include "migrate/install_locations.h"
#include "migrate/job_preset_files.h"
#include "migrate/preset_text.h"
#include "run/run_log.h"

#include <wx/filename.h>

namespace
{

struct Rewriting
{
    std::string before;
    RewrittenPreset after;
    bool isDecided = false;
};

// Decides about the current content of the file. If the file has to stay as it is, logs a line and
// returns false.
bool Decide(JobPresetFile& preset, const wxString& from, const wxString& to, Rewriting& rewriting)
{
    std::string now;
    const char* reason = "cannot be read";
    if (preset.GetFile().Read(now))
    {
        if (!rewriting.isDecided || now != rewriting.before)
        {
            rewriting.before.swap(now);
            rewriting.after = RewritePreset(rewriting.before, from, to);
            rewriting.isDecided = true;
        }
        reason = rewriting.after.reasonToStay;
    }
    if (reason)
        RunLog(wxString::Format("preset.xml left as it is (%s): %s", reason, preset.GetPath()));
    return !reason;
}

void UpdatePreset(JobPresetFile& preset, const wxString& from, const wxString& to)
{
    const wxString& path = preset.GetPath();
    Rewriting rewriting;
    if (preset.OpenForReading() != RegularFile::Status::Open)
        RunLog("Unable to open preset.xml for read : " + path);
    else if (!Decide(preset, from, to, rewriting))
        return;
    else if (preset.ReopenForUpdate() != RegularFile::Status::Open)
        RunLog("Unable to open preset.xml for write : " + path);
    else if (Decide(preset, from, to, rewriting)) // it may have changed meanwhile
    {
        if (!preset.GetFile().Rewrite(rewriting.before, rewriting.after.bytes))
            preset.GetFile().ReportNotWritten(path);
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
