#include "check/template_folders.h"

#include "migrate/install_locations.h"

#include <wx/filename.h>

namespace
{

bool EndsInSeparator(const wxString& path)
{
    return !path.empty() && wxFileName::IsPathSeparator(path.Last());
}

wxString WithoutFinalSeparators(wxString path)
{
    while (EndsInSeparator(path))
        path.RemoveLast();
    return path;
}

bool IsBelow(const wxString& folder, const wxString& outer)
{
    const wxString begin = WithoutFinalSeparators(outer);
    return !begin.empty() && folder.length() > begin.length() && folder.StartsWith(begin) &&
           wxFileName::IsPathSeparator(folder[begin.length()]);
}

} // namespace

TemplateFolders::TemplateFolders(bool isUpgrade) : m_isUpgrade(isUpgrade)
{
    wxFileName folder;
    m_default.value = "InstallPath in HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA";
    m_default.isKnown = GetDefaultImposeTemplatePath(folder);
    if (m_default.isKnown)
        m_default.path = folder.GetFullPath(wxPATH_NATIVE);
    m_previous.value = "Path in HKEY_CURRENT_USER\\SOFTWARE\\HF";
    m_previous.isKnown = GetPreviousImposeTemplatePath(folder);
    m_previous.path = folder.GetFullPath(wxPATH_NATIVE);
}

bool TemplateFolders::IsUpgrade() const
{
    return m_isUpgrade;
}

const wxString& TemplateFolders::From() const
{
    return (m_isUpgrade ? m_previous : m_default).path;
}

const wxString& TemplateFolders::To() const
{
    return (m_isUpgrade ? m_default : m_previous).path;
}

bool TemplateFolders::AreKnown() const
{
    return m_default.isKnown && m_previous.isKnown;
}

void TemplateFolders::ReportFrom(Report& report) const
{
    ReportFolder(m_isUpgrade ? m_previous : m_default, report);
}

void TemplateFolders::ReportTo(Report& report) const
{
    ReportFolder(m_isUpgrade ? m_default : m_previous, report);
}

void TemplateFolders::ReportFolder(const Folder& folder, Report& report)
{
    const wxString value = wxString("registry value ") + folder.value + ": ";
    if (!folder.isKnown)
        report.ProblemOnce(value +
                           "missing, longer than 257 characters, or not readable; nothing moves");
    else if (folder.path.empty())
        report.ProblemOnce(value + "empty");
    else if (EndsInSeparator(folder.path))
        report.ProblemOnce(value +
                           "ends in a separator; an upgrade moves no template of a hot folder");
}

void TemplateFolders::ReportForPresets(Report& report) const
{
    ReportFolder(m_default, report);
    ReportFolder(m_previous, report);
    for (const Folder* folder : {&m_default, &m_previous})
    {
        if (folder->path.find_first_of("&<") != wxString::npos)
            report.ProblemOnce(wxString("registry value ") + folder->value +
                               ": holds & or <, which presets store in another form");
    }
    if (AreKnown() && IsBelow(To(), From()))
        report.ProblemOnce(
            "the folder being installed is below the one being left; every further run moves the "
            "paths of presets again");
}
