#include "check/check.h"

#include "check/hot_folder_check.h"
#include "check/preset_check.h"
#include "check/template_folders_check.h"
#include "check/workstation_check.h"
#include "platform/process_rights.h"

#include <wx/datetime.h>

#include <map>

namespace
{

void WriteHead(TemplateFolders& folders, Report& report)
{
    report.Head(wxString("FolderUpgradeCheck ") + PROGRAM_VERSION + ", " +
                (folders.IsUpgrade() ? "upgrade" : "downgrade") + ", " +
                wxDateTime::Now().Format("%Y-%m-%d %H:%M") + ", " + AccountName() + ", " +
                (IsElevated() ? "elevated" : "not elevated"));
    const auto shown = [](const TemplateFolder& folder)
    {
        return folder.path.empty() ? wxString("(unknown)") : folder.path;
    };
    report.Head("From " + shown(folders.From()) + " to " + shown(folders.To()));
}

// A directory that is listed under two names is checked once.
void CheckHotFolders(const HotFolderList& list, TemplateFolders& folders, TemplateCheck& templates,
                     Report& report)
{
    std::map<std::pair<std::uint64_t, std::uint64_t>, size_t> known; // identity -> position
    for (size_t i = 0; i < list.folders.size(); ++i)
    {
        const wxString& hotFolder = list.folders[i];
        report.Begin(hotFolder);
        HotFolder folder(hotFolder);
        const auto identity = folder.directory.Identity();
        const auto [first, isNew] = known.emplace(identity, i);
        if (isNew || identity == std::pair<std::uint64_t, std::uint64_t>())
            CheckHotFolder(folder, folders, templates, report);
        else
            report.Note("the same directory as " + Shown(list.folders[first->second]));
    }
}

} // namespace

void CheckRun(TemplateFolders& folders, Report& report)
{
    WriteHead(folders, report);
    report.Begin("Workstation");
    CheckAccount(report);
    CheckPreviousFolder(folders, report);
    const HotFolderList list = LoadHotFolderList();
    CheckHotFolderList(list, report);
    CheckRunLog(report);
    TemplateCheck templates(folders);
    CheckHotFolders(list, folders, templates, report);
    report.Begin("Job presets");
    CheckPresets(folders, templates, report);
    report.Begin("Templates");
    if (templates.GetAwaited() > 0)
        report.Note(wxString::Format(
            "there is no folder %s yet; templates that will be looked for in it: %zu",
            folders.To().path, templates.GetAwaited()));
}
