#include "check/template_check.h"

#include "migrate/template_move.h"
#include "platform/local_drive.h"
#include "platform/path_normal_form.h"

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

bool IsIn(const wxString& path, const wxString& folder)
{
    if (folder.empty() || IsTooLongPath(path))
        return false;
    const wxString inner = Comparable(path);
    const wxString outer = Comparable(folder);
    return inner.StartsWith(outer) &&
           (inner.length() == outer.length() || wxFileName::IsPathSeparator(inner[outer.length()]));
}

TemplateCheck::TemplateCheck(TemplateFolders& folders) : m_folders(folders)
{
}

void TemplateCheck::Judge(const wxString& path, const wxString& whyItStays, Findings& findings)
{
    const wxString& from = m_folders.From().path;
    const wxString& to = m_folders.To().path;
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

size_t TemplateCheck::GetAwaited() const
{
    return m_awaited;
}
