// Writing Folder.cfg.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <vector>

/// Rewrites the whole file from the six values; nothing of the old file survives but what is in
/// them. The file is opened in place, so an interrupted write leaves a part of it; a file that
/// cannot be opened stays as it was. A filter setting of another name than "FilterSetting" is not
/// written, and one deeper than MaxFilterLevels must not be given. Holds FolderCfgLock throughout.
/// Returns 0 in every case; the library logs what it cannot open or write.
int SaveHotFolderSettings(const wxString& path, const HotFolderSettings& settings,
                          const JobSettingTable& jobSettings, const HotFolderPaths& paths,
                          const wxXmlNode& filterSetting, const ImposeSettingTable& imposeSettings,
                          const PreflightSettingList& preflightSettings);

/// The levels below a filter setting that can be saved: wxXmlDocument::Save recurses, and indents
/// in a time and to a size that grow with the square of the depth.
constexpr int MaxFilterLevels = 1024;

/// The section writers append one element to the root of a document under construction, or do
/// nothing when there is none.
void WriteInputFormats(wxXmlNode* root, const std::vector<InputFormat>& formats);
void WritePaths(wxXmlNode* root, const HotFolderPaths& paths);
void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table);
void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table);
void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list);
