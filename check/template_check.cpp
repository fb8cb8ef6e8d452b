#include "check/template_check.h"

#include "migrate/template_move.h"
#include "platform/local_drive.h"
#include "platform/path_normal_form.h"
#include "platform/process_rights.h"
#include "store/xml_text.h"

#include <wx/filename.h>

namespace
{

// With one kind of separator, without dots, and in lower case if case does not matter.
wxString Comparable(const wxString& path)
{
    wxFileName name(path, wxPATH_NATIVE);
    name.Normalize(wxPATH_NORM_DOTS | wxPATH_NORM_CASE, wxString(), wxPATH_NATIVE);
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

// Whether the path can be looked at without leaving this machine. Links up to the trusted folder,
// from the registry, do not count.
bool MayLookAt(const wxString& path, const wxString& trusted)
{
    if (IsTooLongPath(path) || !IsOnLocalDrive(Comparable(path)))
        return false;
    wxFileName name(WithoutFinalSeparators(path), wxPATH_NATIVE);
    if (name.GetPath().Lower().Contains(".lnk"))
        return false;
    const size_t trustedDepth =
        IsIn(path, trusted) ? wxFileName::DirName(trusted).GetDirCount() : 0;
    if (IsLink(name.GetFullPath()))
        return false;
    for (; name.GetDirCount() > trustedDepth; name.RemoveLastDir())
    {
        if (IsLink(name.GetPath(wxPATH_GET_VOLUME)))
            return false;
    }
    return true;
}

} // namespace

TemplateCheck::TemplateCheck(TemplateFolders& itsFolders, Report& itsReport)
    : folders(itsFolders), report(itsReport)
{
}

void TemplateCheck::CheckPreviousFolder()
{
    const TemplateFolder& previous = folders.Previous();
    if (!previous.isKnown)
        return;
    if (previous.path.empty())
        report.Problem(previous.source.name +
                       (folders.IsUpgrade() ? ": empty; only templates stored without a folder move"
                                            : ": empty; templates move to the root of the drive"));
    else if (wxFileName::IsPathSeparator(previous.path.Last()))
        report.Problem(previous.source.name +
                       (folders.IsUpgrade()
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
        findings.problems.push_back("stays in the folder being left (" + whyItStays +
                                    "): " + Shown(path));
    else if (!MayLookAt(path, to))
        findings.notes.push_back("not looked at: " + Shown(path));
    else if (IsIn(path, to) && !wxDirExists(to))
        ++m_awaited;
    else if (!wxFileName::Exists(path))
        findings.problems.push_back("no template at " + Shown(path));
}

void TemplateCheck::ReportAwaited()
{
    if (m_awaited > 0)
        report.Note(wxString::Format(
            "there is no folder %s yet; templates that will be looked for in it: %zu",
            folders.To().path, m_awaited));
}
