#include "store/folder_cfg_writer.h"

#include "store/folder_cfg_format.h"
#include "store/root_attributes.h"
#include "store/xml_tree.h"

#include <wx/stream.h>

#include <new>

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
        isFull = isFull || bytes.size() + size > size_t{FolderCfgLimits.bytes};
        if (isFull)
            m_lasterror = wxSTREAM_WRITE_ERROR;
        else
            bytes.append(static_cast<const char*>(data), size);
        return isFull ? 0 : size;
    }
};

template <typename Fields, typename Entry>
void AddAttributes(wxXmlNode& element, const Fields& fields, const Entry& entry)
{
    for (const auto& field : fields)
        element.AddAttribute(field.name, entry.*field.text);
}

template <typename Fields, typename Entry>
void AddAttributes(wxXmlNode& element, const Fields& fields,
                   const std::pair<const wxString, Entry>& entry)
{
    element.AddAttribute(FolderCfg::Key, entry.first);
    AddAttributes(element, fields, entry.second);
}

// Appends a section with an element for each entry, after the last one: finding that each time
// would take time proportional to the square of their number.
template <typename Fields, typename Entries>
void WriteSection(wxXmlNode* root, const wchar_t* name, const wxString& element,
                  const Fields& fields, const Entries& entries)
{
    if (!root)
        return;
    auto* section = new wxXmlNode(wxXML_ELEMENT_NODE, name);
    root->AddChild(section); // from here on owned by the root
    wxXmlNode* last = nullptr;
    for (const auto& entry : entries)
    {
        auto* child = new wxXmlNode(wxXML_ELEMENT_NODE, element);
        section->InsertChildAfter(child, last); // from here on owned by the section
        AddAttributes(*child, fields, entry);
        last = child;
    }
}

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
    WriteSection(root, FolderCfg::InputFormatsSection, L"InputFormat", FolderCfg::InputFormatFields,
                 formats);
}

void WritePaths(wxXmlNode* root, const HotFolderPaths& paths)
{
    if (!root)
        return;
    auto* section = new wxXmlNode(wxXML_ELEMENT_NODE, FolderCfg::PathsSection);
    root->AddChild(section); // as above
    for (const auto& field : FolderCfg::PathFields)
    {
        auto* child = new wxXmlNode(wxXML_ELEMENT_NODE, field.name);
        section->AddChild(child);
        child->AddAttribute(FolderCfg::Path, paths.*field.text);
    }
}

void WriteJobSettings(wxXmlNode* root, const JobSettingTable& table)
{
    WriteSection(root, FolderCfg::JobSettingSection, L"KEYVALUE", FolderCfg::JobSettingFields,
                 table);
}

void WriteImposeSettings(wxXmlNode* root, const ImposeSettingTable& table)
{
    WriteSection(root, FolderCfg::ImposeSettingSection, L"KEYVALUE", FolderCfg::ImposeSettingFields,
                 table);
}

void WritePreflightSettings(wxXmlNode* root, const PreflightSettingList& list)
{
    WriteSection(root, FolderCfg::PreflightSection, L"Preflight", FolderCfg::PreflightFields, list);
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
        throw std::bad_alloc(); // the library could not convert a text
    const bool isReadable = !stream.isFull && IsWithinLimits(stream.bytes, FolderCfgLimits);
    return isReadable ? std::move(stream.bytes) : std::string();
}

XmlFile::Saved SaveHotFolderSettings(HotFolder& folder, const std::string& content)
{
    const wxCriticalSectionLocker lock(FolderCfgLock);
    return folder.cfg.Save(content);
}
