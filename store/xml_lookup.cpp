#include "store/xml_lookup.h"

namespace
{

const wxXmlNode* FirstElement(const wxXmlNode* node)
{
    while (node && node->GetType() != wxXML_ELEMENT_NODE)
        node = node->GetNext();
    return node;
}

// The next element in document order below root, or null. A loop and not a recursion, so that no
// document can exhaust the stack.
const wxXmlNode* NextElement(const wxXmlNode* element, const wxXmlNode* root)
{
    if (const wxXmlNode* child = FirstElement(element->GetChildren()))
        return child;
    for (; element != root; element = element->GetParent())
    {
        if (const wxXmlNode* sibling = FirstElement(element->GetNext()))
            return sibling;
    }
    return nullptr;
}

} // namespace

const wxXmlNode* FirstNamed(const wxXmlNode* node, const wxString& name)
{
    while (node && (node->GetType() != wxXML_ELEMENT_NODE || node->GetName() != name))
        node = node->GetNext();
    return node;
}

const wxXmlNode* FindElement(const wxXmlNode* node, const wxString& name, bool recursive)
{
    for (const wxXmlNode* parent = node; parent; parent = NextElement(parent, node))
    {
        if (const wxXmlNode* found = FirstNamed(parent->GetChildren(), name))
            return found;
        if (!recursive)
            break;
    }
    return nullptr;
}

void CollectAttributes(const wxXmlNode& element, AttributeMap& attributes)
{
    for (const wxXmlAttribute* attribute = element.GetAttributes(); attribute;
         attribute = attribute->GetNext())
        attributes.emplace(attribute->GetName(), attribute->GetValue());
}

bool GetAttribute(const AttributeMap& attributes, const wxString& name, wxString& value)
{
    const auto found = attributes.find(name);
    if (found == attributes.end())
        return false;
    value = found->second;
    return true;
}
