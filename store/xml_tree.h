// Whole trees of XML nodes, at any width: the library's own copy takes time proportional to the
// square of the number of children.
#pragma once

#include <wx/xml/xml.h>

/// Makes the target a deep copy of the source, with its attributes, content and subtree, but as its
/// author wrote it. The source is an element of a document loaded with
/// wxXMLDOC_KEEP_WHITESPACE_NODES. The target must have no children before; its place in its own
/// tree stays.
///
/// Removed is what loading without that flag removes: texts that are only white space, and the
/// empty lines before any other text. The library does this for each piece of a text that the
/// parser delivers, so it loses spaces that are a piece of their own (before an escaped character,
/// at a border of its read buffer). Here they stay.
///
/// Removed from every text that comes before another kind of node is also what wxXmlDocument::Save
/// inserted between the two: a line feed and two spaces for each level; level is the source's own
/// level in the saved document.
void CopyTree(const wxXmlNode& source, wxXmlNode& target, int level);

/// Moves the source's attributes, content and subtree to the target, which must have neither
/// attributes nor children before.
void MoveTree(wxXmlNode& source, wxXmlNode& target);
