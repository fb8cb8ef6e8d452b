#include "store/folder_cfg_writer.h"

#include "store/folder_cfg_format.h"
#include "store/xml_tree.h"

#include <wx/wfstream.h>

#include <string>

namespace
{

constexpr int IndentationStep = 2;
constexpr size_t WriteBufferBytes = size_t{16} * 1024;

const wchar_t* FormatFlag(bool flag)
{
    return flag ? L"1" : L"0";
}

void AddRootAttributes(wxXmlNode& root, const HotFolderSettings& settings)
{
    root.AddAttribute(L"name", settings.name);
    root.AddAttribute(L"description", settings.description);
    root.AddAttribute(L"server_ip", settings.server_ip);
    root.AddAttribute(L"server_name", settings.server_name);
    root.AddAttribute(L"server_version", std::to_wstring(settings.server_version));
    root.AddAttribute(L"server_textversion", settings.server_textversion);
    root.AddAttribute(L"server_type", settings.server_type);
    root.AddAttribute(L"BaseVirtualPrinter", settings.BaseVirtualPrinter);
    root.AddAttribute(L"BaseVirtualPrinterName", settings.BaseVirtualPrinterName);
    root.AddAttribute(L"BaseVirtualPrinterDisplayName", settings.BaseVirtualPrinterDisplayName);
    root.AddAttribute(L"HFPresetName", settings.HFPresetName);
    root.AddAttribute(L"PPDVersion", settings.PPDVersion);
    root.AddAttribute(L"ServerTypeAndJPDefaultKeyInfo", settings.ServerTypeAndJPDefaultKeyInfo);
    root.AddAttribute(L"Quickset_Supported", FormatFlag(settings.Quickset_Supported));
    root.AddAttribute(L"Quickset_Enabled", FormatFlag(settings.Quickset_Enabled));
    root.AddAttribute(L"Quickset", settings.Quickset);
    root.AddAttribute(L"IsWidthBased", FormatFlag(settings.IsWidthBased));
    root.AddAttribute(L"Enable", FormatFlag(settings.Enable));
    root.AddAttribute(L"Centralized", FormatFlag(settings.Centralized));
    root.AddAttribute(L"Isjobpresetattached", FormatFlag(settings.Isjobpresetattached));
    root.AddAttribute(L"IsCustomInterval", FormatFlag(settings.IsCustomInterval));
    root.AddAttribute(L"TimeInterval", settings.TimeInterval);
}

// One section under construction. Each child goes behind the one before it, which the section
// remembers: to look for the last child each time would take a time that grows with the square.
class Section
{
  public:
    Section(wxXmlNode& root, const wxString& name) : m_node(Append(root, name, nullptr))
    {
    }

    wxXmlNode& Add(const wxString& name)
    {
        m_last = Append(*m_node, name, m_last);
        return *m_last;
    }

  private:
    static wxXmlNode* Append(wxXmlNode& parent, const wxString& name, wxXmlNode* last)
    {
        auto* child = new wxXmlNode(wxXML_ELEMENT_NODE, name); // the parent's from here on
        if (last || !parent.GetChildren())
            parent.InsertChildAfter(child, last);
        else
            parent.AddChild(child);
        return child;
    }

    wxXmlNode* m_node;
    wxXmlNode* m_last = nullptr;
};

// Made once a section and not once an entry.
struct KeyValueNames
{
    wxString element = L"KEYVALUE";
    wxString key = L"Key";
    wxString value = L"Value";
    wxString keyDisplayValue = L"KeyDisplayValue";
    wxString locDisplayValue = L"LocDisplayValue";
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
        wxXmlNode& child = section.Add(L"InputFormat");
        child.AddAttribute(FolderCfg::ShortName, format.ShortName);
        child.AddAttribute(FolderCfg::DisplayName, format.DisplayName);
    }
}

void WritePaths(wxXmlNode* root, const HotFolderPaths& paths)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::PathsSection);
    section.Add(FolderCfg::Failfolder).AddAttribute(L"path", paths.Failfolder);
    section.Add(FolderCfg::Workfolder).AddAttribute(L"path", paths.Workfolder);
    section.Add(FolderCfg::Movefolder).AddAttribute(L"path", paths.Movefolder);
    section.Add(FolderCfg::Hotfolder).AddAttribute(L"path", paths.Hotfolder);
}

void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::JobSettingSection);
    const KeyValueNames names;
    for (const auto& [key, entry] : table)
    {
        wxXmlNode& child = section.Add(names.element);
        child.AddAttribute(names.key, key);
        child.AddAttribute(names.value, entry.Value);
        child.AddAttribute(names.keyDisplayValue, entry.KeyDisplayValue);
        child.AddAttribute(names.locDisplayValue, entry.LocDisplayValue);
    }
}

void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::ImposeSettingSection);
    const KeyValueNames names;
    for (const auto& [key, entry] : table)
    {
        wxXmlNode& child = section.Add(names.element);
        child.AddAttribute(names.key, key);
        child.AddAttribute(names.value, entry.Value);
        child.AddAttribute(names.keyDisplayValue, entry.KeyDisplayValue);
    }
}

void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list)
{
    if (!root)
        return;
    Section section(*root, FolderCfg::PreflightSection);
    for (const PreflightSetting& setting : list)
    {
        wxXmlNode& child = section.Add(L"Preflight");
        child.AddAttribute(L"Key", setting.Key);
        child.AddAttribute(L"Value", setting.Value);
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

    // Saving by name would give the same bytes in a write call for each token. Not through a
    // wxFileOutputStream, which the buffer's end would make wait for the disk.
    wxFFileOutputStream file(path, "wb");
    if (!file.IsOk())
        return 0;
    wxBufferedOutputStream buffered(file, WriteBufferBytes);
    document.Save(buffered, IndentationStep);
    buffered.Close();
    // The end of the scope closes the file: the library closes what did not close well once more.
    return 0;
}
