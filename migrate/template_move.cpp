#include "migrate/template_move.h"

#include "platform/path_normal_form.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_document.h"
#include "store/xml_lookup.h"

#include <wx/confbase.h>
#include <wx/filename.h>
#include <wx/log.h>
#include <wx/tokenzr.h>

#include <algorithm>

namespace
{

bool IsOnServer(const wxString& path)
{
    return path.length() > 1 && path.Left(2).find_first_not_of("\\/") == wxString::npos;
}

// "\\host\share", in lower case and with backslashes; of "\\?\UNC\host\share\x" and the like,
// enough parts to include the host.
wxString Share(const wxString& path)
{
    wxStringTokenizer parts(path.Lower(), "\\/", wxTOKEN_STRTOK);
    wxString share;
    size_t count = 2;
    for (size_t i = 0; i < count && parts.HasMoreTokens(); ++i)
    {
        const wxString part = parts.GetNextToken();
        if (i == 0 && (part == "?" || part == "."))
            count = 4;
        share += "\\" + part;
    }
    return share;
}

// A variable may also expand to a server or a drive.
bool IsElsewhereByName(const wxString& stored, const wxString& folder)
{
    const wxString path = wxExpandEnvVars(stored);
    const wxString other = wxExpandEnvVars(folder);
    if (IsOnServer(path) || IsOnServer(stored))
        return !IsOnServer(other) || Share(path) != Share(other);
    const wxString drive = wxFileName(path).GetVolume();
    const wxString otherDrive = wxFileName(other).GetVolume();
    if (!drive.empty() && !otherDrive.empty() && drive.CmpNoCase(otherDrive) != 0)
        return true;
    wxFileName folded(path);
    folded.Normalize(wxPATH_NORM_DOTS, wxString(), wxPATH_NATIVE);
    return folded.GetExt().CmpNoCase("lnk") == 0;
}

void Stay(TemplateMove& move, const wchar_t* reason)
{
    move.outcome = TemplateMove::Outcome::Stays;
    move.reasonToStay = reason;
}

void DecideFolder(const XmlFile& cfg, TemplateFolders& folders, TemplateMove& move)
{
    move.outcome = TemplateMove::Outcome::FromUnknown;
    if (!folders.From().isKnown)
        return;
    const bool isInFolder = IsDirectlyIn(move.storedPath, folders.From().path);
    move.outcome = TemplateMove::Outcome::Elsewhere;
    // In an unknown encoding, only ASCII is read correctly.
    if (!cfg.isFaithful && (isInFolder || !move.storedPath.IsAscii()))
        Stay(move, L"unknown encoding");
    else if (isInFolder)
        move.outcome =
            folders.To().isKnown ? TemplateMove::Outcome::Moves : TemplateMove::Outcome::ToUnknown;
    if (move.outcome != TemplateMove::Outcome::Moves)
        return;
    move.newPath = folders.To().path + wxFileName::GetPathSeparator(wxPATH_NATIVE) +
                   wxFileName(move.storedPath, wxPATH_NATIVE).GetFullName();
    if (!IsXmlText(move.newPath))
        Stay(move, L"new path holds a character that XML cannot store");
}

// The content of Folder.cfg with the root's settings and this imposition table.
void MakeContent(const wxXmlNode& root, const ImposeSettingTable& imposeSettings,
                 TemplateMove& move)
{
    JobSettingTable jobSettings;
    HotFolderPaths paths;
    wxXmlNode filterSetting;
    PreflightSettingList preflightSettings;
    HotFolderSettings settings;
    ReadJobSettings(&root, jobSettings);
    ReadPaths(&root, paths);
    ReadFilterSetting(&root, filterSetting);
    ReadPreflightSettings(&root, preflightSettings);
    ReadHotFolderSettings(&root, settings);
    move.newContent = FolderCfgBytes(settings, jobSettings, paths, filterSetting, imposeSettings,
                                     preflightSettings);
    if (move.newContent.empty())
        Stay(move, NewContentTooLarge);
}

} // namespace

// Windows has no longer path than 32,767 characters. The library copies the rest of the path for
// every variable in it.
bool IsTooLongPath(const wxString& path)
{
    constexpr size_t LongestPath = 32767;
    constexpr std::ptrdiff_t MostVariables = 100;
    return path.length() > LongestPath ||
           std::count_if(path.begin(), path.end(),
                         [](wxUniChar character)
                         { return character == '$' || character == '%'; }) > MostVariables;
}

bool IsDirectlyIn(const wxString& stored, const wxString& folder)
{
    if (IsTooLongPath(stored))
        return false;
    const wxLogNull noWarnings; // of variables that are not there
    wxFileName left(wxFileName(stored, wxPATH_NATIVE).GetPath(wxPATH_GET_VOLUME, wxPATH_NATIVE),
                    wxPATH_NATIVE);
    wxFileName right(folder, wxPATH_NATIVE);
    if (left.GetFullName().empty() != right.GetFullName().empty() ||
        IsElsewhereByName(left.GetFullPath(), folder))
        return false;
    for (wxFileName* each : {&left, &right})
        each->Normalize(NormalizeAll | wxPATH_NORM_CASE, wxString(), wxPATH_NATIVE);
    return left.GetFullPath() == right.GetFullPath();
}

TemplateMove DecideTemplateMove(const XmlFile& cfg, TemplateFolders& folders)
{
    using Outcome = TemplateMove::Outcome;
    TemplateMove move;
    if (!FindElement(cfg.Root(), FolderCfg::ImposeSettingSection, true))
        return move;
    ImposeSettingTable table;
    ReadImposeSettings(cfg.Root(), table);
    const auto entry = table.find(FolderCfg::ImposeTemplateKey);
    move.outcome = Outcome::NoTemplate;
    if (entry == table.end())
        return move;
    move.storedPath = entry->second.Value;
    DecideFolder(cfg, folders, move);
    if (move.outcome == Outcome::Moves)
    {
        SetImposeSetting(table, FolderCfg::ImposeTemplateKey, move.newPath,
                         entry->second.KeyDisplayValue);
        MakeContent(*cfg.Root(), table, move);
    }
    return move;
}
