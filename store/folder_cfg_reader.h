// Reading Folder.cfg, part by part. Nothing is thrown or logged for bad content.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <vector>

/// The hot folder's private directory, with a final separator; the folder's path may have one too.
wxString PrivateDirPath(const wxString& hotFolder);

/// The path of the hot folder's Folder.cfg, which lies in its private directory.
wxString FolderCfgPath(const wxString& hotFolder);

/// Loads the document with wxXmlDocument::Load; false when it does not load or has no root.
/// The library logs what it cannot open or parse. flags are those of wxXmlDocument::Load.
bool LoadFolderCfg(const wxString& path, wxXmlDocument& document, int flags = wxXMLDOC_NONE);

/// Reads the root attributes and the input formats.
///
/// The attributes are read as a chain: from the first absent one on, all fields stay as they were
/// (an absent server_version becomes -1 and breaks no chain).
/// Returns 0 when there is no such file; -1 when it cannot be loaded, which leaves the record as it
/// was, or when the chain ends before server_name; 1 otherwise.
/// loaded, where given, tells whether the file could be loaded.
int LoadHotFolderSettings(const wxString& path, HotFolderSettings& settings,
                          bool* loaded = nullptr);

/// Copies the "FilterSetting" element whole; without one, or when the file cannot be loaded, the
/// node stays as it was. Returns 0 in every case; loaded as above.
int ReadFilterSetting(const wxString& path, wxXmlNode& node, bool* loaded = nullptr);

/// The section readers take the root of a loaded document, or none. A missing section leaves the
/// value as it was; entries with too few attributes are passed over.

/// Returns 1 without a root or a "Paths" element, else 0.
int ReadPaths(const wxXmlNode* root, HotFolderPaths& paths);
/// Of a repeated key the first entry stays.
void ReadJobSettings(const wxXmlNode* root, JobSettingTable& table);
void ReadImposeSettings(const wxXmlNode* root, ImposeSettingTable& table);
/// Appends to the list.
void ReadInputFormats(const wxXmlNode* root, std::vector<InputFormat>& formats);
void ReadPreflightSettings(const wxXmlNode* root, PreflightSettingList& list);
