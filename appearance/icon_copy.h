// The icon that a run copies into a hot folder.
#pragma once

#include "store/hot_folder.h"

#include <wx/string.h>

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

/// Decides with the folder's state, for which it loads Folder.cfg. The name of the folder of the
/// previous version's icons is that of IconSource.
IconCopy DecideIconCopy(HotFolder& folder, bool isUpgrade, const wxString& bundleIconsDir);
