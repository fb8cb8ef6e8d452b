#include "check/workstation_check.h"

#include "check/reach.h"
#include "platform/access_rights.h"
#include "platform/process_rights.h"
#include "run/run_log.h"

#include <wx/filename.h>

namespace
{

bool IsDriveThere(const wxString& folder)
{
    const wxFileName name(folder, wxPATH_NATIVE);
    if (!name.HasVolume())
        return true;
    const wxString separator = wxFileName::GetPathSeparator();
    const bool isShare = name.GetVolume().length() > 1;
    const wxString share = name.GetDirCount() > 0 ? name.GetDirs()[0] : wxString();
    return wxDirExists(isShare ? name.GetVolume() + separator + share + separator
                               : name.GetVolume() + ":" + separator);
}

void CheckEntries(const HotFolderList& list, Report& report)
{
    if (list.folders.empty() && !list.missing.empty())
        report.Problem("none of the listed hot folders exists (another account? mapped drives?)");
    else if (list.folders.empty())
        report.Note("HotFolderList.cfg lists no hot folder");
    Findings missing;
    for (const wxString& folder : list.missing)
    {
        const wxString obstacle = WhyOutOfReach(folder);
        if (!obstacle.empty())
            missing.problems.push_back(Shown(folder) + " " + obstacle);
        else if (!IsDriveThere(folder))
            missing.problems.push_back("is on a drive or share that is not there: " +
                                       Shown(folder));
        else
            missing.notes.push_back("does not exist: " + Shown(folder));
    }
    for (const wxString& folder : list.repeated)
        missing.notes.push_back("is listed twice: " + Shown(folder));
    report.Add("listed hot folder ", missing);
}

} // namespace

wxString Damage(const XmlSyntaxError& error)
{
    return wxString::Format("damaged (line %lu: %s)", error.line, error.message);
}

void CheckAccount(Report& report)
{
    if (IsSystemAccount())
        report.Problem(
            "the account is SYSTEM, which has no hot folder client: it has other presets, "
            "another log and no previous version; run it as the client's user");
}

void CheckHotFolderList(const HotFolderList& list, Report& report)
{
    const wxString obstacle = WhyOutOfReach(GetHotFolderDataDir());
    const wxString path = GetHotFolderListPath();
    if (list.state == XmlFile::State::Loaded)
        CheckEntries(list, report);
    else if (list.state == XmlFile::State::TooLarge)
        report.Problem(wxString("HotFolderList.cfg: ") + TooLargeToRead);
    else if (list.state == XmlFile::State::NotReadable)
        report.Problem(
            (list.error.message.empty() ? list.whyNotReadable : path + ": " + Damage(list.error)) +
            "; no hot folder is migrated");
    else if (!obstacle.empty())
        report.Problem("HotFolderList.cfg: its folder " + obstacle);
    else if (wxFileName::Exists(path, wxFILE_EXISTS_ANY | wxFILE_EXISTS_NO_FOLLOW))
        report.Problem("HotFolderList.cfg: is not a file");
    else
        report.Note("there is no " + path);
}

void CheckRunLog(Report& report)
{
    const wxString folder = RunLogDirPath();
    const wxString path = folder + RunLogFileName;
    // First, because what cannot be looked at counts as a link.
    const wxString obstacle = WhyOutOfReach(folder);
    if (!obstacle.empty())
    {
        report.Problem("there will be no run log: its folder " + obstacle + ": " + folder);
        return;
    }
    if (IsLink(folder.Left(folder.length() - 1)) || IsLink(path))
    {
        report.Problem("there will be no run log: it is reached over a link: " + path);
        return;
    }
    if (!wxDirExists(folder))
    {
        report.Note("there will be no run log: there is no folder " + folder);
        return;
    }
    RegularFile log;
    const RegularFile::Status status =
        log.OpenForUpdate(PinnedDirectory(folder, Links::Refuse), RunLogFileName);
    if (status == RegularFile::Status::Refused)
        report.Problem("there will be no run log: " + log.GetFailure().Describe(path));
    else if (status == RegularFile::Status::NotThere && wxFileName::Exists(path))
        report.Note("there will be no run log: something else has its name: " + path);
    else if (status == RegularFile::Status::NotThere && !MayCreateIn(folder))
        report.Problem("there will be no run log: its folder cannot be written to: " + folder);
}
