// The names in Folder.cfg, which its reader and its writer share.
//
// An XML 1.0 document in UTF-8. The root element carries the attributes of HotFolderSettings; below
// it stand the sections, in the order of their names here. Inside JobSetting, ImposeSetting and
// PreflightSettings attributes are told apart by their position.
#pragma once

namespace FolderCfg
{

constexpr const char* Root = "HotFolder";

constexpr const char* InputFormatsSection = "InputFormatsSummary";
constexpr const char* PathsSection = "Paths";
constexpr const char* JobSettingSection = "JobSetting";
constexpr const char* ImposeSettingSection = "ImposeSetting";
constexpr const char* FilterSettingSection = "FilterSetting";
constexpr const char* PreflightSection = "PreflightSettings";

constexpr const char* Failfolder = "Failfolder";
constexpr const char* Workfolder = "Workfolder";
constexpr const char* Movefolder = "Movefolder";
constexpr const char* Hotfolder = "Hotfolder";

constexpr const char* ShortName = "ShortName";
constexpr const char* DisplayName = "DisplayName";

/// The level of the filter setting in the document; the root's is 0.
constexpr int FilterSettingLevel = 1;

} // namespace FolderCfg
