#include "check/template_check.h"

#include "migrate/template_move.h"
#include "platform/local_drive.h"
#include "platform/path_normal_form.h"
#include "platform/process_rights.h"
#include "store/xml_document.h"

#include <wx/filename.h>
#include <wx/log.h>

namespace
{

// With variables expanded, one kind of separator, without dots, and in lower case if case does not
// matter: as the paths of hot folders are compared.
wxString Comparable(const wxString& path)
{
    const wxLogNull noWarnings; // of variables that are not there
    wxFileName name(path, wxPATH_NATIVE);
    name.Normalize(wxPATH_NORM_ENV_VARS | wxPATH_NORM_DOTS | wxPATH_NORM_CASE, wxString(),
                   wxPATH_NATIVE);
    return WithoutFinalSeparators(name.GetFullPath(wxPATH_NATIVE));
}

// Whether the path is in the folder, at any depth, in any letter case and with any separators that
// the system takes for the same. Only names are compared.
bool IsIn(const wxString& path, const wxString& folder)
{
    if (folder.empty() || IsTooLongPath(path))
        return false;
    const wxString inner = Comparable(path);
    const wxString outer = Comparable(folder);
    return inner.StartsWith(outer) &&
           (inner.length() == outer.length() || wxFileName::IsPathSeparator(inner[outer.length()]));
}

enum class Place
{
    There,
    Missing,
    NotLookedAt
};

// Looks at one directory after another, from the drive on, without leaving this machine. Links up
// to the trusted folder, from the registry, are followed.
Place Look(const wxString& path, const wxString& trusted)
{
    wxFileName name(WithoutFinalSeparators(path), wxPATH_NATIVE);
    if (!IsTooLongPath(path))
        name.Normalize(wxPATH_NORM_DOTS, wxString(), wxPATH_NATIVE);
    const bool isOnServer = path.length() > 1 && wxFileName::IsPathSeparator(path[0]) &&
                            wxFileName::IsPathSeparator(path[1]);
    if (IsTooLongPath(path) || isOnServer || !IsOnLocalDrive(name.GetFullPath()))
        return Place::NotLookedAt;
    const size_t trustedDepth =
        IsIn(path, trusted) ? wxFileName::DirName(Comparable(trusted)).GetDirCount() : 0;
    wxFileName reached(name);
    while (reached.GetDirCount() > 0)
        reached.RemoveLastDir();
    for (size_t i = 0; i <= name.GetDirCount(); ++i)
    {
        const bool isLast = i == name.GetDirCount();
        if (!isLast && name.GetDirs()[i].Lower().EndsWith(".lnk"))
            return Place::NotLookedAt;
        if (!isLast)
            reached.AppendDir(name.GetDirs()[i]);
        const wxString next = isLast ? name.GetFullPath() : reached.GetPath(wxPATH_GET_VOLUME);
        if (i >= trustedDepth && IsLink(next))
            return Place::NotLookedAt;
        if (!wxFileName::Exists(next))
            return Place::Missing;
    }
    return Place::There;
}

} // namespace

void TemplateCheck::CheckPreviousFolder()
{
    const TemplateFolder& previous = folders.Previous();
    if (!previous.isKnown)
        return;
    if (previous.path.empty())
        report.Problem(previous.source.name +
                       (folders.isUpgrade ? ": empty; only templates stored without a folder move"
                                          : ": empty; templates move to the root of the drive"));
    else if (wxFileName::IsPathSeparator(previous.path.Last()))
        report.Problem(previous.source.name +
                       (folders.isUpgrade
                            ? ": ends in a separator; no template of a hot folder moves"
                            : ": ends in a separator; it is doubled in the paths of hot folders"));
}

void TemplateCheck::CheckIsKnown(const TemplateFolder& folder)
{
    if (!folder.isKnown)
        report.ProblemOnce(folder.source.name + ": " + folder.source.whyNot + ", for the account " +
                           AccountName() +
                           "; nothing moves. Run as the client's user, after its installation");
}

void TemplateCheck::CheckForPresets()
{
    CheckIsKnown(folders.From());
    CheckIsKnown(folders.To());
    if (folders.To().path.find_first_of("&<") != wxString::npos)
        report.ProblemOnce(folders.To().source.name +
                           ": holds & or <, which is inserted into presets as it is");
    if (!IsXmlText(folders.To().path))
        report.ProblemOnce("the folder being installed holds a character that XML cannot store; no "
                           "path of a preset moves");
}

void TemplateCheck::Judge(const wxString& path, const wxString& whyItStays, Findings& findings)
{
    const wxString& from = folders.From().path;
    const wxString& to = folders.To().path;
    if (path.empty())
        return;
    // Either folder can be in the other.
    if (IsIn(path, from) && !(IsIn(path, to) && IsIn(to, from)))
    {
        findings.problems.push_back("stays in the folder being left (" + whyItStays +
                                    "): " + Shown(path));
        return;
    }
    const Place place = Look(path, to);
    if (place == Place::NotLookedAt)
        findings.notes.push_back("not looked at: " + Shown(path));
    else if (place == Place::Missing && IsIn(path, to) && !wxDirExists(to))
        ++awaited;
    else if (place == Place::Missing)
        findings.problems.push_back("no template at " + Shown(path));
}

void TemplateCheck::ReportAwaited()
{
    if (awaited == 0)
        return;
    const wxString text =
        wxString::Format("there is no folder %s; templates that will be looked for in it: %zu",
                         folders.To().path, awaited);
    // It may not be there yet before an installation, and before a removal has put it back.
    if (folders.isUpgrade && !folders.isRehearsal)
        report.Problem(text);
    else
        report.Note(text);
}
