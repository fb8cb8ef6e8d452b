#include "appearance/icon_copy.h"

#include "appearance/folder_icon_state.h"
#include "appearance/icon_source.h"

#include <wx/filename.h>

IconCopy DecideIconCopy(HotFolder& folder, bool isUpgrade, const wxString& bundleIconsDir)
{
    using Outcome = IconCopy::Outcome;
    IconCopy copy;
    GetFolderIconName(folder, copy.name);
    copy.source = SourceIconPath(copy.name, isUpgrade, bundleIconsDir);
    const wxString destination = folder.privateDir.Reach(copy.name);
    if (IsLink(destination))
        copy.outcome = Outcome::Linked;
    else if (!wxFileExists(destination))
        copy.outcome = Outcome::NoCopy;
    else
        copy.outcome = wxFileExists(copy.source) ? Outcome::Replaces : Outcome::NoSource;
    return copy;
}
