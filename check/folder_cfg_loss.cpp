#include "check/folder_cfg_loss.h"

#include "check/report.h"
#include "store/folder_cfg_format.h"
#include "store/xml_document.h"

#include <wx/hashmap.h>

#include <algorithm>
#include <set>
#include <unordered_set>

namespace
{

// The attributes that the writer adds where they are missing.
const std::set<wxString> AddedAttributes = {
    FolderCfg::Path,  FolderCfg::ShortName,       FolderCfg::DisplayName,    FolderCfg::Key,
    FolderCfg::Value, FolderCfg::KeyDisplayValue, FolderCfg::LocDisplayValue};

const std::set<wxString> Sections = {
    FolderCfg::InputFormatsSection,  FolderCfg::PathsSection,         FolderCfg::JobSettingSection,
    FolderCfg::ImposeSettingSection, FolderCfg::FilterSettingSection, FolderCfg::PreflightSection};

// The path in the template's entry is meant to change.
bool IsTemplatePath(const wxXmlNode& element, const wxXmlAttribute& attribute)
{
    const wxXmlAttribute* first = element.GetAttributes();
    return first->GetNext() == &attribute && first->GetValue() == FolderCfg::ImposeTemplateKey &&
           element.GetParent()->GetName() == FolderCfg::ImposeSettingSection;
}

// The same whatever the order of the attributes.
wxString DescribeElement(const wxXmlNode& element, bool isInFilter)
{
    std::vector<wxString> attributes;
    for (const wxXmlAttribute* each = element.GetAttributes(); each; each = each->GetNext())
    {
        const bool isKept =
            !isInFilter &&
            ((each->GetValue().empty() && AddedAttributes.count(each->GetName()) != 0) ||
             IsTemplatePath(element, *each));
        if (!isKept)
            attributes.push_back(" " + each->GetName() + "=\"" + each->GetValue() + "\"");
    }
    std::sort(attributes.begin(), attributes.end());
    wxString description = "<" + element.GetName();
    for (const wxString& attribute : attributes)
        description += attribute;
    return description + ">";
}

// What is below the root, but for comments and white space. The readers find a section wherever it
// is, and the root may come out under another name.
std::vector<wxString> DescribeContent(const wxXmlNode& root)
{
    std::vector<wxString> content;
    // At each level, the next node and whether it is in the filter setting.
    std::vector<std::pair<const wxXmlNode*, bool>> open = {{root.GetChildren(), false}};
    while (!open.empty())
    {
        const auto [node, isInFilter] = open.back();
        if (!node)
        {
            open.pop_back();
            continue;
        }
        open.back().first = node->GetNext();
        const wxString text = wxString(node->GetContent()).Trim().Trim(false);
        wxString what;
        if (node->GetType() == wxXML_ELEMENT_NODE)
        {
            what = DescribeElement(*node, isInFilter);
            open.push_back({node->GetChildren(),
                            isInFilter || node->GetName() == FolderCfg::FilterSettingSection});
        }
        else if (node->GetType() == wxXML_PI_NODE)
            what = "the instruction <?" + node->GetName() + "?>";
        else if (node->GetType() != wxXML_COMMENT_NODE && !text.empty())
            what = "the text \"" + text + "\"";
        if (what.empty())
            continue;
        const wxXmlNode* parent = node->GetParent();
        content.push_back(parent == &root || Sections.count(node->GetName()) != 0
                              ? what
                              : what + " in <" + parent->GetName() + ">");
    }
    return content;
}

void FindLostContent(const wxXmlNode& before, const wxXmlNode& after, std::vector<wxString>& losses)
{
    const std::vector<wxString> kept = DescribeContent(after);
    std::unordered_multiset<wxString, wxStringHash> pool(kept.begin(), kept.end());
    for (const wxString& each : DescribeContent(before))
    {
        const auto found = pool.find(each);
        if (found != pool.end())
            pool.erase(found);
        else
            losses.push_back("loses " + Shown(each));
    }
}

void FindLostAttributes(const wxXmlNode& root, std::vector<wxString>& losses)
{
    const AttributeGap gap = FindAttributeGap(root);
    if (!gap.reset.empty())
        losses.push_back("lacks \"" + gap.missing + "\", so the rewrite resets: " + gap.reset +
                         (gap.isDisabled ? " (the folder ends up disabled)" : ""));
    AttributeMap attributes;
    CollectAttributes(root, attributes);
    HotFolderSettings settings;
    const size_t read = ReadRootAttributes(attributes, settings);
    for (size_t i = 0; i < RootAttributes().size(); ++i)
    {
        const RootAttribute& each = RootAttributes()[i];
        const auto found = attributes.find(each.name);
        if (found == attributes.end())
            continue;
        const wxString now = each.Format(settings);
        if (i < read && each.form != AttributeForm::Text &&
            wxString(found->second).Trim().Trim(false) != now)
            losses.push_back(wxString(each.name) + "=\"" + Shown(found->second) +
                             "\" comes out as \"" + now + "\"");
        attributes.erase(found);
    }
    for (const auto& [name, value] : attributes)
        losses.push_back("loses the attribute " + name + "=\"" + Shown(value) + "\"");
}

} // namespace

std::vector<wxString> FindFolderCfgLosses(const wxXmlDocument& document,
                                          const std::string& rewritten)
{
    std::vector<wxString> losses;
    if (!document.GetDoctype().GetRootName().empty())
        losses.push_back("loses its document type, and with it the entities in its texts");
    for (const wxXmlNode* node = document.GetDocumentNode()->GetChildren(); node;
         node = node->GetNext())
    {
        if (node->GetType() == wxXML_PI_NODE)
            losses.push_back("loses the instruction <?" + node->GetName() + "?>");
    }
    const wxXmlNode& root = *document.GetRoot();
    if (root.GetName() != FolderCfg::Root)
        losses.push_back("its root <" + root.GetName() + "> comes out as <" + FolderCfg::Root +
                         ">");
    FindLostAttributes(root, losses);
    wxXmlDocument after;
    LoadXml(rewritten, FolderCfgLimits, after);
    if (after.IsOk())
        FindLostContent(root, *after.GetRoot(), losses);
    return losses;
}

AttributeGap FindAttributeGap(const wxXmlNode& root)
{
    AttributeMap attributes;
    CollectAttributes(root, attributes);
    HotFolderSettings settings;
    const size_t read = ReadRootAttributes(attributes, settings);
    AttributeGap gap;
    for (size_t i = read; i < RootAttributes().size(); ++i)
    {
        const RootAttribute& each = RootAttributes()[i];
        const auto found = attributes.find(each.name);
        HotFolderSettings stored;
        if (found != attributes.end())
            each.Read(found->second, stored);
        if (each.Format(stored) == each.Format(settings))
            continue;
        gap.missing = RootAttributes()[read].name;
        gap.reset += (gap.reset.empty() ? wxString() : wxString(", ")) + each.name;
        gap.isDisabled = gap.isDisabled || stored.Enable;
    }
    return gap;
}
