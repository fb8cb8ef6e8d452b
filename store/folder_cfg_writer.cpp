#include "store/folder_cfg_writer.h"

#include "store/folder_cfg_format.h"
#include "store/root_attributes.h"
#include "store/xml_tree.h"

#include <wx/stream.h>

#include <new>
#include <utility>

namespace
{

constexpr int IndentationStep = 2;
// The library's memory stream copies all its bytes for every kilobyte that is added. This one
// refuses more than can be read again.
class StringOutputStream : public wxOutputStream
{
  public:
    std::string bytes;
    bool isFull = false;

  protected:
    size_t OnSysWrite(const void* data, size_t size) override
    {
        isFull = bytes.size() + size > FolderCfgLimits.bytes;
        if (isFull)
            m_lasterror = wxSTREAM_WRITE_ERROR;
        else
            bytes.append(static_cast<const char*>(data), size);
        return isFull ? 0 : size;
    }
};

// One section under construction. It remembers its last child: finding it each time would take time
// proportional to the square of the number of children.
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
        auto* child = new wxXmlNode(wxXML_ELEMENT_NODE, name); // from here on owned by the parent
        if (last || !parent.GetChildren())
            parent.InsertChildAfter(child, last);
        else
            parent.AddChild(child);
        return child;
    }

    wxXmlNode* m_node;
    wxXmlNode* m_last = nullptr;
};

// Made once for each section, not for each entry.
struct KeyValueNames
{
    wxString element = L"KEYVALUE";
    wxString key = FolderCfg::Key;
    wxString value = FolderCfg::Value;
    wxString keyDisplayValue = FolderCfg::KeyDisplayValue;
    wxString locDisplayValue = FolderCfg::LocDisplayValue;
};

void WriteFilterSetting(wxXmlNode& root, wxXmlNode& filterSetting)
{
    if (filterSetting.GetName() != FolderCfg::FilterSettingSection)
        return;
    auto* child = new wxXmlNode(wxXML_ELEMENT_NODE, FolderCfg::FilterSettingSection);
    root.AddChild(child); // from here on owned by the root
    MoveTree(filterSetting, *child);
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
    section.Add(FolderCfg::Failfolder).AddAttribute(FolderCfg::Path, paths.Failfolder);
    section.Add(FolderCfg::Workfolder).AddAttribute(FolderCfg::Path, paths.Workfolder);
    section.Add(FolderCfg::Movefolder).AddAttribute(FolderCfg::Path, paths.Movefolder);
    section.Add(FolderCfg::Hotfolder).AddAttribute(FolderCfg::Path, paths.Hotfolder);
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
        child.AddAttribute(FolderCfg::Key, setting.Key);
        child.AddAttribute(FolderCfg::Value, setting.Value);
    }
}

std::string FolderCfgBytes(const HotFolderSettings& settings, const JobSettingTable& jobSettings,
                           const HotFolderPaths& paths, wxXmlNode& filterSetting,
                           const ImposeSettingTable& imposeSettings,
                           const PreflightSettingList& preflightSettings)
{
    wxXmlDocument document;
    auto* root = new wxXmlNode(wxXML_ELEMENT_NODE, FolderCfg::Root);
    document.SetRoot(root); // from here on owned by the document
    for (const RootAttribute* attribute : WrittenRootAttributes())
        root->AddAttribute(attribute->name, attribute->Format(settings));
    WriteInputFormats(root, settings.InputFormatsSummary);
    WritePaths(root, paths);
    WriteJobSettings(root, jobSettings);
    WriteImposeSettings(root, imposeSettings);
    WriteFilterSetting(*root, filterSetting);
    WritePreflightSettings(root, preflightSettings);
    StringOutputStream stream;
    if (!document.Save(stream, IndentationStep) && !stream.isFull)
        throw std::bad_alloc(); // the only other reason
    const bool isReadable =
        !stream.isFull &&
        (IsHarmlessXml(stream.bytes) || LookAtXml(stream.bytes, FolderCfgLimits).isWithinLimits);
    return isReadable ? std::move(stream.bytes) : std::string();
}

XmlFile::Saved SaveHotFolderSettings(HotFolder& folder, const std::string& content)
{
    const wxCriticalSectionLocker lock(FolderCfgLock);
    return folder.cfg.Save(content);
}
