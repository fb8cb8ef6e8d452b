#include "store/xml_lookup.h"

const wxXmlNode* FirstNamed(const wxXmlNode* node, const wxString& name)
{
    while (node && (node->GetType() != wxXML_ELEMENT_NODE || node->GetName() != name))
        node = node->GetNext();
    return node;
}

const wxXmlNode* FindElement(const wxXmlNode* node, const wxString& name, bool recursive)
{
    if (!node)
        return nullptr;
    const wxXmlNode* found = FirstNamed(node->GetChildren(), name);
    for (const wxXmlNode* child = node->GetChildren(); child && recursive && !found;
         child = child->GetNext())
        found = FindElement(child, name, recursive);
    return found;
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
