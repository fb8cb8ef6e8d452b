// The settings of one hot folder in memory: six plain values, one for each part of Folder.cfg.
//
// FilterSetting, the sixth, is a wxXmlNode with the name "FilterSetting", or a default-constructed
// one for a file without that element.
#pragma once

#include <wx/string.h>
#include <wx/thread.h>

#include <cstdint>
#include <map>
#include <vector>

/// One entry of the input format list.
struct InputFormat
{
    wxString DisplayName;
    wxString ShortName;
};

/// The attributes of the root element and the input formats; each field has the name of the
/// attribute or element that stores it. The tool interprets only Enable.
struct HotFolderSettings
{
    wxString name;
    wxString description;
    wxString server_ip;
    wxString server_name;
    std::int32_t server_version = -1; // -1: not known
    wxString BaseVirtualPrinter;
    wxString BaseVirtualPrinterName;
    wxString BaseVirtualPrinterDisplayName;
    bool Enable = false;
    std::vector<InputFormat> InputFormatsSummary;
    bool Centralized = false;
    bool Isjobpresetattached = false;
    bool IsCustomInterval = false;
    wxString TimeInterval;
    wxString HFPresetName;
    wxString PPDVersion;
    wxString ServerTypeAndJPDefaultKeyInfo;
    wxString server_textversion;
    wxString server_type;
    bool Quickset_Supported = false;
    bool Quickset_Enabled = false;
    wxString Quickset;
    bool IsWidthBased = false;
};

/// The four folder paths of the "Paths" element, which are only carried over.
struct HotFolderPaths
{
    wxString Failfolder;
    wxString Workfolder;
    wxString Movefolder;
    wxString Hotfolder;
};

struct JobSettingEntry
{
    wxString KeyDisplayValue;
    wxString Value;
    wxString LocDisplayValue;
};

struct ImposeSettingEntry
{
    wxString KeyDisplayValue;
    wxString Value;
};

/// Both tables are ordered by key, as wxString::Cmp compares.
using JobSettingTable = std::map<wxString, JobSettingEntry>;
using ImposeSettingTable = std::map<wxString, ImposeSettingEntry>;

struct PreflightSetting
{
    wxString Key;
    wxString Value;
};

/// In the order of the file, repeated keys included.
using PreflightSettingList = std::vector<PreflightSetting>;

/// Sets both fields of the key's entry, which is added if it is missing.
void SetImposeSetting(ImposeSettingTable& table, const wxString& key, const wxString& value,
                      const wxString& keyDisplayValue);

/// Guards Folder.cfg while the icon's state is read and during a whole rewrite, always through a
/// wxCriticalSectionLocker.
extern wxCriticalSection FolderCfgLock;
