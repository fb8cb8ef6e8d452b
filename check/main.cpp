// FolderUpgradeCheck: what a run of FolderUpgrade would change, and what stands in its way. Only
// reads.
#include "check/hot_folder_check.h"
#include "check/library_errors.h"
#include "check/preset_check.h"
#include "check/report.h"
#include "check/template_folders.h"
#include "check/workstation_check.h"
#include "platform/process_rights.h"
#include "platform/standard_output.h"

#include <wx/app.h>
#include <wx/datetime.h>

#include <set>

namespace
{

// The exit statuses; the greatest that applies.
constexpr int NothingToDo = 0;
constexpr int HasChanges = 1;
constexpr int HasProblems = 2;
constexpr int WrongCall = 3;

void WriteHead(const TemplateFolders& folders, Report& report)
{
    report.Head(wxString("FolderUpgradeCheck ") + PROGRAM_VERSION + ", " +
                (folders.IsUpgrade() ? "upgrade" : "downgrade") + ", " +
                wxDateTime::Now().Format("%Y-%m-%d %H:%M") + ", " + AccountName() + ", " +
                (IsElevated() ? "elevated" : "not elevated"));
    const auto orUnknown = [](const wxString& folder)
    {
        return folder.empty() ? wxString("(unknown)") : folder;
    };
    report.Head("From " + orUnknown(folders.From()) + " to " + orUnknown(folders.To()));
}

// A directory that is listed under two names is looked at once.
void CheckHotFolders(const HotFolderList& list, const TemplateFolders& folders, Report& report)
{
    std::set<std::pair<std::uint64_t, std::uint64_t>> known;
    for (const wxString& hotFolder : list.folders)
    {
        report.Begin(hotFolder);
        const auto identity = PinnedDirectory(hotFolder, Links::Follow).Identity();
        if (identity != std::pair<std::uint64_t, std::uint64_t>() && !known.insert(identity).second)
            report.Note("the same directory as one above, under another name");
        else
            CheckHotFolder(hotFolder, folders, report);
    }
}

int Check(bool isUpgrade, const wxString& fileName)
{
    KeepLibraryErrors();
    const TemplateFolders folders(isUpgrade);
    Report report(fileName);
    WriteHead(folders, report);
    report.Begin("Workstation");
    const HotFolderList list = LoadHotFolderList();
    CheckHotFolderList(list, report);
    CheckRunLog(report);
    CheckHotFolders(list, folders, report);
    report.Begin("Job presets");
    CheckPresets(folders, report);
    if (!report.End() || report.GetProblems() > 0)
        return HasProblems;
    return report.GetChanges() > 0 ? HasChanges : NothingToDo;
}

class FolderUpgradeCheckApp : public wxAppConsole
{
  public:
    // The base class would look at the command line itself.
    bool OnInit() override
    {
        return true;
    }

    int OnRun() override
    {
        const bool isUpgrade = argc > 1 && argv[1].CmpNoCase("I") == 0;
        const bool isDowngrade = argc > 1 && argv[1].CmpNoCase("U") == 0;
        if ((isUpgrade || isDowngrade) && argc <= 3)
            return Check(isUpgrade, argc == 3 ? argv[2] : wxString());
        WriteStandardError("Usage: FolderUpgradeCheck I|U [FILE]\n"
                           "Says what FolderUpgrade with the same switch would change, and what "
                           "stands in its way.\n"
                           "Exit status: 0 nothing, 1 changes, 2 problems, 3 wrong call.\n");
        return WrongCall;
    }
};

} // namespace

wxIMPLEMENT_APP_CONSOLE(FolderUpgradeCheckApp);
