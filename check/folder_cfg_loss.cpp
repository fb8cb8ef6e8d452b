#include "check/folder_cfg_loss.h"

#include "store/folder_cfg_format.h"
#include "store/root_attributes.h"
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

// A node below the root, with a number for the names of those above it up to its section: a section
// counts as directly below the root wherever it is, as it does for the readers.
struct Thing
{
    const wxXmlNode* node;
    size_t place;
    wxString text; // of what is no element
};

bool IsElement(const Thing& thing)
{
    return thing.node->GetType() == wxXML_ELEMENT_NODE;
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
        if (node->GetType() == wxXML_ELEMENT_NODE)
        {
            const bool isSection = !isInFilter && IsSection(node->GetName());
            const size_t own = Mix(isSection ? 0 : place, Hash(node->GetName()));
            things.push_back({node, own, {}});
            open.push_back(
                {node->GetChildren(), own,
                 isInFilter || (isSection && node->GetName() == FolderCfg::FilterSettingSection)});
            continue;
        }
        const wxString text = WithoutWhiteSpace(node->GetContent());
        if (node->GetType() != wxXML_COMMENT_NODE && !text.empty())
            things.push_back({node, Mix(place, static_cast<size_t>(node->GetType())), text});
    }
    return things;
}

size_t Key(size_t place, const wxString& name, const wxString& value)
{
    return Mix(Mix(place, Hash(name)), Hash(value));
}

bool HasAll(const wxXmlNode& element, const wxXmlNode& wanted)
{
    for (const wxXmlAttribute* each = wanted.GetAttributes(); each; each = each->GetNext())
    {
        wxString value;
        if (!element.GetAttribute(each->GetName(), &value) || value != each->GetValue())
            return false;
    }
    return true;
}

// The things of the new document, each of which can stand for one of the old.
class Pool
{
  public:
    explicit Pool(const std::vector<Thing>& things)
    {
        for (const Thing& thing : things)
        {
            m_things.emplace(IsElement(thing) ? thing.place : Mix(thing.place, Hash(thing.text)),
                             thing.node);
            for (const wxXmlAttribute* each = thing.node->GetAttributes(); each;
                 each = each->GetNext())
                m_things.emplace(Key(thing.place, each->GetName(), each->GetValue()), thing.node);
        }
    }

    bool Take(const Thing& thing)
    {
        constexpr int MostTries = 1000; // so that many alike cost a time in proportion
        const wxXmlAttribute* first = thing.node->GetAttributes();
        const size_t key = !IsElement(thing) ? Mix(thing.place, Hash(thing.text))
                           : first           ? Key(thing.place, first->GetName(), first->GetValue())
                                             : thing.place;
        const auto [begin, end] = m_things.equal_range(key);
        int tries = 0;
        for (auto each = begin; each != end && tries < MostTries; ++each, ++tries)
        {
            if (IsElement(thing) && !HasAll(*each->second, *thing.node))
                continue;
            m_things.erase(each);
            return true;
        }
        return false;
    }

  private:
    std::unordered_multimap<size_t, const wxXmlNode*> m_things;
};

wxString Describe(const Thing& thing)
{
    const wxXmlNode& node = *thing.node;
    if (node.GetType() == wxXML_PI_NODE)
        return "the instruction <?" + node.GetName() + "?>";
    if (!IsElement(thing))
        return "the text \"" + thing.text + "\" in <" + node.GetParent()->GetName() + ">";
    wxString tag = "<" + node.GetName();
    for (const wxXmlAttribute* each = node.GetAttributes(); each; each = each->GetNext())
        tag += " " + each->GetName() + "=\"" + each->GetValue() + "\"";
    return tag + "> in <" + node.GetParent()->GetName() + ">";
}

void FindLostThings(const wxXmlNode& before, const wxXmlNode& after, wxArrayString& losses)
{
    const std::vector<Thing> things = Collect(before);
    Pool pool(Collect(after));
    // One without attributes could take the place of any other.
    for (const bool withAttributes : {true, false})
    {
        for (const Thing& thing : things)
        {
            if ((thing.node->GetAttributes() != nullptr) == withAttributes && !pool.Take(thing))
                losses.Add("loses " + Describe(thing));
        }
    }
}

void FindLostAttributes(const wxXmlNode& root, wxArrayString& losses)
{
    AttributeMap attributes;
    CollectAttributes(root, attributes);
    HotFolderSettings settings;
    const RootAttribute* gap = ReadRootAttributes(attributes, settings);
    if (gap)
    {
        const bool wasEnabled =
            !settings.Enable && attributes.count(L"Enable") != 0 && gap->chainPlace <= EnablePlace;
        losses.Add(wxString("lacks the attribute \"") + gap->name +
                   "\"; the rewrite sets it and all that follow it to their defaults" +
                   (wasEnabled ? " (the folder comes out disabled)" : ""));
    }
    for (const RootAttribute& each : RootAttributes())
    {
        const auto found = attributes.find(each.name);
        if (found == attributes.end())
            continue;
        const bool isRead = !gap || each.chainPlace < gap->chainPlace;
        const wxString now = each.Format(settings);
        if (isRead && each.form != AttributeForm::Text &&
            wxString(found->second).Trim().Trim(false) != now)
            losses.Add(wxString(each.name) + "=\"" + found->second + "\" comes out as \"" + now +
                       "\"");
        attributes.erase(found);
    }
    for (const auto& [name, value] : attributes)
        losses.Add("loses the attribute " + name + "=\"" + value + "\"");
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
            losses.Add("loses " + Describe({node, 0, {}}));
    }
    const wxXmlNode& root = *document.GetRoot();
    FindLostAttributes(root, losses);
    wxXmlDocument after;
    if (LoadXml(rewritten, after, wxXMLDOC_KEEP_WHITESPACE_NODES) == XmlLoad::Loaded)
        FindLostThings(root, *after.GetRoot(), losses);
    return losses;
}
