// Where the run log is.
#pragma once

#include <wx/string.h>

constexpr const wchar_t* RunLogFileName = L"UpgradeDowngrade.log";

/// The log's folder, ORX_Installers in the per-user application data folder, with a final
/// separator. Does not check that it exists; the tool never creates it.
wxString RunLogDirPath();
