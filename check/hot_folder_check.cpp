#include "check/hot_folder_check.h"

#include "check/folder_cfg_check.h"
#include "check/folder_icon_check.h"
#include "check/reach.h"

#include <wx/filename.h>

namespace
{

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

} // namespace

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
