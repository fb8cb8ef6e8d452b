#include "migrate/hot_folder_impose_path.h"

#include "migrate/template_move.h"
#include "run/run_log.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_reader.h"
#include "store/hot_folder.h"
#include "store/xml_file.h"
#include "store/xml_lookup.h"

namespace
{

void LogUntouched(const wxString& cfgPath, const wxString& reason)
{
    RunLog(wxString::Format(L"HF cfg file left as it is (%s): %s", reason, cfgPath));
}

void LogDecision(const TemplateMove& move, const wxString& cfgPath, bool isUpgrade)
{
    switch (move.outcome)
    {
    case TemplateMove::Outcome::NoFromFolder:
        RunLog(isUpgrade ? L"Unable to read: Previous Version  Default Impose Template Path"
                         : L"Unable to read: Default Impose Template Path");
        break;
    case TemplateMove::Outcome::NoToFolder:
        RunLog(isUpgrade ? L"Unable to read: Default Impose Template Path"
                         : L"unable to read: Previous Version  Default Impose Template Path");
        break;
    case TemplateMove::Outcome::UnknownEncoding:
        LogUntouched(cfgPath, L"unknown encoding");
        break;
    case TemplateMove::Outcome::NotStorable:
        LogUntouched(cfgPath, L"new path holds a character that XML cannot store");
        break;
    case TemplateMove::Outcome::Elsewhere:
    case TemplateMove::Outcome::Moves:
        break;
    }
}

// Everything outside the table is read again, from the file that is then written.
void Rewrite(XmlFile& cfg, const ImposeSettingTable& imposeSettings, const wxString& cfgPath)
{
    const wxCriticalSectionLocker lock(FolderCfgLock);
    const RegularFile::Status status = cfg.ReopenForUpdate();
    if (status == RegularFile::Status::Refused)
        return;
    if (status != RegularFile::Status::Open || !cfg.LoadAgain())
    {
        LogUntouched(cfgPath, L"cannot be loaded again");
        return;
    }
    const RewrittenFolderCfg rewritten = RewriteFolderCfg(*cfg.GetRoot(), imposeSettings);
    if (rewritten.reasonToStay)
        LogUntouched(cfgPath, rewritten.reasonToStay);
    else
        cfg.Rewrite(rewritten.bytes);
}

void MoveTemplate(XmlFile& cfg, const wxString& hotFolder, const wxString& cfgPath, bool isUpgrade)
{
    ImposeSettingTable table;
    ReadImposeSettings(cfg.GetRoot(), table);
    const auto entry = table.find(FolderCfg::ImposeTemplateKey);
    const ImposeSettingEntry stored = entry == table.end() ? ImposeSettingEntry() : entry->second;
    RunLog(L"Imposepath:" + hotFolder + L"is: " + stored.Value);
    if (entry == table.end())
        return;
    const TemplateMove move = DecideTemplateMove(stored.Value, cfg.GetBytes(), isUpgrade);
    LogDecision(move, cfgPath, isUpgrade);
    if (move.outcome != TemplateMove::Outcome::Moves)
        return;
    SetImposeSetting(table, FolderCfg::ImposeTemplateKey, move.newPath, stored.KeyDisplayValue);
    Rewrite(cfg, table, cfgPath);
}

} // namespace

void UpdateHotFolderImposePath(const FolderUpgradeApp& app, const wxString& hotFolder)
{
    const wxString cfgPath = FolderCfgPath(hotFolder);
    const PinnedHotFolder folder(hotFolder);
    XmlFile cfg;
    switch (cfg.Load(folder.privateDir.Reach(FolderCfgName), Links::Refuse, cfgPath))
    {
    case XmlFile::State::Missing:
        RunLog(L"HF cfg file unable to read/exist: " + cfgPath);
        break;
    case XmlFile::State::TooLarge:
        LogUntouched(cfgPath, L"too large to read safely");
        break;
    case XmlFile::State::NotReadable:
        break;
    case XmlFile::State::Loaded:
        if (FindElement(cfg.GetRoot(), FolderCfg::ImposeSettingSection, true))
            MoveTemplate(cfg, hotFolder, cfgPath, app.m_isUpgrade);
        break;
    }
}
