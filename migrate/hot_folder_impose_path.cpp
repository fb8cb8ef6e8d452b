#include "migrate/hot_folder_impose_path.h"

#include "migrate/template_move.h"
#include "platform/library_log.h"
#include "run/run_log.h"
#include "store/folder_cfg_writer.h"

namespace
{

void LogUntouched(const wxString& cfgPath, const wxString& reason)
{
    RunLog(wxString::Format(L"HF cfg file left as it is (%s): %s", reason, cfgPath));
}

void Save(HotFolder& folder, const std::string& content, const wxString& cfgPath)
{
    const XmlFile::Saved saved = SaveHotFolderSettings(folder, content);
    if (saved == XmlFile::Saved::Refused)
        ReportError(folder.cfg.file.GetFailure().Describe(cfgPath));
    else if (saved == XmlFile::Saved::NotReadAgain)
        LogUntouched(cfgPath, L"cannot be loaded again");
    else if (saved == XmlFile::Saved::Changed)
        LogUntouched(cfgPath, L"changed meanwhile");
}

void MoveTemplate(HotFolder& folder, const wxString& cfgPath, bool isUpgrade)
{
    using Outcome = TemplateMove::Outcome;
    TemplateFolders folders(isUpgrade);
    const TemplateMove move = DecideTemplateMove(folder.cfg, folders);
    if (move.outcome != Outcome::NoSection)
        RunLog(L"Imposepath:" + folder.path + L"is: " + move.storedPath);
    if (move.outcome == Outcome::FromUnknown)
        RunLog(isUpgrade ? L"Unable to read: Previous Version  Default Impose Template Path"
                         : L"Unable to read: Default Impose Template Path");
    else if (move.outcome == Outcome::ToUnknown)
        RunLog(isUpgrade ? L"Unable to read: Default Impose Template Path"
                         : L"unable to read: Previous Version  Default Impose Template Path");
    else if (move.outcome == Outcome::Stays)
        LogUntouched(cfgPath, move.reasonToStay);
    else if (move.outcome == Outcome::Moves)
        Save(folder, move.newContent, cfgPath);
}

} // namespace

void UpdateHotFolderImposePath(const FolderUpgradeApp& app, HotFolder& folder)
{
    const wxString cfgPath = FolderCfgPath(folder.path);
    const XmlFile::State state = folder.LoadCfg();
    if (state == XmlFile::State::Missing)
        RunLog(L"HF cfg file unable to read/exist: " + cfgPath);
    else if (state == XmlFile::State::TooLarge)
        LogUntouched(cfgPath, TooLargeToRead);
    else if (state == XmlFile::State::NotReadable)
        ReportError(folder.cfg.WhyNotReadable(cfgPath));
    else
        MoveTemplate(folder, cfgPath, app.m_isUpgrade);
}
