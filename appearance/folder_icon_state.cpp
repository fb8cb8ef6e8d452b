#include "appearance/folder_icon_state.h"

#include "store/folder_cfg_reader.h"

#include <wx/filename.h>

namespace
{

const wchar_t* const ErrorFileName = L"Error.er";

bool IsEnabled(HotFolder& folder)
{
    HotFolderSettings settings;
    const wxCriticalSectionLocker lock(FolderCfgLock);
    LoadHotFolderSettings(folder, settings);
    return settings.Enable;
}

// A link counts by its name: its target may be on a drive that does not answer.
bool HasError(const HotFolder& folder)
{
    const wxString path = folder.privateDir.Reach(ErrorFileName);
    return wxFileName::IsDirReadable(folder.privateDir.Reach({})) &&
           (IsLink(path) ||
            (wxFileName::Exists(path, wxFILE_EXISTS_ANY | wxFILE_EXISTS_NO_FOLLOW) &&
             !wxDirExists(path)));
}

} // namespace

bool GetFolderIconName(HotFolder& folder, wxString& iconName)
{
    const bool isEnabled = IsEnabled(folder);
    iconName = isEnabled ? L"hf_folder.ico" : L"hf_folder_disabled.ico";
    if (HasError(folder))
        iconName = isEnabled ? L"hf_error_active.ico" : L"hf_error_inactive.ico";
    return true;
}
