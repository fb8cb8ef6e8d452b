#include "check/preset_check.h"

#include "check/reach.h"
#include "migrate/job_preset_files.h"
#include "migrate/template_move.h"
#include "store/xml_document.h"
#include "store/xml_encoding.h"

#include <wx/convauto.h>
#include <wx/filename.h>

#include <algorithm>
#include <map>

namespace
{

// How the content changes when no path moves.
wxString OtherChange(const std::string& before, const std::string& after)
{
    const wxBOM mark = wxConvAuto::DetectBOM(before.data(), before.length());
    if (mark != wxBOM_None && mark != wxBOM_Unknown && mark != wxBOM_UTF8)
        return "comes out as UTF-8, without byte-order mark";
    const std::string content = before.substr(mark == wxBOM_UTF8 ? 3 : 0);
    if (content == after)
        return "loses its byte-order mark";
    const auto withoutLineEnds = [](std::string text)
    {
        text.erase(std::remove(text.begin(), text.end(), '\r'), text.end());
        return text;
    };
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
    const wxString encoding = DeclaredEncoding(rewritten.bytes);
    if (!encoding.empty() && encoding.CmpNoCase("UTF-8") != 0)
        report.Problem(name + "declares the encoding " + encoding + ", but comes out as UTF-8");
    else if (IsTakenAsLatin1(rewritten.before))
        report.AddLosses(name, {"is not UTF-8, so the whole file is read as Latin-1; accented "
                                "characters come out wrong"});
}

// The path as an XML parser reads it, for a look at the template; unchanged if that would refuse
// it.
wxString Decoded(const wxString& path)
{
    wxXmlDocument element;
    if (path.find('&') != wxString::npos && path.find('<') == wxString::npos)
        LoadXml("<p>" + path.utf8_string() + "</p>", FolderCfgLimits, element);
    const wxString decoded = element.IsOk() ? element.GetRoot()->GetNodeContent() : wxString();
    return decoded.empty() ? path : decoded;
}

// Why a path of a preset that is rewritten stays although it leads into the folder being left.
wxString WhyItStays(const wxString& path, const wxString& decoded, TemplateFolders& folders)
{
    const wxString& from = folders.From().path;
    if (path != decoded)
        return "stored as XML";
    if (MovedPresetPath(path, from, folders.To().path) != path)
        return "another run moves it";
    const wxString begin = decoded.Left(from.length());
    if (begin == from)
        return "no path moves";
    return begin.CmpNoCase(from) == 0 ? "other letter case" : "other separators";
}

// The changes of the file's paths, and what is at the places to which they then lead.
Findings CheckPaths(const wxString& text, bool isRewritten, TemplateCheck& check)
{
    const wxString& from = check.folders.From().path;
    const wxString& to = check.folders.To().path;
    std::map<std::pair<wxString, wxString>, size_t> paths; // stored and moved -> how often
    std::set<wxString> judged;
    Findings findings;
    for (const PresetPath& path : FindPresetPaths(text, from, to))
    {
        if (path.isCutOff)
            findings.notes.push_back("a template path has no closing quote");
        else
            ++paths[{path.stored, isRewritten ? path.moved : path.stored}];
    }
    for (const auto& [path, count] : paths)
    {
        const auto& [stored, left] = path;
        const wxString decoded = IsTooLongPath(left) ? left : Decoded(left);
        if (judged.insert(left).second)
            check.Judge(decoded,
                        isRewritten ? WhyItStays(left, decoded, check.folders)
                                    : "in a file that stays as it is",
                        findings);
        if (stored == left)
            continue;
        findings.changes.push_back(
            Shown(stored) + " -> " + Shown(left) +
            (count == 1 ? wxString() : wxString::Format(" (%zu times)", count)));
        if (MovedPresetPath(left, from, to) != left)
            check.report.ProblemOnce("one template folder is below the other: another run would "
                                     "move paths of presets again");
    }
    return findings;
}

void CheckPreset(JobPresetFile& preset, const wxString& name, TemplateCheck& check)
{
    Report& report = check.report;
    const RegularFile::Status opened = preset.OpenForReading();
    if (opened != RegularFile::Status::Open)
    {
        report.Problem(name + (opened == RegularFile::Status::Refused
                                   ? "cannot be opened for reading (" +
                                         preset.file.GetFailure().Describe(preset.path) + ")"
                                   : wxString("reached over a link, or not a file")));
        return;
    }
    const RegularFile::Status reopened = preset.file.ReopenForUpdate();
    const FailedCall reopening = preset.file.GetFailure();
    const RewrittenPreset rewritten =
        preset.Decide(check.folders.From().path, check.folders.To().path);
    wxString text;
    if (DecodePreset(rewritten.before, text))
        text.clear();
    if (!FindPresetPaths(text, {}, {}).empty())
        check.CheckForPresets();
    if (!check.folders.From().isKnown || !check.folders.To().isKnown)
        return;
    const bool isRewritten = !rewritten.reasonToStay && reopened == RegularFile::Status::Open;
    if (rewritten.reasonToStay)
        report.Problem(name + "left as it is (" + rewritten.reasonToStay + ")");
    else if (!isRewritten)
        report.Problem(name + "cannot be opened for writing (" + reopening.Describe(preset.path) +
                       ")");
    else
        CheckContent(name, rewritten, report);
    Findings findings = CheckPaths(text, isRewritten, check);
    if (isRewritten && findings.changes.empty() && rewritten.bytes != rewritten.before)
        findings.changes.push_back(OtherChange(rewritten.before, rewritten.bytes));
    report.Add(name, findings);
}

// False if there is no preset.
bool CheckDirectory(const wxString& directory, const wxString& root, TemplateCheck& check)
{
    JobPresetFile preset(directory);
    const wxString name = preset.path.Mid(root.length()) + ": ";
    if (preset.IsThere())
    {
        check.report.Attempt(name, [&]() { CheckPreset(preset, name, check); });
        return true;
    }
    for (const wxString& each : {directory, wxFileName(preset.path).GetPath()})
    {
        const wxString obstacle = WhyOutOfReach(each); // it may exist and not be seen
        if (obstacle.empty())
            continue;
        check.report.Problem(name + each + " " + obstacle);
        return true;
    }
    return false;
}

} // namespace

void CheckPresets(TemplateCheck& check)
{
    Report& report = check.report;
    const wxString root = JobPresetRoot();
    const JobPresetDirs directories = ListJobPresetDirs(root);
    const wxString obstacle = WhyOutOfReach(root);
    if (!obstacle.empty())
        report.Problem(root + " " + obstacle);
    else if (directories.failure)
        report.Problem(root + " cannot be listed");
    bool hasPresets = !obstacle.empty() || directories.failure;
    for (const wxString& directory : directories.paths)
        hasPresets = CheckDirectory(directory, root, check) || hasPresets;
    if (!hasPresets)
        report.Note(directories.isThere
                        ? "there are no presets in " + root
                        : "there are no presets, because there is no folder " + root);
}
