#include "store/folder_cfg_reader.h"

#include "store/folder_cfg_format.h"
#include "store/xml_lookup.h"
#include "store/xml_tree.h"

#include <wx/filename.h>

#include <array>
#include <limits>

namespace
{

const wchar_t* const PrivateDirName = L"[_ORX_HotFolder_]";
const wchar_t* const FolderCfgName = L"Folder.cfg";

// The base-10 number at the front of the text; 0 without one and for one beyond 32 bits, which is
// what a 32-bit long makes of it everywhere.
std::int32_t ReadNumber(const wxString& text)
{
    using Limits = std::numeric_limits<std::int32_t>;
    long number = 0;
    text.ToLong(&number);
    return number < Limits::min() || number > Limits::max() ? 0 : static_cast<std::int32_t>(number);
}

bool ReadNumericFlag(const wxString& text)
{
    return ReadNumber(text) != 0;
}

bool ReadTextFlag(const wxString& text)
{
    return wxString(text).Trim() == L"1";
}

// Looks attributes up one after another until the first that is absent.
class AttributeChain
{
  public:
    explicit AttributeChain(const AttributeMap& attributes) : m_attributes(attributes)
    {
    }

    AttributeChain& Text(const wchar_t* name, wxString& field)
    {
        m_isWhole = m_isWhole && GetAttribute(m_attributes, name, field);
        return *this;
    }

    AttributeChain& Flag(const wchar_t* name, bool& field, bool (*read)(const wxString&))
    {
        wxString value;
        if (Text(name, value).m_isWhole)
            field = read(value);
        return *this;
    }

    bool IsWhole() const
    {
        return m_isWhole;
    }

  private:
    const AttributeMap& m_attributes;
    bool m_isWhole = true;
};

int ReadRootAttributes(const AttributeMap& attributes, HotFolderSettings& settings)
{
    AttributeChain chain(attributes);
    chain.Text(L"name", settings.name)
        .Text(L"description", settings.description)
        .Text(L"server_ip", settings.server_ip)
        .Text(L"server_name", settings.server_name);
    const int result = chain.IsWhole() ? 1 : -1;

    chain.Flag(L"Enable", settings.Enable, ReadTextFlag)
        .Text(L"BaseVirtualPrinter", settings.BaseVirtualPrinter)
        .Text(L"BaseVirtualPrinterName", settings.BaseVirtualPrinterName)
        .Text(L"BaseVirtualPrinterDisplayName", settings.BaseVirtualPrinterDisplayName)
        .Text(L"HFPresetName", settings.HFPresetName)
        .Flag(L"Centralized", settings.Centralized, ReadTextFlag)
        .Flag(L"Isjobpresetattached", settings.Isjobpresetattached, ReadTextFlag)
        .Flag(L"IsCustomInterval", settings.IsCustomInterval, ReadTextFlag)
        .Text(L"TimeInterval", settings.TimeInterval)
        .Text(L"PPDVersion", settings.PPDVersion)
        .Text(L"ServerTypeAndJPDefaultKeyInfo", settings.ServerTypeAndJPDefaultKeyInfo);
    if (chain.IsWhole())
    {
        wxString version;
        const bool found = GetAttribute(attributes, L"server_version", version);
        settings.server_version = found ? ReadNumber(version) : -1;
    }
    chain.Text(L"server_textversion", settings.server_textversion)
        .Text(L"server_type", settings.server_type)
        .Text(L"Quickset", settings.Quickset)
        .Flag(L"Quickset_Supported", settings.Quickset_Supported, ReadNumericFlag)
        .Flag(L"Quickset_Enabled", settings.Quickset_Enabled, ReadNumericFlag)
        .Flag(L"IsWidthBased", settings.IsWidthBased, ReadNumericFlag);
    return result;
}

const wxXmlNode* FindSection(const wxXmlNode* root, const wchar_t* name)
{
    return root ? FindElement(root, name, true) : nullptr;
}

// The values of a node's first four attributes, which stay the node's, and how many of them it has.
struct Positional
{
    explicit Positional(const wxXmlNode& node)
    {
        for (const wxXmlAttribute* attribute = node.GetAttributes();
             attribute && count < values.size(); attribute = attribute->GetNext())
            values[count++] = &attribute->GetValue();
    }

    // Copies the value at that position, where there is one.
    void Get(size_t position, wxString& value) const
    {
        if (position < count)
            value = *values[position];
    }

    std::array<const wxString*, 4> values{};
    size_t count = 0;
};

void FillEntry(const Positional& attributes, JobSettingEntry& entry)
{
    attributes.Get(1, entry.Value);
    attributes.Get(2, entry.KeyDisplayValue);
    attributes.Get(3, entry.LocDisplayValue);
}

void FillEntry(const Positional& attributes, ImposeSettingEntry& entry)
{
    attributes.Get(1, entry.Value);
    attributes.Get(2, entry.KeyDisplayValue);
}

template <typename Table>
void ReadKeyValues(const wxXmlNode* section, Table& table)
{
    if (!section)
        return;
    Table read;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        const Positional attributes(*child);
        if (attributes.count < 2)
            continue;
        const auto [place, isNew] = read.try_emplace(*attributes.values[0]);
        if (isNew)
            FillEntry(attributes, place->second);
    }
    table.swap(read);
}

void ReadPath(const wxXmlNode& section, const wchar_t* name, wxString& path)
{
    const wxXmlNode* element = FirstNamed(section.GetChildren(), name);
    if (element && element->GetAttributes())
        path = element->GetAttributes()->GetValue();
}

void Report(bool* loaded, bool value)
{
    if (loaded)
        *loaded = value;
}

} // namespace

wxString PrivateDirPath(const wxString& hotFolder)
{
    wxFileName directory;
    directory.AssignDir(hotFolder);
    directory.AppendDir(PrivateDirName);
    return directory.GetFullPath();
}

wxString FolderCfgPath(const wxString& hotFolder)
{
    return PrivateDirPath(hotFolder) + FolderCfgName;
}

bool LoadFolderCfg(const wxString& path, wxXmlDocument& document, int flags)
{
    return document.Load(path, L"UTF-8", flags) && document.GetRoot();
}

int LoadHotFolderSettings(const wxString& path, HotFolderSettings& settings, bool* loaded)
{
    Report(loaded, false);
    if (!wxFileExists(path))
        return 0;
    wxXmlDocument document;
    if (!LoadFolderCfg(path, document))
        return -1;
    Report(loaded, true);

    const wxXmlNode* root = document.GetRoot();
    AttributeMap attributes;
    CollectAttributes(*root, attributes);
    const int result = ReadRootAttributes(attributes, settings);
    std::vector<InputFormat> formats;
    ReadInputFormats(root, formats);
    settings.InputFormatsSummary.swap(formats);
    return result;
}

int ReadFilterSetting(const wxString& path, wxXmlNode& node, bool* loaded)
{
    Report(loaded, false);
    wxXmlDocument document;
    if (!wxFileExists(path) || !LoadFolderCfg(path, document, wxXMLDOC_KEEP_WHITESPACE_NODES))
        return 0;
    Report(loaded, true);
    const wxXmlNode* section = FindSection(document.GetRoot(), FolderCfg::FilterSettingSection);
    if (section)
    {
        node = wxXmlNode();
        CopyTree(*section, node);
        RemoveIgnoredBlanks(node);
        RemoveSavedIndentation(node, FolderCfg::FilterSettingLevel);
    }
    return 0;
}

int ReadPaths(const wxXmlNode* root, HotFolderPaths& paths)
{
    const wxXmlNode* section = FindSection(root, FolderCfg::PathsSection);
    if (!section)
        return 1;
    ReadPath(*section, FolderCfg::Workfolder, paths.Workfolder);
    ReadPath(*section, FolderCfg::Failfolder, paths.Failfolder);
    ReadPath(*section, FolderCfg::Movefolder, paths.Movefolder);
    ReadPath(*section, FolderCfg::Hotfolder, paths.Hotfolder);
    return 0;
}

void ReadJobSettings(const wxXmlNode* root, JobSettingTable& table)
{
    ReadKeyValues(FindSection(root, FolderCfg::JobSettingSection), table);
}

void ReadImposeSettings(const wxXmlNode* root, ImposeSettingTable& table)
{
    ReadKeyValues(FindSection(root, FolderCfg::ImposeSettingSection), table);
}

void ReadInputFormats(const wxXmlNode* root, std::vector<InputFormat>& formats)
{
    const wxXmlNode* section = FindSection(root, FolderCfg::InputFormatsSection);
    if (!section)
        return;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        AttributeMap attributes;
        CollectAttributes(*child, attributes);
        if (attributes.empty())
            continue;
        InputFormat format;
        // Without a short name the display name is not read.
        if (GetAttribute(attributes, FolderCfg::ShortName, format.ShortName))
            GetAttribute(attributes, FolderCfg::DisplayName, format.DisplayName);
        formats.push_back(format);
    }
}

void ReadPreflightSettings(const wxXmlNode* root, PreflightSettingList& list)
{
    const wxXmlNode* section = FindSection(root, FolderCfg::PreflightSection);
    if (!section)
        return;
    PreflightSettingList read;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        const Positional attributes(*child);
        if (attributes.count == 0)
            continue;
        PreflightSetting& setting = read.emplace_back();
        attributes.Get(0, setting.Key);
        attributes.Get(1, setting.Value);
    }
    list.swap(read);
}
