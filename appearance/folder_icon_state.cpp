#include "appearance/folder_icon_state.h"

#include "store/folder_cfg_reader.h"

#include <wx/dir.h>
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

// The library reports an error for a directory that it cannot open, so that is checked before
// listing. The check for the file comes first because it is quicker.
bool HasError(const HotFolder& folder)
{
    const wxString path = folder.privateDir.Reach(L"");
    if (!wxFileName::Exists(folder.privateDir.Reach(ErrorFileName), wxFILE_EXISTS_ANY) ||
        !wxFileName::IsDirReadable(path))
        return false;
    const wxDir directory(path);
    return directory.IsOpened() && directory.HasFiles(ErrorFileName);
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
