#include "app/folder_upgrade_app.h"

wxIMPLEMENT_APP(FolderUpgradeApp);
