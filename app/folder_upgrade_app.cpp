// The application object, and in OnInit the body of the run: the switch, and the fixed order of the
// steps.
#include "run/folder_upgrade_app.h"

#include "appearance/folder_icon.h"
#include "appearance/icon_copy.h"
#include "migrate/hot_folder_impose_path.h"
#include "migrate/job_preset_files.h"
#include "migrate/job_preset_impose_path.h"
#include "run/attempt.h"
#include "store/hot_folder_list.h"

#include <wx/debug.h>

#include <optional>

namespace
{

void UpdateHotFolder(const FolderUpgradeApp& app, const wxString& path, int position)
{
    std::optional<HotFolder> folder;
    Attempt(L"Icon", path,
            [&]()
            {
                folder.emplace(path);
                UpdateFolderIcon(app, *folder);
            });
    RunLog(L"Updated icon for hf" + path, position);
    Attempt(L"HF cfg file", FolderCfgPath(path),
            [&]()
            {
                if (!folder)
                    folder.emplace(path);
                UpdateHotFolderImposePath(app, *folder);
            });
    RunLog(L"updated Impose path for hf" + path, position);
}

} // namespace

FolderUpgradeApp::FolderUpgradeApp() : m_bundleIconsDir(BundleIconsDirName)
{
}

FolderUpgradeApp::~FolderUpgradeApp() = default;

bool FolderUpgradeApp::OnInit()
{
    wxDisableAsserts();
    if (argc < 2)
        return false;
    if (argc == 3 && argv[2].CmpNoCase("V") == 0)
        RunLogEnabled = false;
    m_isUpgrade = argv[1].CmpNoCase("I") == 0;
    if (!m_isUpgrade && argv[1].CmpNoCase("U") != 0)
    {
        RunLog(L"Invalid call check calling parameter: exiting....");
        return false;
    }
    RunLog(m_isUpgrade ? L"Installation : Upgrade call with switch: I"
                       : L"Un-installation : Downgrade call with switch: U");

    wxArrayString folders;
    Attempt(L"HotFolderList.cfg", GetHotFolderListPath(),
            [&]()
            {
                wxArrayString listed;
                ReadHotFolderList(listed);
                folders = listed;
            });
    if (folders.empty())
        RunLog(L"No Hotfolder listed");

    RunLog(L"Start: HF updation");
    for (size_t i = 0; i < folders.size(); ++i)
        UpdateHotFolder(*this, folders[i], static_cast<int>(i + 1));
    RunLog(L"End: HF updation");

    RunLog(L"Start: Updating Impose path for JP Presets");
    Attempt(L"JP Presets", JobPresetRoot(), [&]() { UpdateJobPresetImposePath(*this); });
    RunLog(L"End: Updating Impose path for JP Presets");
    return false;
}
