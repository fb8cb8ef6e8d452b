// Reading Folder.cfg, part by part. Nothing is thrown or logged for bad content.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <vector>

/// Reads the root attributes and the input formats.
///
/// The attributes are read as a chain: from the first absent one on, all fields stay as they were
/// (an absent server_version becomes -1 and breaks no chain).
/// Returns 0 when there is no such file; -1 when it cannot be loaded, which leaves the record as it
/// was, or when the chain ends before server_name; 1 otherwise.
int LoadHotFolderSettings(const wxString& path, HotFolderSettings& settings);

/// Copies the "FilterSetting" element whole; without one, or when the file cannot be loaded, the
/// node stays as it was. Returns 0 in every case.
int ReadFilterSetting(const wxString& path, wxXmlNode& node);

/// What follows takes the root of a loaded document, or none. A missing section leaves the value as
/// it was; entries with too few attributes are skipped.

/// As LoadHotFolderSettings; -1 without a root.
int ReadHotFolderSettings(const wxXmlNode* root, HotFolderSettings& settings);
/// As above. The document has to be loaded with wxXMLDOC_KEEP_WHITESPACE_NODES.
void ReadFilterSetting(const wxXmlNode* root, wxXmlNode& node);
/// Returns 1 without a root or a "Paths" element, else 0.
int ReadPaths(const wxXmlNode* root, HotFolderPaths& paths);
/// Of a repeated key the first entry stays.
void ReadJobSettings(const wxXmlNode* root, JobSettingTable& table);
void ReadImposeSettings(const wxXmlNode* root, ImposeSettingTable& table);
/// Appends to the list.
void ReadInputFormats(const wxXmlNode* root, std::vector<InputFormat>& formats);
void ReadPreflightSettings(const wxXmlNode* root, PreflightSettingList& list);
