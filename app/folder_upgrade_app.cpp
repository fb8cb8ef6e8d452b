// The application object, and in OnInit the body of the run: the switch, and the fixed order of the
// steps.
#include "run/folder_upgrade_app.h"

#include "appearance/folder_icon.h"
#include "appearance/icon_copy.h"
#include "migrate/hot_folder_impose_path.h"
#include "migrate/job_preset_impose_path.h"
#include "run/attempt.h"
#include "store/hot_folder_list.h"

#include <wx/arrstr.h>
#include <wx/debug.h>

#include <optional>

namespace
{

enum class Switch
{
    Upgrade,
    Downgrade,
    Invalid
};

Switch ReadSwitch(const wxString& text)
{
    if (text.CmpNoCase("I") == 0)
        return Switch::Upgrade;
    return text.CmpNoCase("U") == 0 ? Switch::Downgrade : Switch::Invalid;
}

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
    if (folder)
        Attempt(L"HF cfg file", FolderCfgPath(path),
                [&]() { UpdateHotFolderImposePath(app, *folder); });
    RunLog(L"updated Impose path for hf" + path, position);
}

wxArrayString ListHotFolders()
{
    wxArrayString folders;
    Attempt(L"HotFolderList.cfg", GetHotFolderListPath(),
            [&]()
            {
                wxArrayString read;
                ReadHotFolderList(read);
                folders = read;
            });
    return folders;
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
    switch (ReadSwitch(argv[1]))
    {
    case Switch::Upgrade:
        m_isUpgrade = true;
        RunLog(L"Installation : Upgrade call with switch: I");
        break;
    case Switch::Downgrade:
        m_isUpgrade = false;
        RunLog(L"Un-installation : Downgrade call with switch: U");
        break;
    case Switch::Invalid:
        RunLog(L"Invalid call check calling parameter: exiting....");
        return false;
    }

    const wxArrayString folders = ListHotFolders();
    if (folders.empty())
        RunLog(L"No Hotfolder listed");

    RunLog(L"Start: HF updation");
    for (size_t i = 0; i < folders.size(); ++i)
        UpdateHotFolder(*this, folders[i], static_cast<int>(i + 1));
    RunLog(L"End: HF updation");

    RunLog(L"Start: Updating Impose path for JP Presets");
    UpdateJobPresetImposePath(*this);
    RunLog(L"End: Updating Impose path for JP Presets");
    return false;
}
