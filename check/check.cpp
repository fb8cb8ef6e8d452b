#include "check/check.h"

#include "check/folder_cfg_check.h"
#include "check/folder_icon_check.h"
#include "check/preset_check.h"
#include "check/reach.h"
#include "check/workstation_check.h"
#include "platform/process_rights.h"

#include <wx/datetime.h>
#include <wx/filename.h>

#include <map>

namespace
{

void WriteHead(TemplateFolders& folders, Report& report)
{
    report.Write(wxString("FolderUpgradeCheck ") + PROGRAM_VERSION + ", " +
                 (folders.isUpgrade ? "upgrade" : "downgrade") + ", " +
                 wxDateTime::Now().Format("%Y-%m-%d %H:%M") + ", " + AccountName() + ", " +
                 (IsElevated() ? "elevated" : "not elevated"));
    const auto shown = [](const TemplateFolder& folder)
    {
        return folder.path.empty() ? wxString("(unknown)") : folder.path;
    };
    report.Write("From " + shown(folders.From()) + " to " + shown(folders.To()));
}

// What prevents a run from reaching anything in the private directory.
wxString FindObstacle(const HotFolder& folder)
{
    const wxString obstacle = WhyOutOfReach(folder.path);
    if (!obstacle.empty())
        return "the hot folder " + obstacle;
    const wxString privateDir = folder.directory.Reach(PrivateDirName);
    if (IsLink(privateDir))
        return wxString(PrivateDirName) + ": reached over a link";
    if (wxDirExists(privateDir) && !MayEnter(folder.privateDir))
        return wxString(PrivateDirName) + ": cannot be entered";
    return {};
}

void CheckHotFolder(HotFolder& folder, TemplateCheck& check)
{
    const wxString obstacle = FindObstacle(folder);
    if (!obstacle.empty())
    {
        check.report.Problem(obstacle);
        return;
    }
    CheckFolderCfg(folder, check);
    CheckFolderIcon(folder, check);
}

using Identity = std::pair<std::uint64_t, std::uint64_t>;

// A directory that is listed under two names is checked once.
void CheckHotFolders(const HotFolderList& list, TemplateCheck& check)
{
    std::map<Identity, wxString> known; // identity -> listed path
    for (const wxString& path : list.folders)
    {
        check.report.Begin(path);
        check.report.Attempt({},
                             [&]()
                             {
                                 HotFolder folder(path);
                                 const Identity identity = folder.directory.Identity();
                                 const auto [first, isNew] = known.emplace(identity, path);
                                 if (isNew || identity == Identity())
                                     CheckHotFolder(folder, check);
                                 else
                                     check.report.Note("the same directory as " +
                                                       Shown(first->second));
                             });
    }
}

} // namespace

void CheckRun(TemplateFolders& folders, Report& report)
{
    WriteHead(folders, report);
    TemplateCheck check{folders, report};
    report.Begin("Workstation");
    CheckAccount(report);
    check.CheckPreviousFolder();
    const HotFolderList list = LoadHotFolderList();
    CheckHotFolderList(list, report);
    CheckRunLog(report);
    CheckHotFolders(list, check);
    report.Begin("Job presets");
    CheckPresets(check);
    report.Begin("Templates");
    check.ReportAwaited();
}
