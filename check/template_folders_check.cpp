#include "check/template_folders_check.h"

#include "platform/path_normal_form.h"
#include "store/xml_text.h"

namespace
{

bool IsBelow(const wxString& folder, const wxString& outer)
{
    const wxString begin = WithoutFinalSeparators(outer);
    return !begin.empty() && folder.length() > begin.length() && folder.StartsWith(begin) &&
           wxFileName::IsPathSeparator(folder[begin.length()]);
}

} // namespace

void CheckPreviousFolder(TemplateFolders& folders, Report& report)
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

void CheckIsKnown(const TemplateFolder& folder, Report& report)
{
    if (!folder.isKnown)
        report.ProblemOnce(folder.source.name + ": " + folder.source.whyNot + "; nothing moves");
}

void CheckFoldersForPresets(TemplateFolders& folders, Report& report)
{
    const wxString& from = folders.From().path;
    const wxString& to = folders.To().path;
    CheckIsKnown(folders.From(), report);
    CheckIsKnown(folders.To(), report);
    for (const TemplateFolder& folder : {folders.Default(), folders.Previous()})
    {
        if (folder.path.find_first_of("&<") != wxString::npos)
            report.ProblemOnce(folder.source.name +
                               ": holds & or <, which presets store in another form");
    }
    if (!IsXmlText(to))
        report.ProblemOnce("the folder being installed holds a character that XML cannot store; no "
                           "path of a preset moves");
    if (folders.From().isKnown && folders.To().isKnown && IsBelow(to, from))
        report.ProblemOnce("the folder being installed is below the one being left; every further "
                           "run moves the paths of presets again");
}
