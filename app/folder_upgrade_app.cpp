#include "app/folder_upgrade_app.h"

FolderUpgradeApp::FolderUpgradeApp() : m_bundleIconsDir("BundleIcons")
{
}

FolderUpgradeApp::~FolderUpgradeApp() = default;
