// Lookups on the tree of a loaded XML document. Names have to match exactly.
#pragma once

#include <wx/xml/xml.h>

#include <map>

/// One element's attributes by name, in code unit order; a copy.
using AttributeMap = std::map<wxString, wxString>;

/// The first element of that name below the node, or null: among its direct children, and then,
/// with recursive set, in one subtree after another. The node itself never matches, and null has no
/// elements.
const wxXmlNode* FindElement(const wxXmlNode* node, const wxString& name, bool recursive);

/// The first element of that name among the node and the siblings after it, or null.
const wxXmlNode* FirstNamed(const wxXmlNode* node, const wxString& name);

/// Adds every attribute of the element to the map; if a name is repeated, the first value stays.
void CollectAttributes(const wxXmlNode& element, AttributeMap& attributes);

/// If the name is in the map, sets the value and returns true; otherwise the value stays as it was.
bool GetAttribute(const AttributeMap& attributes, const wxString& name, wxString& value);
