#include "check/folder_cfg_check.h"

#include "check/folder_cfg_loss.h"
#include "check/workstation_check.h"
#include "migrate/template_move.h"
#include "platform/path_normal_form.h"
#include "store/xml_encoding.h"

#include <wx/filename.h>

namespace
{

void ReportLeft(const wxString& reason, Report& report)
{
    report.Problem("Folder.cfg: left as it is (" + reason + ")");
}

void CheckMissing(const HotFolder& folder, Report& report)
{
    const wxString path = folder.privateDir.Reach(FolderCfgName);
    if (IsLink(path))
        report.Problem("Folder.cfg: reached over a link");
    else if (wxFileName::Exists(path))
        report.Problem("Folder.cfg: is not a file");
    else
        report.Note("no Folder.cfg");
}

void CheckShownState(const wxXmlNode& root, Report& report)
{
    const AttributeGap gap = FindAttributeGap(root);
    if (gap.isDisabled)
        report.Problem("Folder.cfg: lacks \"" + gap.missing +
                       "\", so the enabled folder shows as disabled");
}

// Returns whether the file is rewritten.
bool CheckMove(HotFolder& folder, const TemplateMove& move, Report& report)
{
    XmlFile& cfg = folder.cfg;
    if (cfg.file.ReopenForUpdate() != RegularFile::Status::Open)
    {
        report.Problem("Folder.cfg: cannot be opened for writing (" +
                       cfg.file.GetFailure().Describe(FolderCfgPath(folder.path)) + ")");
        return false;
    }
    if (move.storedPath == move.newPath && move.newContent == cfg.bytes)
        return true;
    report.AddLosses("Folder.cfg: ", FindFolderCfgLosses(*cfg.document, move.newContent));
    report.Change("Folder.cfg: " + Shown(move.storedPath) + " -> " + Shown(move.newPath));
    if (!IsUtf8(cfg.bytes))
        report.Note("Folder.cfg: comes out as UTF-8");
    return true;
}

wxString WhyItStays(const TemplateMove& move, TemplateFolders& folders)
{
    using Outcome = TemplateMove::Outcome;
    if (move.outcome == Outcome::ToUnknown)
        return "the folder being installed is unknown";
    if (move.outcome != Outcome::Elsewhere)
        return "in a file that stays as it is";
    const wxString from = WithoutFinalSeparators(folders.From().path);
    wxFileName folded(IsTooLongPath(move.storedPath) ? wxString() : move.storedPath);
    folded.Normalize(wxPATH_NORM_DOTS, wxString(), wxPATH_NATIVE);
    if (IsDirectlyIn(move.storedPath, from))
        return "the registry value ends in a separator";
    return IsDirectlyIn(folded.GetFullPath(), from) ? "its last folder is a dot"
                                                    : "in a sub-folder";
}

// Returns whether the file is rewritten.
bool CheckTemplate(HotFolder& folder, TemplateCheck& check)
{
    Report& report = check.report;
    using Outcome = TemplateMove::Outcome;
    const TemplateMove move = DecideTemplateMove(folder.cfg, check.folders);
    const bool isRewritten = move.outcome == Outcome::Moves && CheckMove(folder, move, report);
    if (move.outcome == Outcome::Stays)
        ReportLeft(move.reasonToStay, report);
    if (move.outcome == Outcome::FromUnknown && !move.storedPath.empty())
        check.CheckIsKnown(check.folders.From());
    if (move.outcome == Outcome::ToUnknown)
        check.CheckIsKnown(check.folders.To());
    Findings findings;
    check.Judge(isRewritten ? move.newPath : move.storedPath, WhyItStays(move, check.folders),
                findings);
    report.Add({}, findings);
    return isRewritten;
}

} // namespace

void CheckFolderCfg(HotFolder& folder, TemplateCheck& check)
{
    Report& report = check.report;
    const XmlFile::State state = folder.LoadCfg();
    if (state == XmlFile::State::Missing)
        CheckMissing(folder, report);
    else if (state == XmlFile::State::TooLarge)
        ReportLeft(TooLargeToRead, report);
    else if (state == XmlFile::State::NotReadable)
        report.Problem("Folder.cfg: " +
                       (folder.cfg.error.message.empty()
                            ? folder.cfg.WhyNotReadable(FolderCfgPath(folder.path))
                            : Damage(folder.cfg.error) +
                                  "; it stays as it is, and the folder shows as disabled"));
    else if (!CheckTemplate(folder, check))
        CheckShownState(*folder.cfg.Root(), report);
}
