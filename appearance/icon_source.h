// Where a run takes the state icons from.
#pragma once

#include <wx/string.h>

/// The name of the folder beside the executable that holds the previous version's icons.
constexpr const wchar_t* BundleIconsDirName = L"BundleIcons";

/// The full path of the icon: an upgrade takes it from the executable's directory, a downgrade from
/// the bundle icons directory in it. Does not check that it exists.
wxString SourceIconPath(const wxString& iconName, bool isUpgrade, const wxString& bundleIconsDir);
