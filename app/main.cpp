#include "run/folder_upgrade_app.h"

wxIMPLEMENT_APP(FolderUpgradeApp);
