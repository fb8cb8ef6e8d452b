// The two standard folders that wxWidgets finds correctly only on Windows; one source for each
// system.
#pragma once

#include <wx/string.h>

/// The per-user (roaming) application data folder, without a final separator.
/// Windows: wxStandardPaths::GetUserConfigDir. Elsewhere: $XDG_CONFIG_HOME, else ~/.config.
wxString GetUserDataFolder();

/// The machine-wide application data folder, without a final separator. Windows:
/// wxStandardPaths::GetConfigDir without the application's name. Elsewhere: the first entry of
/// $XDG_CONFIG_DIRS, else /etc/xdg.
wxString GetMachineDataFolder();
