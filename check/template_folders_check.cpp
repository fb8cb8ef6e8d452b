#include "check/template_folders_check.h"

#include "platform/process_rights.h"
#include "store/xml_text.h"

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
        report.ProblemOnce(folder.source.name + ": " + folder.source.whyNot + ", for the account " +
                           AccountName() +
                           "; nothing moves. Run as the client's user, after its installation");
}

void CheckFoldersForPresets(TemplateFolders& folders, Report& report)
{
    CheckIsKnown(folders.From(), report);
    CheckIsKnown(folders.To(), report);
    if (folders.To().path.find_first_of("&<") != wxString::npos)
        report.ProblemOnce(folders.To().source.name +
                           ": holds & or <, which is inserted into presets as it is");
    if (!IsXmlText(folders.To().path))
        report.ProblemOnce("the folder being installed holds a character that XML cannot store; no "
                           "path of a preset moves");
}
