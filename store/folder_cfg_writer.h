// Writing Folder.cfg.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>
#include <vector>

/// The content of a Folder.cfg with the six values, and nothing else. A filter setting whose name
/// is not "FilterSetting" is left out. It must not be deeper than MaxFilterLevels. It is moved
/// from, and empty afterwards.
std::string FolderCfgBytes(const HotFolderSettings& settings, const JobSettingTable& jobSettings,
                           const HotFolderPaths& paths, wxXmlNode& filterSetting,
                           const ImposeSettingTable& imposeSettings,
                           const PreflightSettingList& preflightSettings);

/// Writes that content to the file, as RegularFile::Rewrite does; creates the file if it does not
/// exist. If it cannot be opened or written, it stays as it was. Holds FolderCfgLock throughout.
/// Always returns 0; the library reports an error if the file cannot be opened or written.
int SaveHotFolderSettings(const wxString& path, const HotFolderSettings& settings,
                          const JobSettingTable& jobSettings, const HotFolderPaths& paths,
                          const wxXmlNode& filterSetting, const ImposeSettingTable& imposeSettings,
                          const PreflightSettingList& preflightSettings);

/// How many levels below a filter setting can be saved: wxXmlDocument::Save recurses, and the time
/// and size of the indentation grow with the square of the depth.
constexpr int MaxFilterLevels = 1024;

/// The section writers append one element to the root of a document under construction, or do
/// nothing if there is no root.
void WriteInputFormats(wxXmlNode* root, const std::vector<InputFormat>& formats);
void WritePaths(wxXmlNode* root, const HotFolderPaths& paths);
void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table);
void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table);
void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list);
