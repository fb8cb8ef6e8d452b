#include "appearance/folder_icon_state.h"

#include "store/folder_cfg_reader.h"

#include <wx/filename.h>

namespace
{

const wchar_t* const ErrorFileName = L"Error.er";
const wchar_t* const IconExtension = L".ico";

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

const wchar_t* IconBaseName(FolderIconState state)
{
    switch (state)
    {
    case FolderIconState::Active:
        return L"hf_folder";
    case FolderIconState::Inactive:
        return L"hf_folder_disabled";
    case FolderIconState::ErrorActive:
        return L"hf_error_active";
    case FolderIconState::ErrorInactive:
        break;
    }
    return L"hf_error_inactive";
}

} // namespace

bool GetFolderIconName(HotFolder& folder, wxString& iconName)
{
    const bool isEnabled = IsEnabled(folder);
    FolderIconState state = isEnabled ? FolderIconState::Active : FolderIconState::Inactive;
    if (HasError(folder))
        state = isEnabled ? FolderIconState::ErrorActive : FolderIconState::ErrorInactive;
    iconName = wxString(IconBaseName(state)) + IconExtension;
    return true;
}
