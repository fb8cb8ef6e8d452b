#include "check/folder_cfg_loss.h"

#include "store/folder_cfg_format.h"
#include "store/xml_document.h"

#include <wx/hashmap.h>

#include <algorithm>
#include <initializer_list>
#include <unordered_set>
#include <vector>

namespace
{

using Texts = std::initializer_list<const wchar_t*>;

bool IsOneOf(const Texts& texts, const wxString& text)
{
    return std::any_of(texts.begin(), texts.end(),
                       [&](const wchar_t* each) { return text == each; });
}

bool IsSection(const wxString& name)
{
    return IsOneOf({FolderCfg::InputFormatsSection, FolderCfg::PathsSection,
                    FolderCfg::JobSettingSection, FolderCfg::ImposeSettingSection,
                    FolderCfg::FilterSettingSection, FolderCfg::PreflightSection},
                   name);
}

// The writer adds these attributes where they are missing.
bool IsAdded(const wxString& name)
{
    return IsOneOf({FolderCfg::Path, FolderCfg::ShortName, FolderCfg::DisplayName, FolderCfg::Key,
                    FolderCfg::Value, FolderCfg::KeyDisplayValue, FolderCfg::LocDisplayValue},
                   name);
}

wxString WithoutWhiteSpace(const wxString& text)
{
    wxString result;
    for (const wxUniChar character : text)
    {
        if (!wxIsspace(character))
            result += character;
    }
    return result;
}

// A node below the root, with a text that identifies it: its name and attributes or its text, and
// the names of the nodes above it up to its section. A section counts as directly below the root
// wherever it is, as it does for the readers.
struct Thing
{
    const wxXmlNode* node;
    wxString identity;
};

bool IsElement(const wxXmlNode& node)
{
    return node.GetType() == wxXML_ELEMENT_NODE;
}

// The same in any order.
wxString AttributesIdentity(const wxXmlNode& element, bool isInFilter)
{
    AttributeMap attributes;
    CollectAttributes(element, attributes);
    const wxXmlAttribute* first = element.GetAttributes();
    if (element.GetParent()->GetName() == FolderCfg::ImposeSettingSection && first &&
        first->GetNext() && first->GetValue() == FolderCfg::ImposeTemplateKey)
        attributes[first->GetNext()->GetName()].clear(); // the path that is meant to change
    wxString identity;
    for (const auto& [name, value] : attributes)
    {
        if (isInFilter || !value.empty() || !IsAdded(name))
            identity += "\n" + name + "=" + value;
    }
    return identity;
}

// Comments and white space are left out.
std::vector<Thing> Collect(const wxXmlNode& root)
{
    struct Open
    {
        const wxXmlNode* next;
        wxString place;
        bool isInFilter;
    };
    std::vector<Thing> things;
    std::vector<Open> open = {{root.GetChildren(), wxString(), false}};
    while (!open.empty())
    {
        const wxXmlNode* node = open.back().next;
        if (!node)
        {
            open.pop_back();
            continue;
        }
        open.back().next = node->GetNext();
        const auto [next, place, isInFilter] = open.back();
        if (IsElement(*node))
        {
            const bool isSection = !isInFilter && IsSection(node->GetName());
            const wxString own = (isSection ? wxString() : place) + "/" + node->GetName();
            things.push_back({node, own + AttributesIdentity(*node, isInFilter)});
            open.push_back(
                {node->GetChildren(), own,
                 isInFilter || (isSection && node->GetName() == FolderCfg::FilterSettingSection)});
            continue;
        }
        const wxString text = WithoutWhiteSpace(node->GetContent());
        if (node->GetType() == wxXML_PI_NODE ||
            (node->GetType() != wxXML_COMMENT_NODE && !text.empty()))
            things.push_back({node, place + wxString::Format("\r%d\r", node->GetType()) + text});
    }
    return things;
}

// As much of a text as is readable in one line.
wxString Shown(const wxString& text)
{
    constexpr size_t Longest = 200;
    return text.length() <= Longest ? text : text.Left(Longest) + "...";
}

wxString Describe(const wxXmlNode& node)
{
    if (node.GetType() == wxXML_PI_NODE)
        return "the instruction <?" + node.GetName() + "?>";
    const wxString place = " in <" + node.GetParent()->GetName() + ">";
    if (!IsElement(node))
        return "the text \"" + Shown(wxString(node.GetContent()).Trim().Trim(false)) + "\"" + place;
    wxString tag = "<" + node.GetName();
    for (const wxXmlAttribute* each = node.GetAttributes(); each; each = each->GetNext())
        tag += " " + each->GetName() + "=\"" + each->GetValue() + "\"";
    return Shown(tag) + ">" + place;
}

void FindLostThings(const wxXmlNode& before, const wxXmlNode& after, wxArrayString& losses)
{
    // Each node of the new document can match one of the old.
    std::unordered_multiset<wxString, wxStringHash> pool;
    for (const Thing& thing : Collect(after))
        pool.insert(thing.identity);
    for (const Thing& thing : Collect(before))
    {
        const auto found = pool.find(thing.identity);
        if (found != pool.end())
            pool.erase(found);
        else
            losses.Add("loses " + Describe(*thing.node));
    }
}

void FindLostAttributes(const wxXmlNode& root, wxArrayString& losses)
{
    const AttributeGap gap = FindAttributeGap(root);
    if (!gap.reset.empty())
        losses.Add("lacks \"" + gap.missing + "\", so the rewrite resets: " + gap.reset +
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
            losses.Add(wxString(each.name) + "=\"" + Shown(found->second) + "\" comes out as \"" +
                       now + "\"");
        attributes.erase(found);
    }
    for (const auto& [name, value] : attributes)
        losses.Add("loses the attribute " + name + "=\"" + Shown(value) + "\"");
}

} // namespace

wxArrayString FindFolderCfgLosses(const wxXmlDocument& document, const std::string& rewritten)
{
    wxArrayString losses;
    if (!document.GetDoctype().GetRootName().empty())
        losses.Add("loses its document type, and with it the entities in its texts");
    for (const wxXmlNode* node = document.GetDocumentNode()->GetChildren(); node;
         node = node->GetNext())
    {
        if (node->GetType() == wxXML_PI_NODE)
            losses.Add("loses " + Describe(*node));
    }
    const wxXmlNode& root = *document.GetRoot();
    if (root.GetName() != FolderCfg::Root)
        losses.Add("its root <" + root.GetName() + "> comes out as <" + FolderCfg::Root + ">");
    FindLostAttributes(root, losses);
    wxXmlDocument after;
    if (LoadXml(rewritten, after).state == XmlLoad::State::Loaded)
        FindLostThings(root, *after.GetRoot(), losses);
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
