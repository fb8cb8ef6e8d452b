#include "check/hot_folder_check.h"

#include "appearance/attribute_change.h"
#include "appearance/desktop_ini.h"
#include "appearance/folder_icon_state.h"
#include "appearance/icon_source.h"
#include "appearance/shell_version.h"
#include "check/folder_cfg_loss.h"
#include "check/library_errors.h"
#include "check/reach.h"
#include "migrate/template_move.h"
#include "platform/access_rights.h"
#include "platform/file_copy.h"
#include "platform/regular_file.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_reader.h"
#include "store/hot_folder.h"
#include "store/root_attributes.h"
#include "store/xml_encoding.h"
#include "store/xml_file.h"

#include <wx/filename.h>

#include <array>

namespace
{

// Appearance
// ---------------------------------------------------------------------------------------------------

constexpr DWORD ComparedAttributes =
    FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM;

wxString AttributeNames(DWORD attributes)
{
    wxString names;
    if ((attributes & FILE_ATTRIBUTE_READONLY) != 0)
        names += " READONLY";
    if ((attributes & FILE_ATTRIBUTE_HIDDEN) != 0)
        names += " HIDDEN";
    if ((attributes & FILE_ATTRIBUTE_SYSTEM) != 0)
        names += " SYSTEM";
    return names.empty() ? wxString(" none") : names;
}

void CheckAttributes(const wxString& name, const wxString& path, DWORD wanted, Report& report)
{
    const DWORD attributes = GetFileAttributesW(path.wc_str());
    if (attributes == INVALID_FILE_ATTRIBUTES || (attributes & ComparedAttributes) == wanted)
        return;
    if (MayChangeAttributes(path))
        report.Change(name + ": attributes" + AttributeNames(attributes) + " ->" +
                      AttributeNames(wanted));
    else
        report.Problem(name + ": its attributes cannot be changed");
}

// The names of the keys whose values differ.
wxString ChangedKeys(const wxString& path, const wxString& iconName)
{
    constexpr DWORD Capacity = 1024; // characters; longer than any of our values
    wxString names;
    for (const DesktopIniKey& each : DesktopIniKeys(true, iconName))
    {
        std::array<wchar_t, Capacity> value{};
        GetPrivateProfileStringW(DesktopIniSection, each.key, L"", value.data(), Capacity,
                                 path.wc_str());
        if (each.value != value.data())
            names += (names.empty() ? wxString() : wxString(", ")) + each.key;
    }
    return names;
}

// Read-only is removed before the keys are written, so it stops nobody who may change attributes.
bool MayWriteIni(const wxString& path)
{
    if ((GetFileAttributesW(path.wc_str()) & FILE_ATTRIBUTE_READONLY) != 0)
        return MayChangeAttributes(path);
    RegularFile ini;
    return ini.OpenForUpdate(path, Links::Refuse) == RegularFile::Status::Open;
}

void CheckKeys(const wxString& path, const wxString& iconName, Report& report)
{
    RegularFile ini;
    const bool isReadable = ini.OpenForReading(path, Links::Refuse) == RegularFile::Status::Open;
    ini.Close();
    const wxString changed = isReadable ? ChangedKeys(path, iconName) : wxString();
    if (!isReadable || (!changed.empty() && !MayWriteIni(path)))
        report.Problem("Desktop.ini: cannot be opened for reading and writing");
    else if (!changed.empty())
        report.Change("Desktop.ini: " + changed);
}

void CheckDesktopIni(const PinnedDirectory& directory, const wxString& iconName, Report& report)
{
    const wxString path = directory.Reach(DesktopIniName);
    const bool isCustomised = GetPackedShellVersion() >= CustomFolderVersion;
    if (IsLink(path))
        report.Problem("Desktop.ini: left as it is (reached over a link)");
    else if (wxFileExists(path))
    {
        if (isCustomised)
            CheckKeys(path, iconName, report);
        CheckAttributes("Desktop.ini", path, ReadOnlyAndSystem, report);
    }
    else if (wxFileName::Exists(path))
    {
        report.Problem("Desktop.ini: is not a file");
        CheckAttributes("Desktop.ini", path, ReadOnlyAndSystem, report);
    }
    else if (isCustomised && MayCreateIn(directory.Reach(L"")))
        report.Change("Desktop.ini: new");
    else if (isCustomised)
        report.Problem(
            "Desktop.ini: cannot be created, because the hot folder cannot be written to");
    if (!isCustomised)
        return;
    const wxString folder = directory.Reach(L"");
    const DWORD attributes = GetFileAttributesW(folder.wc_str());
    const DWORD wanted = (attributes | FILE_ATTRIBUTE_SYSTEM) & ~DWORD{FILE_ATTRIBUTE_READONLY};
    CheckAttributes("hot folder", folder, wanted & ComparedAttributes, report);
}

void CheckIcon(const PinnedHotFolder& folder, const wxString& hotFolder, bool isUpgrade,
               Report& report)
{
    wxString name;
    GetFolderIconName(folder, hotFolder, name);
    TakeLibraryErrors(); // errors about Folder.cfg were reported with the template
    const wxString destination = folder.privateDir.Reach(name);
    const wxString source = SourceIconPath(name, isUpgrade, BundleIconsDirName);
    if (IsLink(destination))
        report.Problem(name + ": reached over a link");
    else if (!wxFileExists(destination))
        report.Note("no copy of the icon to replace: " + name);
    else if (!wxFileExists(source))
        report.ProblemOnce("source icon missing: " + source);
    else
    {
        if (!MayCopyOver(source, destination))
            report.Problem(name + ": the copy would be refused");
        else if (!IsCopy(source, destination))
            report.Change(name);
        CheckDesktopIni(folder.directory, name, report);
    }
}

// Folder.cfg
// ---------------------------------------------------------------------------------------------------

void CheckMissing(const PinnedHotFolder& folder, Report& report)
{
    const wxString path = folder.privateDir.Reach(FolderCfgName);
    if (IsLink(path))
        report.Problem("Folder.cfg: reached over a link");
    else if (wxFileName::Exists(path))
        report.Problem("Folder.cfg: is not a file");
    else
        report.Note("no Folder.cfg");
}

void CheckShownState(const wxXmlNode& root, Report& report)
{
    const RootAttribute* gap = FindGapBeforeEnable(root);
    if (gap)
        report.Problem(wxString("Folder.cfg: lacks the attribute \"") + gap->name +
                       "\", so the enabled folder shows as disabled");
}

// False when the file is not rewritten.
bool CheckMove(XmlFile& cfg, const TemplateMove& move, const wxString& stored,
               const ImposeSettingTable& table, Report& report)
{
    // The new path makes no difference to what is lost.
    const RewrittenFolderCfg rewritten = RewriteFolderCfg(*cfg.GetRoot(), table);
    if (rewritten.reasonToStay)
    {
        report.Problem(wxString("Folder.cfg: left as it is (") + rewritten.reasonToStay + ")");
        return false;
    }
    if (cfg.ReopenForUpdate() != RegularFile::Status::Open)
    {
        report.Problem("Folder.cfg: cannot be opened for writing (" + TakeLibraryErrors() + ")");
        return false;
    }
    if (stored == move.newPath && rewritten.bytes == cfg.GetBytes())
        return true;
    for (const wxString& loss : FindFolderCfgLosses(cfg.GetDocument(), rewritten.bytes))
        report.Problem("Folder.cfg: " + loss);
    report.Change("Folder.cfg: " + stored + " -> " + move.newPath);
    if (!IsUtf8(cfg.GetBytes()))
        report.Note("Folder.cfg: comes out as UTF-8");
    if (!wxFileName::Exists(move.newPath))
        report.Note("no such file: " + move.newPath);
    return true;
}

// False when the file is not rewritten.
bool CheckTemplate(XmlFile& cfg, const TemplateFolders& folders, Report& report)
{
    ImposeSettingTable table;
    ReadImposeSettings(cfg.GetRoot(), table);
    const auto entry = table.find(FolderCfg::ImposeTemplateKey);
    if (entry == table.end())
        return false;
    const wxString stored = entry->second.Value;
    folders.ReportFrom(report);
    const TemplateMove move = DecideTemplateMove(stored, cfg.GetBytes(), folders.IsUpgrade());
    switch (move.outcome)
    {
    case TemplateMove::Outcome::NoFromFolder:
        break;
    case TemplateMove::Outcome::NoToFolder:
        folders.ReportTo(report);
        break;
    case TemplateMove::Outcome::Elsewhere:
        if (!stored.empty() &&
            !IsSameFolder(
                wxFileName(stored, wxPATH_NATIVE).GetPath(wxPATH_GET_VOLUME, wxPATH_NATIVE),
                folders.To()))
            report.Note("template elsewhere: " + stored);
        break;
    case TemplateMove::Outcome::UnknownEncoding:
        report.Problem("Folder.cfg: left as it is (unknown encoding)");
        break;
    case TemplateMove::Outcome::NotStorable:
        folders.ReportTo(report);
        report.Problem(
            "Folder.cfg: left as it is (new path holds a character that XML cannot store)");
        break;
    case TemplateMove::Outcome::Moves:
        folders.ReportTo(report);
        return CheckMove(cfg, move, stored, table, report);
    }
    return false;
}

void CheckFolderCfg(const PinnedHotFolder& folder, const wxString& hotFolder,
                    const TemplateFolders& folders, Report& report)
{
    XmlFile cfg;
    switch (
        cfg.Load(folder.privateDir.Reach(FolderCfgName), Links::Refuse, FolderCfgPath(hotFolder)))
    {
    case XmlFile::State::Missing:
        CheckMissing(folder, report);
        break;
    case XmlFile::State::TooLarge:
        report.Problem("Folder.cfg: left as it is (too large to read safely)");
        break;
    case XmlFile::State::NotReadable:
        report.Problem("Folder.cfg: " + TakeLibraryErrors());
        break;
    case XmlFile::State::Loaded:
        if (!FindElement(cfg.GetRoot(), FolderCfg::ImposeSettingSection, true) ||
            !CheckTemplate(cfg, folders, report))
            CheckShownState(*cfg.GetRoot(), report);
        break;
    }
}

// What prevents a run from reaching anything in the private directory.
wxString FindObstacle(const PinnedHotFolder& folder, const wxString& hotFolder)
{
    const wxString obstacle = WhyOutOfReach(hotFolder);
    if (!obstacle.empty())
        return "the hot folder " + obstacle;
    const wxString privateDir = folder.directory.Reach(PrivateDirName);
    if (IsLink(privateDir))
        return wxString(PrivateDirName) + ": reached over a link";
    if (wxDirExists(privateDir) && !MayEnter(folder.privateDir))
        return wxString(PrivateDirName) + ": cannot be entered";
    return {};
}

} // namespace

void CheckHotFolder(const wxString& hotFolder, const TemplateFolders& folders, Report& report)
{
    const PinnedHotFolder folder(hotFolder);
    const wxString obstacle = FindObstacle(folder, hotFolder);
    if (!obstacle.empty())
    {
        report.Problem(obstacle);
        return;
    }
    CheckFolderCfg(folder, hotFolder, folders, report);
    CheckIcon(folder, hotFolder, folders.IsUpgrade(), report);
    const wxString errors = TakeLibraryErrors();
    if (!errors.empty())
        report.Problem(errors);
}
