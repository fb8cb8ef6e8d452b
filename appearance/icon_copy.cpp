#include "appearance/icon_copy.h"

#include "platform/path_normal_form.h"
#include "store/folder_cfg_reader.h"

#include <wx/stdpaths.h>

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

wxString SourceIconPath(const wxString& iconName, bool isUpgrade, const wxString& bundleIconsDir)
{
    wxFileName source(wxStandardPaths::Get().GetExecutablePath());
    if (!isUpgrade)
        source.AppendDir(bundleIconsDir);
    source.SetFullName(iconName);
    source.Normalize(NormalizeAll, wxString(), wxPATH_NATIVE);
    return source.GetFullPath();
}

} // namespace

bool GetFolderIconName(HotFolder& folder, wxString& iconName)
{
    const bool isEnabled = IsEnabled(folder);
    FolderIconState state = isEnabled ? FolderIconState::Active : FolderIconState::Inactive;
    if (HasError(folder))
        state = isEnabled ? FolderIconState::ErrorActive : FolderIconState::ErrorInactive;
    iconName = wxString(IconBaseName(state)) + L".ico";
    return true;
}

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
