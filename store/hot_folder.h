// A hot folder on disk, and what the client keeps in it.
#pragma once

#include "platform/pinned_directory.h"

#include <wx/string.h>

/// The directory, directly inside a hot folder, in which the client keeps the folder's settings and
/// icons.
constexpr const wchar_t* PrivateDirName = L"[_ORX_HotFolder_]";
constexpr const wchar_t* FolderCfgName = L"Folder.cfg";

/// The hot folder's private directory, with a final separator; the folder's path may have one too.
wxString PrivateDirPath(const wxString& hotFolder);

/// The path of the hot folder's Folder.cfg, in its private directory.
wxString FolderCfgPath(const wxString& hotFolder);

/// A hot folder and its private directory, which cannot be replaced while a step works in them. The
/// hot folder may be reached over links; a private directory that is a link counts as missing.
struct PinnedHotFolder
{
    explicit PinnedHotFolder(const wxString& path);

    const PinnedDirectory directory;
    const PinnedDirectory privateDir;
};
