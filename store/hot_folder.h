// A hot folder on disk, and what the client keeps in it.
#pragma once

#include "platform/pinned_directory.h"
#include "store/xml_file.h"

/// The directory in a hot folder in which the client keeps the folder's settings and icons.
constexpr const wchar_t* PrivateDirName = L"[_ORX_HotFolder_]";
constexpr const wchar_t* FolderCfgName = L"Folder.cfg";

/// The hot folder's private directory, with a final separator; the folder's path may have one too.
wxString PrivateDirPath(const wxString& hotFolder);
/// The path of the Folder.cfg in it.
wxString FolderCfgPath(const wxString& hotFolder);

/// A hot folder, which cannot be replaced while the steps of a run work in it. It may be reached
/// over links; a private directory that is a link counts as missing.
struct HotFolder
{
    explicit HotFolder(const wxString& listedPath);

    /// Opens Folder.cfg by its name, as the client may have replaced it, and loads it.
    XmlFile::State LoadCfg();

    const wxString path; // as it is listed; for messages and the shell
    const PinnedDirectory directory;
    const PinnedDirectory privateDir;
    XmlFile cfg{FolderCfgLimits};
};
