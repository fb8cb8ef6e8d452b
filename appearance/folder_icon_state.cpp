#include "appearance/folder_icon_state.h"

#include "store/folder_cfg_reader.h"

#include <wx/dir.h>
#include <wx/filename.h>

namespace
{

const wchar_t* const ErrorFileName = L"Error.er";
const wchar_t* const IconExtension = L".ico";

bool IsEnabled(const wxString& hotFolder)
{
    HotFolderSettings settings;
    const wxString cfgPath = FolderCfgPath(hotFolder);
    const wxCriticalSectionLocker lock(FolderCfgLock);
    if (wxFileExists(cfgPath))
        LoadHotFolderSettings(cfgPath, settings);
    return settings.Enable;
}

// The library logs a directory that it cannot open, so that is asked first; and before that whether
// the file is there at all, which is quicker than a look through the directory.
bool HasError(const wxString& hotFolder)
{
    const wxString path = PrivateDirPath(hotFolder);
    if (!wxFileName::Exists(path + ErrorFileName) || !wxFileName::IsDirReadable(path))
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

bool GetFolderIconName(const wxString& hotFolder, wxString& iconName)
{
    const bool isEnabled = IsEnabled(hotFolder);
    FolderIconState state = isEnabled ? FolderIconState::Active : FolderIconState::Inactive;
    if (HasError(hotFolder))
        state = isEnabled ? FolderIconState::ErrorActive : FolderIconState::ErrorInactive;
    iconName = wxString(IconBaseName(state)) + IconExtension;
    return true;
}
