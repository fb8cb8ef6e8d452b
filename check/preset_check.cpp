#include "check/preset_check.h"

#include "check/reach.h"
#include "check/template_folders_check.h"
#include "migrate/job_preset_files.h"
#include "store/xml_encoding.h"

#include <wx/convauto.h>
#include <wx/filename.h>

#include <algorithm>

namespace
{

// How the content changes when no path moves.
wxString OtherChange(const std::string& before, const std::string& after)
{
    const wxBOM mark = wxConvAuto::DetectBOM(before.data(), before.length());
    if (mark == wxBOM_UTF8 && before.substr(3) == after)
        return "loses its byte-order mark";
    if (mark != wxBOM_None && mark != wxBOM_Unknown && mark != wxBOM_UTF8)
        return "comes out as UTF-8, without byte-order mark";
    const auto withoutLineEnds = [](std::string text)
    {
        text.erase(std::remove(text.begin(), text.end(), '\r'), text.end());
        return text;
    };
    const std::string content = mark == wxBOM_UTF8 ? before.substr(3) : before;
    if (withoutLineEnds(content) == withoutLineEnds(after))
        return mark == wxBOM_UTF8 ? "loses its byte-order mark, and its line ends become CR LF"
                                  : "its line ends become CR LF";
    return "comes out as UTF-8";
}

// Without a byte-order mark, anything that is not UTF-8 is read as Latin-1.
bool IsTakenAsLatin1(const std::string& bytes)
{
    const wxBOM mark = wxConvAuto::DetectBOM(bytes.data(), bytes.length());
    return mark == wxBOM_None && !bytes.empty() &&
           wxString::FromUTF8(bytes.data(), bytes.size()).empty();
}

void CheckContent(const wxString& name, const RewrittenPreset& rewritten, Report& report)
{
    const std::string& before = rewritten.before;
    const wxString encoding = DeclaredEncoding(rewritten.bytes);
    if (!encoding.empty() && encoding.CmpNoCase("UTF-8") != 0)
        report.Problem(name + ": declares the encoding " + encoding + ", but comes out as UTF-8");
    else if (IsTakenAsLatin1(before))
        report.Loss(name + ": is not UTF-8, so the whole file is read as Latin-1");
    if (rewritten.bytes == before)
        return;
    if (rewritten.movedPaths == 0)
        report.Change(name + ": " + OtherChange(before, rewritten.bytes));
    else
        report.Change(wxString::Format("%s: %zu path%s", name, rewritten.movedPaths,
                                       rewritten.movedPaths == 1 ? "" : "s"));
}

void CheckPreset(JobPresetFile& preset, const wxString& name, TemplateFolders& folders,
                 Report& report)
{
    const RegularFile& file = preset.GetFile();
    const RegularFile::Status opened = preset.OpenForReading();
    if (opened != RegularFile::Status::Open)
    {
        report.Problem(name + (opened == RegularFile::Status::Refused
                                   ? ": cannot be opened for reading (" +
                                         file.GetFailure().Describe(preset.GetPath()) + ")"
                                   : wxString(": reached over a link, or not a file")));
        return;
    }
    const RegularFile::Status reopened = preset.GetFile().ReopenForUpdate();
    const FailedCall reopening = file.GetFailure();
    const RewrittenPreset rewritten = preset.Decide(folders.From().path, folders.To().path);
    if (rewritten.reasonToStay)
        report.Problem(name + ": left as it is (" + rewritten.reasonToStay + ")");
    else if (reopened != RegularFile::Status::Open)
        report.Problem(name + ": cannot be opened for writing (" +
                       reopening.Describe(preset.GetPath()) + ")");
    else
        CheckContent(name, rewritten, report);
}

// Why a presets.xml that may exist cannot be seen; empty if it does not exist.
wxString WhyMissing(const JobPresetFile& preset, const wxString& directory)
{
    for (const wxString& each : {directory, wxFileName(preset.GetPath()).GetPath()})
    {
        const wxString obstacle = WhyOutOfReach(each);
        if (!obstacle.empty())
            return each + " " + obstacle;
    }
    return {};
}

// False if there is no preset.
bool CheckDirectory(const wxString& directory, const wxString& root, TemplateFolders& folders,
                    Report& report)
{
    JobPresetFile preset(directory);
    const wxString name = preset.GetPath().Mid(root.length());
    if (preset.IsThere())
    {
        CheckFoldersForPresets(folders, report);
        if (folders.From().isKnown && folders.To().isKnown)
            CheckPreset(preset, name, folders, report);
        return true;
    }
    const wxString obstacle = WhyMissing(preset, directory);
    if (!obstacle.empty())
        report.Problem(name + ": " + obstacle);
    return !obstacle.empty();
}

} // namespace

void CheckPresets(TemplateFolders& folders, Report& report)
{
    const wxString root = JobPresetRoot();
    const JobPresetDirs directories = ListJobPresetDirs(root);
    const wxString obstacle = WhyOutOfReach(root);
    if (!obstacle.empty())
        report.Problem(root + " " + obstacle);
    else if (directories.failure)
        report.Problem(root + " cannot be listed");
    bool hasPresets = !obstacle.empty() || directories.failure;
    for (const wxString& directory : directories.paths)
        hasPresets = CheckDirectory(directory, root, folders, report) || hasPresets;
    if (!hasPresets)
        report.Note(directories.isThere
                        ? "there are no presets in " + root
                        : "there are no presets, because there is no folder " + root);
}
