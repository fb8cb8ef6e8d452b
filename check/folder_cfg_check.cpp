#include "check/folder_cfg_check.h"

#include "check/folder_cfg_loss.h"
#include "check/template_folders_check.h"
#include "migrate/template_move.h"
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

void ReportLosses(const wxArrayString& losses, Report& report)
{
    constexpr size_t Most = 20;
    for (size_t i = 0; i < losses.size() && i < Most; ++i)
        report.Loss("Folder.cfg: " + losses[i]);
    if (losses.size() > Most)
        report.Loss(wxString::Format("Folder.cfg: and %zu more", losses.size() - Most));
}

// False if the file is not rewritten.
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
    ReportLosses(FindFolderCfgLosses(*cfg.document, move.newContent), report);
    report.Change("Folder.cfg: " + Shown(move.storedPath) + " -> " + Shown(move.newPath));
    if (!IsUtf8(cfg.bytes))
        report.Note("Folder.cfg: comes out as UTF-8");
    if (!wxFileName::Exists(move.newPath))
        report.Note("no such file: " + Shown(move.newPath));
    return true;
}

// False if the file is not rewritten.
bool CheckTemplate(HotFolder& folder, TemplateFolders& folders, Report& report)
{
    using Outcome = TemplateMove::Outcome;
    const TemplateMove move = DecideTemplateMove(folder.cfg, folders);
    switch (move.outcome)
    {
    case Outcome::NoSection:
    case Outcome::NoTemplate:
        break;
    case Outcome::FromUnknown:
        CheckIsKnown(folders.From(), report);
        break;
    case Outcome::ToUnknown:
        CheckIsKnown(folders.To(), report);
        break;
    case Outcome::Elsewhere:
        if (!move.storedPath.empty() && !IsDirectlyIn(move.storedPath, folders.To().path))
            report.Note("template elsewhere: " + Shown(move.storedPath));
        break;
    case Outcome::Stays:
        ReportLeft(move.reasonToStay, report);
        break;
    case Outcome::Moves:
        return CheckMove(folder, move, report);
    }
    return false;
}

} // namespace

void CheckFolderCfg(HotFolder& folder, TemplateFolders& folders, Report& report)
{
    switch (folder.LoadCfg())
    {
    case XmlFile::State::Missing:
        CheckMissing(folder, report);
        break;
    case XmlFile::State::TooLarge:
        ReportLeft(CfgStays::TooLarge, report);
        break;
    case XmlFile::State::NotReadable:
        report.Problem("Folder.cfg: " + folder.cfg.WhyNotReadable(FolderCfgPath(folder.path)));
        break;
    case XmlFile::State::Loaded:
        if (!CheckTemplate(folder, folders, report))
            CheckShownState(*folder.cfg.Root(), report);
        break;
    }
}
