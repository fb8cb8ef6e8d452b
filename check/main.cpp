// FolderUpgradeCheck: what a run of FolderUpgrade would change, and what would prevent a change.
// Only reads.
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
#include <wx/debug.h>

#include <map>

namespace
{

// The exit statuses. The highest one that applies is returned.
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

// A directory that is listed under two names is checked once.
void CheckHotFolders(const HotFolderList& list, const TemplateFolders& folders, Report& report)
{
    std::map<std::pair<std::uint64_t, std::uint64_t>, size_t> known; // identity -> position
    for (size_t i = 0; i < list.folders.size(); ++i)
    {
        const wxString& hotFolder = list.folders[i];
        report.Begin(hotFolder);
        const auto identity = PinnedDirectory(hotFolder, Links::Follow).Identity();
        const auto [first, isNew] = known.emplace(identity, i);
        if (isNew || identity == std::pair<std::uint64_t, std::uint64_t>())
            CheckHotFolder(hotFolder, folders, report);
        else
            report.Note("the same directory as " + list.folders[first->second]);
    }
}

int Check(bool isUpgrade, const wxString& fileName)
{
    KeepLibraryErrors();
    const TemplateFolders folders(isUpgrade);
    Report report(fileName);
    TakeLibraryErrors(); // if a file cannot be written, that is reported at the end
    WriteHead(folders, report);
    report.Begin("Workstation");
    folders.ReportPath(report);
    const HotFolderList list = LoadHotFolderList();
    CheckHotFolderList(list, report);
    CheckRunLog(report);
    CheckHotFolders(list, folders, report);
    report.Begin("Job presets");
    CheckPresets(folders, report);
    if (!report.End())
    {
        WriteStandardError("FolderUpgradeCheck: the report cannot be written to " +
                           (fileName.empty() ? wxString("the standard output") : fileName) + "\n");
        return HasProblems;
    }
    if (report.GetProblems() > 0)
        return HasProblems;
    return report.GetChanges() > 0 ? HasChanges : NothingToDo;
}

} // namespace

class FolderUpgradeCheckApp : public wxAppConsole
{
  public:
    // The base class would parse the command line itself.
    bool OnInit() override
    {
        return true;
    }

    int OnRun() override
    {
        wxDisableAsserts();
        const bool isUpgrade = argc > 1 && argv[1].CmpNoCase("I") == 0;
        const bool isDowngrade = argc > 1 && argv[1].CmpNoCase("U") == 0;
        if ((isUpgrade || isDowngrade) && argc <= 3)
            return Check(isUpgrade, argc == 3 ? argv[2] : wxString());
        WriteStandardError(
            "Usage: FolderUpgradeCheck I|U [FILE]\n"
            "Reports what FolderUpgrade would change with the same switch, and what "
            "would prevent a change, to the standard output or to FILE.\n"
            "Exit status: 0 nothing to do, 1 changes, 2 problems, 3 wrong arguments.\n");
        return WrongCall;
    }
};

wxIMPLEMENT_APP_CONSOLE(FolderUpgradeCheckApp);
