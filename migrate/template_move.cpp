#include "migrate/template_move.h"

#include "migrate/install_locations.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_encoding.h"
#include "store/xml_text.h"
#include "store/xml_tree.h"

#include <wx/confbase.h>
#include <wx/filename.h>
#include <wx/tokenzr.h>

namespace
{

using Lookup = bool (*)(wxFileName&);

bool IsAnySeparator(wxUniChar character)
{
    return character == '\\' || character == '/';
}

bool IsOnServer(const wxString& path)
{
    return path.length() > 1 && IsAnySeparator(path[0]) && IsAnySeparator(path[1]);
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

// The folder that holds the template, without a final separator.
wxString FolderOf(const wxFileName& templateFile)
{
    return templateFile.GetPath(wxPATH_GET_VOLUME, wxPATH_NATIVE);
}

} // namespace

bool IsSameFolder(const wxString& stored, const wxString& folder)
{
    const wxFileName left(stored, wxPATH_NATIVE);
    const wxFileName right(folder, wxPATH_NATIVE);
    return left.GetFullName().empty() == right.GetFullName().empty() &&
           !IsElsewhereByName(stored, folder) && right.SameAs(left, wxPATH_NATIVE);
}

TemplateMove DecideTemplateMove(const wxString& storedPath, const std::string& folderCfg,
                                bool isUpgrade)
{
    using Outcome = TemplateMove::Outcome;
    const Lookup lookUpFrom =
        isUpgrade ? GetPreviousImposeTemplatePath : GetDefaultImposeTemplatePath;
    const Lookup lookUpTo =
        isUpgrade ? GetDefaultImposeTemplatePath : GetPreviousImposeTemplatePath;
    wxFileName from;
    if (!lookUpFrom(from))
        return {Outcome::NoFromFolder, {}};
    const wxString fromPath = from.GetFullPath(wxPATH_NATIVE);
    const wxFileName templateFile(storedPath, wxPATH_NATIVE);
    const bool isInFolder = IsSameFolder(FolderOf(templateFile), fromPath);
    // In an unknown encoding, only ASCII is read correctly.
    if (!isInFolder && storedPath.IsAscii())
        return {Outcome::Elsewhere, {}};
    if (!IsReadFaithfully(folderCfg))
        return {Outcome::UnknownEncoding, {}};
    if (!isInFolder)
        return {Outcome::Elsewhere, {}};
    wxFileName to;
    if (!lookUpTo(to))
        return {Outcome::NoToFolder, {}};
    const wxString newPath = to.GetFullPath(wxPATH_NATIVE) +
                             wxFileName::GetPathSeparator(wxPATH_NATIVE) +
                             templateFile.GetFullName();
    return {IsXmlText(newPath) ? Outcome::Moves : Outcome::NotStorable, newPath};
}

RewrittenFolderCfg RewriteFolderCfg(const wxXmlNode& root, const ImposeSettingTable& imposeSettings)
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
    if (CountLevels(filterSetting) > MaxFilterLevels)
        return {L"filter setting nested too deep", {}};
    return {nullptr, FolderCfgBytes(settings, jobSettings, paths, filterSetting, imposeSettings,
                                    preflightSettings)};
}
