// The names in Folder.cfg, which its reader and its writer share.
//
// An XML 1.0 document in UTF-8. The root element has the attributes of store/root_attributes.h;
// below it are the sections, in the order of their names here. Inside JobSetting, ImposeSetting and
// PreflightSettings, attributes are identified by position, not by name. The names are wide, like
// the library's strings: converting them took half as long as loading a file.
#pragma once

#include "store/hot_folder_settings.h"

namespace FolderCfg
{

constexpr const wchar_t* Root = L"HotFolder";

constexpr const wchar_t* InputFormatsSection = L"InputFormatsSummary";
constexpr const wchar_t* PathsSection = L"Paths";
constexpr const wchar_t* JobSettingSection = L"JobSetting";
constexpr const wchar_t* ImposeSettingSection = L"ImposeSetting";
constexpr const wchar_t* FilterSettingSection = L"FilterSetting";
constexpr const wchar_t* PreflightSection = L"PreflightSettings";

/// The key of the imposition setting whose value is the template's path, in job presets too.
constexpr const wchar_t* ImposeTemplateKey = L"ORXImposeTemplate";

constexpr const wchar_t* ShortName = L"ShortName";
constexpr const wchar_t* DisplayName = L"DisplayName";
constexpr const wchar_t* Path = L"path";
constexpr const wchar_t* Key = L"Key";
constexpr const wchar_t* Value = L"Value";
constexpr const wchar_t* KeyDisplayValue = L"KeyDisplayValue";
constexpr const wchar_t* LocDisplayValue = L"LocDisplayValue";

/// A text of an entry, and the attribute that stores it; of the paths, the element.
template <typename Entry>
struct Field
{
    const wchar_t* name;
    wxString Entry::*text;
};

/// In the order in which they are written.
constexpr Field<InputFormat> InputFormatFields[] = {{ShortName, &InputFormat::ShortName},
                                                    {DisplayName, &InputFormat::DisplayName}};
constexpr Field<HotFolderPaths> PathFields[] = {{L"Failfolder", &HotFolderPaths::Failfolder},
                                                {L"Workfolder", &HotFolderPaths::Workfolder},
                                                {L"Movefolder", &HotFolderPaths::Movefolder},
                                                {L"Hotfolder", &HotFolderPaths::Hotfolder}};
constexpr Field<JobSettingEntry> JobSettingFields[] = {
    {Value, &JobSettingEntry::Value},
    {KeyDisplayValue, &JobSettingEntry::KeyDisplayValue},
    {LocDisplayValue, &JobSettingEntry::LocDisplayValue}};
constexpr Field<ImposeSettingEntry> ImposeSettingFields[] = {
    {Value, &ImposeSettingEntry::Value}, {KeyDisplayValue, &ImposeSettingEntry::KeyDisplayValue}};
constexpr Field<PreflightSetting> PreflightFields[] = {{Key, &PreflightSetting::Key},
                                                       {Value, &PreflightSetting::Value}};

} // namespace FolderCfg
