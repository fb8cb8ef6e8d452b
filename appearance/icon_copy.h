// The icon that a run copies into a hot folder.
#pragma once

#include "store/hot_folder.h"

/// The name of the folder beside the executable that holds the previous version's icons.
constexpr const wchar_t* BundleIconsDirName = L"BundleIcons";

enum class FolderIconState
{
    Active = 1,
    Inactive = 2,
    ErrorActive = 3,
    ErrorInactive = 4
};

/// Gives the file name, without a directory, of the icon for the folder's state: whether its
/// Folder.cfg enables it (not if it cannot be read), and whether its private directory holds a file
/// "Error.er" (not if it is missing or cannot be listed). Changes nothing; returns true.
bool GetFolderIconName(HotFolder& folder, wxString& iconName);

struct IconCopy
{
    enum class Outcome
    {
        Linked, // the copy in the private directory is reached over a link, so it stays as it is
        NoCopy, // there is none to replace
        NoSource,
        Replaces
    };

    Outcome outcome = Outcome::NoCopy;
    wxString name;   // of both, without a directory
    wxString source; // full path
};

/// Decides with the folder's state, for which it loads Folder.cfg. An upgrade takes the icon from
/// the executable's directory, a downgrade from the bundle icons directory in it.
IconCopy DecideIconCopy(HotFolder& folder, bool isUpgrade, const wxString& bundleIconsDir);
