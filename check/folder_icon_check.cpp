#include "check/folder_icon_check.h"

#include "appearance/desktop_ini.h"
#include "appearance/icon_copy.h"
#include "platform/access_rights.h"
#include "platform/file_copy.h"

namespace
{

wxString AttributeNames(DWORD attributes)
{
    const std::pair<DWORD, const char*> all[] = {
        {FILE_ATTRIBUTE_READONLY, " READONLY"},
        {FILE_ATTRIBUTE_HIDDEN, " HIDDEN"},
        {FILE_ATTRIBUTE_SYSTEM, " SYSTEM"},
        {FILE_ATTRIBUTE_TEMPORARY, " TEMPORARY"},
        {FILE_ATTRIBUTE_OFFLINE, " OFFLINE"},
        {FILE_ATTRIBUTE_NOT_CONTENT_INDEXED, " NOT_CONTENT_INDEXED"},
    };
    wxString names;
    for (const auto& [attribute, name] : all)
        names += (attributes & attribute) != 0 ? name : "";
    return names.empty() ? wxString(" none") : names;
}

void CheckAttributes(const wxString& name, const wxString& path, const AttributeChange& change,
                     Report& report)
{
    if (change.before == change.after)
        return;
    if (MayChangeAttributes(path))
        report.Change(name + ": attributes" + AttributeNames(change.before) + " ->" +
                      AttributeNames(change.after));
    else
        report.Problem(name + ": its attributes cannot be changed");
}

// Read-only is removed before the keys are written, so it stops nobody who may change attributes.
std::optional<FailedCall> WhyNotWritten(const HotFolder& folder, const DesktopIniChange& change)
{
    if (change.kind == DesktopIniChange::Kind::NotReadable)
        return change.failure;
    const bool isReadOnly = (change.ini.before & FILE_ATTRIBUTE_READONLY) != 0;
    RegularFile ini;
    if (change.keys.empty() ||
        (isReadOnly && MayChangeAttributes(folder.directory.Reach(DesktopIniName))) ||
        ini.OpenForUpdate(folder.directory, DesktopIniName) == RegularFile::Status::Open)
        return {};
    return ini.GetFailure();
}

wxString KeyNames(const std::vector<DesktopIniKey>& keys)
{
    wxString names;
    for (const DesktopIniKey& each : keys)
        names += (names.empty() ? wxString() : wxString(", ")) + each.key;
    return names;
}

void CheckDesktopIni(const HotFolder& folder, const wxString& iconName, Report& report)
{
    using Kind = DesktopIniChange::Kind;
    const DesktopIniChange change = DecideDesktopIni(folder, iconName);
    const wxString path = folder.directory.Reach({});
    if (change.kind == Kind::Stays)
        report.Problem(wxString("Desktop.ini: left as it is (") + change.reasonToStay + ")");
    else if (change.kind == Kind::NotAFile)
        report.Problem("Desktop.ini: is not a file");
    else if (change.kind == Kind::Create && !MayCreateIn(path))
        report.Problem(
            "Desktop.ini: cannot be created, because the hot folder cannot be written to");
    else if (change.kind == Kind::Create)
        report.Change("Desktop.ini: new");
    else if (const auto failure = WhyNotWritten(folder, change))
        report.Problem("Desktop.ini: cannot be opened for reading and writing" + failure->Reason());
    else if (!change.keys.empty())
        report.Change("Desktop.ini: " + KeyNames(change.keys));
    if (change.kind != Kind::Create)
        CheckAttributes("Desktop.ini", folder.directory.Reach(DesktopIniName), change.ini, report);
    CheckAttributes("hot folder", path, change.folder, report);
}

} // namespace

void CheckFolderIcon(HotFolder& folder, TemplateCheck& check)
{
    Report& report = check.report;
    const IconCopy copy = DecideIconCopy(folder, check.folders.isUpgrade, BundleIconsDirName);
    if (copy.outcome == IconCopy::Outcome::Linked)
        report.Problem(copy.name + ": reached over a link");
    else if (copy.outcome == IconCopy::Outcome::NoCopy)
        report.Note("no copy of the icon to replace: " + copy.name);
    else if (copy.outcome == IconCopy::Outcome::NoSource && check.folders.isRehearsal)
        report.NoteOnce(
            "the icons being installed are not there, so icons are left out of this check");
    else if (copy.outcome == IconCopy::Outcome::NoSource)
        report.ProblemOnce("source icon missing: " + copy.source);
    else if (const auto failure = WhyNotCopied(copy.source, folder.privateDir, copy.name))
        report.Problem(copy.name + ": cannot be replaced with " + copy.source + failure->Reason());
    else if (!IsCopy(copy.source, folder.privateDir, copy.name))
        report.Change(copy.name);
    if (copy.outcome == IconCopy::Outcome::Replaces)
        CheckDesktopIni(folder, copy.name, report);
}
