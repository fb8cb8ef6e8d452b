#include "check/template_folders.h"

#include "migrate/install_locations.h"
#include "store/xml_text.h"

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
    m_default.value = wxString("registry value ") + DefaultFolderSource + ": ";
    m_default.isKnown = GetDefaultImposeTemplatePath(folder);
    if (m_default.isKnown)
        m_default.path = folder.GetFullPath(wxPATH_NATIVE);
    m_previous.value = wxString("registry value ") + PreviousFolderSource + ": ";
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

void TemplateFolders::ReportPath(Report& report) const
{
    if (!m_previous.isKnown)
        return;
    if (m_previous.path.empty())
        report.Problem(m_previous.value +
                       (m_isUpgrade ? "empty; only templates stored without a folder move"
                                    : "empty; templates move to the root of the drive"));
    else if (EndsInSeparator(m_previous.path))
        report.Problem(m_previous.value +
                       (m_isUpgrade
                            ? "ends in a separator; no template of a hot folder moves"
                            : "ends in a separator; it is doubled in the paths of hot folders"));
}

void TemplateFolders::ReportFrom(Report& report) const
{
    ReportUnknown(m_isUpgrade ? m_previous : m_default, report);
}

void TemplateFolders::ReportTo(Report& report) const
{
    ReportUnknown(m_isUpgrade ? m_default : m_previous, report);
}

void TemplateFolders::ReportUnknown(const Folder& folder, Report& report)
{
    if (!folder.isKnown)
        report.ProblemOnce(folder.value +
                           "missing, longer than 257 characters, or not readable; nothing moves");
}

void TemplateFolders::ReportForPresets(Report& report) const
{
    ReportFrom(report);
    ReportTo(report);
    for (const Folder* folder : {&m_default, &m_previous})
    {
        if (folder->path.find_first_of("&<") != wxString::npos)
            report.ProblemOnce(folder->value + "holds & or <, which presets store in another form");
    }
    if (!IsXmlText(To()))
        report.ProblemOnce("the folder being installed holds a character that XML cannot store; no "
                           "path of a preset moves");
    if (AreKnown() && IsBelow(To(), From()))
        report.ProblemOnce("the folder being installed is below the one being left; every further "
                           "run moves the paths of presets again");
}
