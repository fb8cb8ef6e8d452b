#include "store/folder_cfg_writer.h"

#include "store/folder_cfg_format.h"
#include "store/xml_tree.h"

#include <wx/wfstream.h>

#include <memory>

namespace
{

constexpr int IndentationStep = 2;
constexpr size_t WriteBufferBytes = 64 * 1024;

wxString FormatNumericFlag(bool flag)
{
    return wxString::Format("%d", flag ? 1 : 0);
}

wxString FormatTextFlag(bool flag)
{
    return flag ? "1" : "0";
}

void AddRootAttributes(wxXmlNode& root, const HotFolderSettings& settings)
{
    root.AddAttribute("name", settings.name);
    root.AddAttribute("description", settings.description);
    root.AddAttribute("server_ip", settings.server_ip);
    root.AddAttribute("server_name", settings.server_name);
    root.AddAttribute("server_version",
                      wxString::Format("%ld", static_cast<long>(settings.server_version)));
    root.AddAttribute("server_textversion", settings.server_textversion);
    root.AddAttribute("server_type", settings.server_type);
    root.AddAttribute("BaseVirtualPrinter", settings.BaseVirtualPrinter);
    root.AddAttribute("BaseVirtualPrinterName", settings.BaseVirtualPrinterName);
    root.AddAttribute("BaseVirtualPrinterDisplayName", settings.BaseVirtualPrinterDisplayName);
    root.AddAttribute("HFPresetName", settings.HFPresetName);
    root.AddAttribute("PPDVersion", settings.PPDVersion);
    root.AddAttribute("ServerTypeAndJPDefaultKeyInfo", settings.ServerTypeAndJPDefaultKeyInfo);
    root.AddAttribute("Quickset_Supported", FormatNumericFlag(settings.Quickset_Supported));
    root.AddAttribute("Quickset_Enabled", FormatNumericFlag(settings.Quickset_Enabled));
    root.AddAttribute("Quickset", settings.Quickset);
    root.AddAttribute("IsWidthBased", FormatNumericFlag(settings.IsWidthBased));
    root.AddAttribute("Enable", FormatTextFlag(settings.Enable));
    root.AddAttribute("Centralized", FormatTextFlag(settings.Centralized));
    root.AddAttribute("Isjobpresetattached", FormatTextFlag(settings.Isjobpresetattached));
    root.AddAttribute("IsCustomInterval", FormatTextFlag(settings.IsCustomInterval));
    root.AddAttribute("TimeInterval", settings.TimeInterval);
}

// One section under construction. Each child goes behind the one before it, which the section
// remembers: to look for the last child each time would take a time that grows with the square.
class Section
{
  public:
    Section(wxXmlNode& root, const char* name) : m_node(Append(root, name, nullptr))
    {
    }

    wxXmlNode& Add(const char* name)
    {
        m_last = Append(*m_node, name, m_last);
        return *m_last;
    }

  private:
    static wxXmlNode* Append(wxXmlNode& parent, const char* name, wxXmlNode* last)
    {
        auto* node = new wxXmlNode(wxXML_ELEMENT_NODE, name); // the parent's from here on
        if (last || !parent.GetChildren())
            parent.InsertChildAfter(node, last);
        else
            parent.AddChild(node);
        return node;
    }

    wxXmlNode* m_node;
    wxXmlNode* m_last = nullptr;
};

void WriteFilterSetting(wxXmlNode& root, const wxXmlNode& filterSetting)
{
    if (filterSetting.GetName() != FolderCfg::FilterSettingSection)
        return;
    auto* copy = new wxXmlNode(wxXML_ELEMENT_NODE, FolderCfg::FilterSettingSection);
    root.AddChild(copy); // the root's from here on
    CopyTree(filterSetting, *copy);
}

} // namespace

void WriteInputFormats(wxXmlNode* root, const std::vector<InputFormat>& formats)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::InputFormatsSection);
    for (const InputFormat& format : formats)
    {
        wxXmlNode& child = section.Add("InputFormat");
        child.AddAttribute(FolderCfg::ShortName, format.ShortName);
        child.AddAttribute(FolderCfg::DisplayName, format.DisplayName);
    }
}

void WritePaths(wxXmlNode* root, const HotFolderPaths& paths)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::PathsSection);
    section.Add(FolderCfg::Failfolder).AddAttribute("path", paths.Failfolder);
    section.Add(FolderCfg::Workfolder).AddAttribute("path", paths.Workfolder);
    section.Add(FolderCfg::Movefolder).AddAttribute("path", paths.Movefolder);
    section.Add(FolderCfg::Hotfolder).AddAttribute("path", paths.Hotfolder);
}

void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::JobSettingSection);
    for (const auto& [key, entry] : table)
    {
        wxXmlNode& child = section.Add("KEYVALUE");
        child.AddAttribute("Key", key);
        child.AddAttribute("Value", entry.Value);
        child.AddAttribute("KeyDisplayValue", entry.KeyDisplayValue);
        child.AddAttribute("LocDisplayValue", entry.LocDisplayValue);
    }
}

void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::ImposeSettingSection);
    for (const auto& [key, entry] : table)
    {
        wxXmlNode& child = section.Add("KEYVALUE");
        child.AddAttribute("Key", key);
        child.AddAttribute("Value", entry.Value);
        child.AddAttribute("KeyDisplayValue", entry.KeyDisplayValue);
    }
}

void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::PreflightSection);
    for (const PreflightSetting& setting : list)
    {
        wxXmlNode& child = section.Add("Preflight");
        child.AddAttribute("Key", setting.Key);
        child.AddAttribute("Value", setting.Value);
    }
}

int SaveHotFolderSettings(const wxString& path, const HotFolderSettings& settings,
                          const JobSettingTable& jobSettings, const HotFolderPaths& paths,
                          const wxXmlNode& filterSetting, const ImposeSettingTable& imposeSettings,
                          const PreflightSettingList& preflightSettings)
{
    const wxCriticalSectionLocker lock(FolderCfgLock);
    wxXmlDocument document;
    auto* root = new wxXmlNode(wxXML_ELEMENT_NODE, FolderCfg::Root);
    document.SetRoot(root); // the document's from here on
    AddRootAttributes(*root, settings);
    WriteInputFormats(root, settings.InputFormatsSummary);
    WritePaths(root, paths);
    WriteJobSettings(root, jobSettings);
    WriteImposeSettings(root, imposeSettings);
    WriteFilterSetting(*root, filterSetting);
    WritePreflightSettings(root, preflightSettings);

    // Saving by name would give the same bytes in a write call for each token.
    wxFileOutputStream file(path);
    if (!file.IsOk())
        return 0;
    wxBufferedOutputStream buffered(file, WriteBufferBytes);
    document.Save(buffered, IndentationStep);
    buffered.Close();
    file.Close();
    return 0;
}
