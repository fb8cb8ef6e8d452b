// Any bytes as a Folder.cfg: what loads comes out of a save as it went in, and what does not load
// leaves every value as it was.
#include "fuzz/fuzzing.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_encoding.h"
#include "store/xml_tree.h"

#include <wx/sstream.h>

#include <tuple>

namespace
{

struct Values
{
    HotFolderSettings settings;
    HotFolderPaths paths;
    JobSettingTable jobSettings;
    ImposeSettingTable imposeSettings;
    PreflightSettingList preflightSettings;
    wxXmlNode filterSetting;
};

auto RootFields(const HotFolderSettings& s)
{
    return std::tie(s.name, s.description, s.server_ip, s.server_name, s.server_version, s.server_textversion, s.server_type,
                    s.BaseVirtualPrinter, s.BaseVirtualPrinterName, s.HFPresetName, s.PPDVersion, s.BaseVirtualPrinterDisplayName, s.Enable,
                    s.Centralized, s.Isjobpresetattached, s.Quickset, s.IsCustomInterval, s.TimeInterval, s.ServerTypeAndJPDefaultKeyInfo,
                    s.Quickset_Supported, s.Quickset_Enabled, s.IsWidthBased);
}

// Everything but the root's attributes, as it is; a save would indent it.
wxString Sections(const Values& values)
{
    auto* root = new wxXmlNode(wxXML_ELEMENT_NODE, "Sections");
    wxXmlDocument document;
    document.SetRoot(root); // the document's from here on
    WriteInputFormats(root, values.settings.InputFormatsSummary);
    WritePaths(root, values.paths);
    WriteJobSettings(root, values.jobSettings);
    WriteImposeSettings(root, values.imposeSettings);
    WritePreflightSettings(root, values.preflightSettings);
    auto* filterSetting = new wxXmlNode(root, wxXML_ELEMENT_NODE, "");
    CopyTree(values.filterSetting, *filterSetting);
    wxStringOutputStream text;
    document.Save(text, wxXML_NO_INDENTATION);
    return text.GetString();
}

bool AreEqual(const Values& left, const Values& right)
{
    return RootFields(left.settings) == RootFields(right.settings) && Sections(left) == Sections(right);
}

// False when the file does not load.
bool Read(const wxString& path, Values& values)
{
    wxXmlDocument document;
    const bool isLoaded = LoadFolderCfg(path, document);
    ReadPaths(document.GetRoot(), values.paths);
    ReadJobSettings(document.GetRoot(), values.jobSettings);
    ReadImposeSettings(document.GetRoot(), values.imposeSettings);
    ReadPreflightSettings(document.GetRoot(), values.preflightSettings);
    bool isFilterLoaded = false;
    bool areSettingsLoaded = false;
    ReadFilterSetting(path, values.filterSetting, &isFilterLoaded);
    LoadHotFolderSettings(path, values.settings, &areSettingsLoaded);
    Check(isFilterLoaded == isLoaded && areSettingsLoaded == isLoaded, "the readers agree");
    return isLoaded;
}

void Save(const wxString& path, const Values& values)
{
    SaveHotFolderSettings(path, values.settings, values.jobSettings, values.paths, values.filterSetting, values.imposeSettings,
                          values.preflightSettings);
}

} // namespace

void Try(const std::string& input)
{
    static const std::string path = NewFile();
    Values before;
    before.settings.name = "Flyers";
    before.settings.InputFormatsSummary = {{"Portable Document Format", "PDF"}};
    before.paths.Failfolder = "/Fail";
    before.jobSettings["ORXCopies"].Value = "1";
    before.imposeSettings["ORXImposeBleed"].Value = "3";
    before.preflightSettings = {{"Enabled", "1"}};
    before.filterSetting = wxXmlNode(wxXML_ELEMENT_NODE, "FilterSetting");
    Values values = before;
    WriteBytes(path, input);
    if (!Read(path, values))
        return Check(AreEqual(values, before), "what does not load changes no value");
    if (CountLevels(values.filterSetting) > MaxFilterLevels || !IsReadFaithfully(path))
        return;

    Save(path, values);
    const std::string saved = ReadBytes(path);
    Values again;
    Check(Read(path, again), "what was saved loads");
    Check(AreEqual(again, values), "what was saved is read as it was");
    Save(path, again);
    Check(ReadBytes(path) == saved, "a second save gives the same bytes");
}
