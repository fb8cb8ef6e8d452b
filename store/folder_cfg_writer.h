// Writing Folder.cfg.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>
#include <vector>

/// The content of a Folder.cfg with the six values, and nothing else. A filter setting of another
/// name than "FilterSetting" is left out, and one deeper than MaxFilterLevels must not be given; it
/// is taken over, and empty afterwards.
std::string FolderCfgBytes(const HotFolderSettings& settings, const JobSettingTable& jobSettings,
                           const HotFolderPaths& paths, wxXmlNode& filterSetting,
                           const ImposeSettingTable& imposeSettings,
                           const PreflightSettingList& preflightSettings);

/// Makes that the content of the file, as RegularFile::Rewrite does; a file that is not there is
/// created. One that cannot be opened or written stays as it was. Holds FolderCfgLock throughout.
/// Returns 0 in every case; the library reports what cannot be opened or written.
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
