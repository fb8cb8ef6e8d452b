#include "store/folder_cfg_reader.h"

#include "store/folder_cfg_format.h"
#include "store/root_attributes.h"
#include "store/xml_lookup.h"
#include "store/xml_tree.h"

#include <array>

namespace
{

const wxXmlNode* FindSection(const wxXmlNode* root, const wchar_t* name)
{
    return root ? FindElement(root, name, true) : nullptr;
}

// The values of a node's first four attributes, which the node still owns, and the number of them.
struct Positional
{
    explicit Positional(const wxXmlNode& node)
    {
        for (const wxXmlAttribute* attribute = node.GetAttributes();
             attribute && count < values.size(); attribute = attribute->GetNext())
            values[count++] = &attribute->GetValue();
    }

    // Copies the value at that position, if there is one.
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

} // namespace

int LoadHotFolderSettings(HotFolder& folder, HotFolderSettings& settings)
{
    const XmlFile::State state = folder.LoadCfg();
    folder.cfg.file.Close();
    return state == XmlFile::State::Missing ? 0
                                            : ReadHotFolderSettings(folder.cfg.Root(), settings);
}

int ReadHotFolderSettings(const wxXmlNode* root, HotFolderSettings& settings)
{
    if (!root)
        return -1;
    AttributeMap attributes;
    CollectAttributes(*root, attributes);
    const size_t read = ReadRootAttributes(attributes, settings);
    std::vector<InputFormat> formats;
    ReadInputFormats(root, formats);
    settings.InputFormatsSummary.swap(formats);
    return read < RequiredAttributes ? -1 : 1;
}

void ReadFilterSetting(const wxXmlNode* root, wxXmlNode& node)
{
    const wxXmlNode* section = FindSection(root, FolderCfg::FilterSettingSection);
    if (!section)
        return;
    node = wxXmlNode();
    CopyTree(*section, node);
    RemoveIgnoredWhiteSpace(node);
    RemoveSavedIndentation(node, FolderCfg::FilterSettingLevel);
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
        // Without a short name, the display name is not read.
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
