// Reading Folder.cfg, part by part. Nothing is thrown for bad content.
#pragma once

#include "store/hot_folder.h"
#include "store/hot_folder_settings.h"

/// Loads the hot folder's Folder.cfg, and reads the root attributes and the input formats.
///
/// The attributes are read as a chain: from the first missing one on, all fields stay as they were
/// (a missing server_version becomes -1 and does not end the chain). Returns 0 if there is no such
/// file; -1 if it cannot be loaded, which leaves the record as it was, or if the chain ends before
/// server_name; 1 otherwise.
int LoadHotFolderSettings(HotFolder& folder, HotFolderSettings& settings);

/// The following functions take the root of a loaded document, or null. If a section is missing,
/// the value stays as it was; entries with too few attributes are skipped.

/// Like LoadHotFolderSettings; returns -1 without a root.
int ReadHotFolderSettings(const wxXmlNode* root, HotFolderSettings& settings);
/// Copies the whole "FilterSetting" element, as CopyTree does.
void ReadFilterSetting(const wxXmlNode* root, wxXmlNode& node);
/// Returns 1 if there is no root or no "Paths" element, 0 otherwise.
int ReadPaths(const wxXmlNode* root, HotFolderPaths& paths);
/// If a key is repeated, the first entry stays.
void ReadJobSettings(const wxXmlNode* root, JobSettingTable& table);
void ReadImposeSettings(const wxXmlNode* root, ImposeSettingTable& table);
void ReadPreflightSettings(const wxXmlNode* root, PreflightSettingList& list);
/// Appends to the list.
void ReadInputFormats(const wxXmlNode* root, std::vector<InputFormat>& formats);
