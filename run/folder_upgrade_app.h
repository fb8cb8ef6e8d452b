// The application object, which lives for the whole run and carries its state to the steps. Its
// functions are in app/folder_upgrade_app.cpp, which calls the steps.
#pragma once

#include <wx/app.h>

class FolderUpgradeApp : public wxApp
{
  public:
    FolderUpgradeApp();
    ~FolderUpgradeApp() override;

    /// The whole run. Returns false on every path, so that the library enters no event loop and the
    /// process ends with exit status -1; the run log says what happened.
    bool OnInit() override;

    /// Upgrade (switch "I") or downgrade (switch "U"); set before any step reads it.
    bool m_isUpgrade = false;

    /// The name of the folder of icons that ships beside the executable.
    wxString m_bundleIconsDir;
};
