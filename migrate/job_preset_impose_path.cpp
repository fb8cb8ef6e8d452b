#include "migrate/job_preset_impose_path.h"

#include "migrate/job_preset_files.h"
#include "migrate/template_folders.h"
#include "platform/library_log.h"
#include "run/attempt.h"

namespace
{

// Opened for update before it is read, so that one handle serves both. If both fail, only the fault
// in the content is logged.
void UpdatePreset(JobPresetFile& preset, const wxString& from, const wxString& to)
{
    const wxString& path = preset.path;
    RegularFile& file = preset.file;
    const RegularFile::Status opened = preset.OpenForReading();
    if (opened != RegularFile::Status::Open)
    {
        if (opened == RegularFile::Status::Refused)
            ReportError(file.GetFailure().Describe(path));
        RunLog("Unable to open preset.xml for read : " + path);
        return;
    }
    const RegularFile::Status reopened = file.ReopenForUpdate();
    const FailedCall reopening = file.GetFailure();
    const RewrittenPreset rewritten = preset.Decide(from, to);
    if (rewritten.reasonToStay)
        RunLog(wxString::Format("preset.xml left as it is (%s): %s", rewritten.reasonToStay, path));
    else if (reopened != RegularFile::Status::Open)
    {
        if (reopened == RegularFile::Status::Refused)
            ReportError(reopening.Describe(path));
        RunLog("Unable to open preset.xml for write : " + path);
    }
    else
    {
        if (!file.Rewrite(rewritten.before, rewritten.bytes))
            ReportError(file.GetFailure().Describe(path));
        RunLog("Updated preset.xml  : " + path);
    }
}

// Always makes both lookups, in this order; returns false if either fails.
bool LookUp(TemplateFolders& folders)
{
    const bool previousFound = folders.Previous().isKnown;
    const bool defaultFound = folders.Default().isKnown;
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
    const JobPresetDirs found = ListJobPresetDirs(root);
    if (!found.isThere)
        RunLog("Preset dirctory  not exist: " + root);
    if (found.failure)
        ReportError(found.failure->Describe(root));
    for (const wxString& path : found.paths)
        directories.Add(path);
}

void UpdateJobPresetImposePath(const FolderUpgradeApp& app)
{
    wxArrayString directories;
    FindJobPresetDirs(directories);
    TemplateFolders folders(app.m_isUpgrade);
    if (!LookUp(folders))
        return;
    for (const wxString& directory : directories)
    {
        JobPresetFile preset(directory);
        if (preset.IsThere())
            Attempt(L"preset.xml", preset.path,
                    [&]() { UpdatePreset(preset, folders.From().path, folders.To().path); });
    }
}
