// Arbitrary bytes as a Folder.cfg: what loads is unchanged after saving and loading, and what does
// not load leaves every value as it was.
#include "fuzz/fuzzing.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/root_attributes.h"
#include "store/xml_encoding.h"
#include "store/xml_file.h"
#include "store/xml_tree.h"

#include <wx/sstream.h>

#include <algorithm>

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

// Everything but the root's attributes, without the indentation that saving adds.
wxString Sections(const Values& values)
{
    auto* root = new wxXmlNode(wxXML_ELEMENT_NODE, "Sections");
    wxXmlDocument document;
    document.SetRoot(root); // from here on owned by the document
    WriteInputFormats(root, values.settings.InputFormatsSummary);
    WritePaths(root, values.paths);
    WriteJobSettings(root, values.jobSettings);
    WriteImposeSettings(root, values.imposeSettings);
    WritePreflightSettings(root, values.preflightSettings);
    auto* filterSetting = new wxXmlNode(root, wxXML_ELEMENT_NODE, "");
    CopyTree(values.filterSetting, *filterSetting, FolderCfg::FilterSettingLevel);
    wxStringOutputStream text;
    document.Save(text, wxXML_NO_INDENTATION);
    return text.GetString();
}

bool AreEqual(const Values& left, const Values& right)
{
    const auto& attributes = RootAttributes();
    return std::all_of(attributes.begin(), attributes.end(),
                       [&](const RootAttribute& each)
                       { return each.Format(left.settings) == each.Format(right.settings); }) &&
           Sections(left) == Sections(right);
}

// Returns false if the file does not load.
bool Read(const wxString& path, Values& values)
{
    XmlFile cfg;
    const bool isLoaded = cfg.Load(path, Links::Refuse, path) == XmlFile::State::Loaded;
    ReadPaths(cfg.GetRoot(), values.paths);
    ReadJobSettings(cfg.GetRoot(), values.jobSettings);
    ReadImposeSettings(cfg.GetRoot(), values.imposeSettings);
    ReadPreflightSettings(cfg.GetRoot(), values.preflightSettings);
    ReadFilterSetting(cfg.GetRoot(), values.filterSetting);
    ReadHotFolderSettings(cfg.GetRoot(), values.settings);
    return isLoaded;
}

void Save(const wxString& path, const Values& values)
{
    SaveHotFolderSettings(path, values.settings, values.jobSettings, values.paths,
                          values.filterSetting, values.imposeSettings, values.preflightSettings);
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
    if (CountLevels(values.filterSetting) > MaxFilterLevels || !IsReadFaithfully(input))
        return;

    Save(path, values);
    const std::string saved = ReadBytes(path);
    Values again;
    Check(Read(path, again), "what was saved loads");
    Check(AreEqual(again, values), "what was saved is read as it was");
    Save(path, again);
    Check(ReadBytes(path) == saved, "a second save gives the same bytes");
}
