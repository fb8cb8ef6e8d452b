#include "migrate/hot_folder_impose_path.h"

#include "run/run_log.h"
#include "migrate/install_locations.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_encoding.h"
#include "store/xml_lookup.h"
#include "store/xml_tree.h"

#include <wx/filename.h>
#include <wx/xml/xml.h>

namespace
{

using Lookup = bool (*)(wxFileName&);

// The direction of a run: each folder's lookup, and the line for its failure.
struct Direction
{
    Lookup from;
    const char* fromMessage;
    Lookup to;
    const char* toMessage;
};

constexpr Direction Upgrade = {GetPreviousImposeTemplatePath, NoPreviousPathMessage,
                               GetDefaultImposeTemplatePath, NoDefaultPathMessage};
constexpr Direction Downgrade = {GetDefaultImposeTemplatePath, NoDefaultPathMessage,
                                 GetPreviousImposeTemplatePath,
                                 "unable to read: Previous Version  Default Impose Template Path"};

void LogUntouched(const wxString& cfgPath, const wxString& reason)
{
    RunLog(wxString::Format(L"HF cfg file left as it is (%s): %s", reason, cfgPath), NoCount);
}

bool Load(const wxString& cfgPath, wxXmlDocument& document)
{
    return wxFileExists(cfgPath) && LoadFolderCfg(cfgPath, document);
}

template <typename Reader, typename Section>
bool LoadSection(const wxString& cfgPath, Reader read, Section& section)
{
    wxXmlDocument document;
    if (!Load(cfgPath, document))
        return false;
    read(document.GetRoot(), section);
    return true;
}

bool LookUp(Lookup lookup, const char* message, wxFileName& folder)
{
    if (lookup(folder))
        return true;
    RunLog(message, NoCount);
    return false;
}

// The folder that holds the template, its last component as the file name, as the lookups give it.
wxFileName FolderOf(const wxFileName& templateFile)
{
    return wxFileName(templateFile.GetPath(wxPATH_GET_VOLUME, wxPATH_NATIVE), wxPATH_NATIVE);
}

// Two names of one folder are the same, but not with a final separator and without: off Windows
// wxFileName::SameAs would take that too, for a folder that is there.
bool IsSameFolder(const wxFileName& left, const wxFileName& right)
{
    return left.GetFullName().empty() == right.GetFullName().empty() &&
           left.SameAs(right, wxPATH_NATIVE);
}

// Everything in Folder.cfg but the imposition settings.
struct OtherSettings
{
    JobSettingTable jobSettings;
    HotFolderPaths paths;
    wxXmlNode filterSetting;
    PreflightSettingList preflightSettings;
    HotFolderSettings settings;
};

// False when one of the loads failed: a rewrite would then empty what was not read.
bool ReadOtherSettings(const wxString& cfgPath, OtherSettings& other)
{
    bool filterLoaded = false;
    bool settingsLoaded = false;
    const bool jobsLoaded = LoadSection(cfgPath, ReadJobSettings, other.jobSettings);
    const bool pathsLoaded = LoadSection(cfgPath, ReadPaths, other.paths);
    ReadFilterSetting(cfgPath, other.filterSetting, &filterLoaded);
    const bool preflightLoaded =
        LoadSection(cfgPath, ReadPreflightSettings, other.preflightSettings);
    {
        const wxCriticalSectionLocker lock(FolderCfgLock);
        if (wxFileExists(cfgPath))
            LoadHotFolderSettings(cfgPath, other.settings, &settingsLoaded);
    }
    return jobsLoaded && pathsLoaded && filterLoaded && preflightLoaded && settingsLoaded;
}

void RewriteFolderCfg(const wxString& cfgPath, const ImposeSettingTable& imposeSettings)
{
    OtherSettings other;
    if (!ReadOtherSettings(cfgPath, other))
        return LogUntouched(cfgPath, L"cannot be loaded again");
    if (CountLevels(other.filterSetting) > MaxFilterLevels)
        return LogUntouched(cfgPath, L"filter setting nested too deep");
    SaveHotFolderSettings(cfgPath, other.settings, other.jobSettings, other.paths,
                          other.filterSetting, imposeSettings, other.preflightSettings);
}

// Moves the stored path when its template lies in the folder being left.
void MoveTemplate(const wxString& cfgPath, const Direction& direction, ImposeSettingTable& table)
{
    const ImposeSettingEntry stored = table[ImposeTemplateKey];
    wxFileName from;
    if (!LookUp(direction.from, direction.fromMessage, from))
        return;
    const wxFileName templateFile(stored.Value, wxPATH_NATIVE);
    const bool isInFolder = IsSameFolder(from, FolderOf(templateFile));
    // In an encoding that is not known just what is ASCII can be told.
    if (!isInFolder && stored.Value.IsAscii())
        return;
    if (!IsReadFaithfully(cfgPath))
        return LogUntouched(cfgPath, L"unknown encoding");
    if (!isInFolder)
        return;
    wxFileName to;
    if (!LookUp(direction.to, direction.toMessage, to))
        return;

    const wxString newPath = to.GetFullPath(wxPATH_NATIVE) +
                             wxFileName::GetPathSeparator(wxPATH_NATIVE) +
                             templateFile.GetFullName();
    if (!IsXmlText(newPath))
        return LogUntouched(cfgPath, L"new path holds a character that XML cannot store");
    SetImposeSetting(table, ImposeTemplateKey, newPath, stored.KeyDisplayValue);
    RewriteFolderCfg(cfgPath, table);
}

} // namespace

void UpdateHotFolderImposePath(const FolderUpgradeApp& app, const wxString& hotFolder)
{
    const wxString cfgPath = FolderCfgPath(hotFolder);
    if (!wxFileName::FileExists(cfgPath))
    {
        RunLog(wxString::Format(L"HF cfg file unable to read/exist: %s", cfgPath), NoCount);
        return;
    }

    {
        wxXmlDocument document;
        if (!LoadFolderCfg(cfgPath, document) ||
            !FindElement(document.GetRoot(), FolderCfg::ImposeSettingSection, true))
            return;
    }

    ImposeSettingTable table;
    LoadSection(cfgPath, ReadImposeSettings, table);
    const auto entry = table.find(ImposeTemplateKey);
    const bool isPresent = entry != table.end();
    const wxString storedPath = isPresent ? entry->second.Value : wxString();
    RunLog(L"Imposepath:" + hotFolder + L"is: " + storedPath, NoCount);
    if (isPresent)
        MoveTemplate(cfgPath, app.m_isUpgrade ? Upgrade : Downgrade, table);
}
