// Writing Folder.cfg.
#pragma once

#include "store/hot_folder.h"
#include "store/hot_folder_settings.h"

/// The content of a Folder.cfg with the six values, and nothing else. A filter setting is moved
/// from; one whose name is not "FilterSetting" is left out. Empty if the content would exceed
/// FolderCfgLimits, and so could not be read again.
std::string FolderCfgBytes(const HotFolderSettings& settings, const JobSettingTable& jobSettings,
                           const HotFolderPaths& paths, wxXmlNode& filterSetting,
                           const ImposeSettingTable& imposeSettings,
                           const PreflightSettingList& preflightSettings);

/// Makes that content the hot folder's Folder.cfg, if it still has the loaded content. Holds
/// FolderCfgLock throughout.
XmlFile::Saved SaveHotFolderSettings(HotFolder& folder, const std::string& content);

/// The section writers append one element to the root of a document under construction, or do
/// nothing if there is no root.
void WriteInputFormats(wxXmlNode* root, const std::vector<InputFormat>& formats);
void WritePaths(wxXmlNode* root, const HotFolderPaths& paths);
void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table);
void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table);
void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list);
