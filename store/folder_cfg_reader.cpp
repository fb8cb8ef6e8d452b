#include "store/folder_cfg_reader.h"

#include "store/folder_cfg_format.h"
#include "store/root_attributes.h"
#include "store/xml_lookup.h"
#include "store/xml_tree.h"

namespace
{

// Sets as many fields as there are attributes, from this one on.
template <typename Entry, typename Fields>
void ReadFields(const wxXmlAttribute* attribute, const Fields& fields, Entry& entry)
{
    for (const auto& field : fields)
    {
        if (!attribute)
            return;
        entry.*field.text = attribute->GetValue();
        attribute = attribute->GetNext();
    }
}

template <typename Table, typename Fields>
void ReadKeyValues(const wxXmlNode* section, const Fields& fields, Table& table)
{
    if (!section)
        return;
    Table read;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        const wxXmlAttribute* key = child->GetAttributes();
        if (!key || !key->GetNext())
            continue;
        const auto [place, isNew] = read.try_emplace(key->GetValue());
        if (isNew)
            ReadFields(key->GetNext(), fields, place->second);
    }
    table.swap(read);
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
    const wxXmlNode* section = FindElement(root, FolderCfg::FilterSettingSection, true);
    if (!section)
        return;
    node = wxXmlNode();
    CopyTree(*section, node, 1); // directly below the root, as it is written
}

int ReadPaths(const wxXmlNode* root, HotFolderPaths& paths)
{
    const wxXmlNode* section = FindElement(root, FolderCfg::PathsSection, true);
    if (!section)
        return 1;
    for (const auto& field : FolderCfg::PathFields)
    {
        const wxXmlNode* element = FirstNamed(section->GetChildren(), field.name);
        if (element && element->GetAttributes())
            paths.*field.text = element->GetAttributes()->GetValue();
    }
    return 0;
}

void ReadJobSettings(const wxXmlNode* root, JobSettingTable& table)
{
    ReadKeyValues(FindElement(root, FolderCfg::JobSettingSection, true),
                  FolderCfg::JobSettingFields, table);
}

void ReadImposeSettings(const wxXmlNode* root, ImposeSettingTable& table)
{
    ReadKeyValues(FindElement(root, FolderCfg::ImposeSettingSection, true),
                  FolderCfg::ImposeSettingFields, table);
}

void ReadInputFormats(const wxXmlNode* root, std::vector<InputFormat>& formats)
{
    const wxXmlNode* section = FindElement(root, FolderCfg::InputFormatsSection, true);
    if (!section)
        return;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        AttributeMap attributes;
        CollectAttributes(*child, attributes);
        if (attributes.empty())
            continue;
        InputFormat& format = formats.emplace_back();
        // Without a short name, the display name is not read.
        for (const auto& field : FolderCfg::InputFormatFields)
        {
            if (!GetAttribute(attributes, field.name, format.*field.text))
                break;
        }
    }
}

void ReadPreflightSettings(const wxXmlNode* root, PreflightSettingList& list)
{
    const wxXmlNode* section = FindElement(root, FolderCfg::PreflightSection, true);
    if (!section)
        return;
    PreflightSettingList read;
    for (const wxXmlNode* child = section->GetChildren(); child; child = child->GetNext())
    {
        if (child->GetAttributes())
            ReadFields(child->GetAttributes(), FolderCfg::PreflightFields, read.emplace_back());
    }
    list.swap(read);
}
