#include "check/folder_cfg_loss.h"

#include "store/folder_cfg_format.h"
#include "store/xml_document.h"

#include <wx/hashmap.h>

#include <algorithm>
#include <functional>
#include <unordered_map>
#include <vector>

namespace
{

size_t Mix(size_t left, size_t right)
{
    constexpr size_t Odd = 0x9E3779B9; // spreads the bits
    return (left ^ (right + Odd + (left << 6) + (left >> 2))) * Odd;
}

size_t Hash(const wxString& text)
{
    return wxStringHash()(text);
}

bool IsSection(const wxString& name)
{
    const auto sections = {FolderCfg::InputFormatsSection,  FolderCfg::PathsSection,
                           FolderCfg::JobSettingSection,    FolderCfg::ImposeSettingSection,
                           FolderCfg::FilterSettingSection, FolderCfg::PreflightSection};
    return std::any_of(sections.begin(), sections.end(),
                       [&](const wchar_t* section) { return name == section; });
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

// A node below the root, with a hash of everything that identifies it: its name and attributes or
// its text, and the names of the nodes above it up to its section. A section counts as directly
// below the root wherever it is, as it does for the readers.
struct Thing
{
    const wxXmlNode* node;
    size_t fingerprint;
};

bool IsElement(const wxXmlNode& node)
{
    return node.GetType() == wxXML_ELEMENT_NODE;
}

// The same in any order. Outside the filter setting the writer adds empty attributes.
size_t AttributesFingerprint(const wxXmlNode& element, bool withEmpty)
{
    size_t sum = 0;
    for (const wxXmlAttribute* each = element.GetAttributes(); each; each = each->GetNext())
    {
        if (withEmpty || !each->GetValue().empty())
            sum += Mix(Hash(each->GetName()), Hash(each->GetValue()));
    }
    return sum;
}

// Comments and white space are left out.
std::vector<Thing> Collect(const wxXmlNode& root)
{
    struct Open
    {
        const wxXmlNode* next;
        size_t place;
        bool isInFilter;
    };
    std::vector<Thing> things;
    std::vector<Open> open = {{root.GetChildren(), 0, false}};
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
            const size_t own = Mix(isSection ? 0 : place, Hash(node->GetName()));
            things.push_back({node, Mix(own, AttributesFingerprint(*node, isInFilter))});
            open.push_back(
                {node->GetChildren(), own,
                 isInFilter || (isSection && node->GetName() == FolderCfg::FilterSettingSection)});
            continue;
        }
        const wxString text = WithoutWhiteSpace(node->GetContent());
        if (node->GetType() == wxXML_PI_NODE ||
            (node->GetType() != wxXML_COMMENT_NODE && !text.empty()))
            things.push_back(
                {node, Mix(Mix(place, static_cast<size_t>(node->GetType())), Hash(text))});
    }
    return things;
}

bool HasAll(const wxXmlNode& element, const wxXmlNode& wanted)
{
    for (const wxXmlAttribute* each = wanted.GetAttributes(); each; each = each->GetNext())
    {
        if (!element.HasAttribute(each->GetName()))
            return false;
    }
    return true;
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
    std::unordered_multimap<size_t, const wxXmlNode*> pool;
    for (const Thing& thing : Collect(after))
        pool.emplace(thing.fingerprint, thing.node);
    for (const Thing& thing : Collect(before))
    {
        const auto found = pool.find(thing.fingerprint);
        if (found != pool.end() && HasAll(*found->second, *thing.node))
            pool.erase(found);
        else
            losses.Add("loses " + Describe(*thing.node));
    }
}

void FindLostAttributes(const wxXmlNode& root, wxArrayString& losses)
{
    AttributeMap attributes;
    CollectAttributes(root, attributes);
    HotFolderSettings settings;
    const RootAttribute* gap = ReadRootAttributes(attributes, settings);
    if (gap)
        losses.Add(wxString("lacks the attribute \"") + gap->name +
                   "\"; the rewrite sets it and all that follow it to their defaults" +
                   (FindGapBeforeEnable(root) ? " (the folder comes out disabled)" : ""));
    for (const RootAttribute& each : RootAttributes())
    {
        const auto found = attributes.find(each.name);
        if (found == attributes.end())
            continue;
        const bool isRead = !gap || each.chainPlace < gap->chainPlace;
        const wxString now = each.Format(settings);
        if (isRead && each.form != AttributeForm::Text &&
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
    if (LoadXml(rewritten, after, wxXMLDOC_KEEP_WHITESPACE_NODES) == XmlLoad::Loaded)
        FindLostThings(root, *after.GetRoot(), losses);
    return losses;
}

const RootAttribute* FindGapBeforeEnable(const wxXmlNode& root)
{
    AttributeMap attributes;
    CollectAttributes(root, attributes);
    HotFolderSettings settings;
    const RootAttribute* gap = ReadRootAttributes(attributes, settings);
    if (!gap || gap->chainPlace > EnablePlace)
        return nullptr;
    for (const RootAttribute& each : RootAttributes())
    {
        const auto found = attributes.find(each.name);
        if (each.chainPlace == EnablePlace && found != attributes.end())
            each.Read(found->second, settings);
    }
    return settings.Enable ? gap : nullptr;
}
