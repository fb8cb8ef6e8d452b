// Whole trees of XML nodes, at any width: the library's own copy takes time proportional to the
// square of the number of children.
#pragma once

#include <wx/xml/xml.h>

/// Makes the target, which has no children yet, a deep copy of the source, an element of a document
/// loaded with wxXMLDOC_KEEP_WHITESPACE_NODES, but as its author wrote it. The copy lacks
/// - what loading without that flag removes: texts that are only white space, and the empty lines
///   before any other text. The library judges each piece of a text that the parser delivers, and
///   loses spaces that are a piece of their own (before an escaped character, at a border of its
///   read buffer). Here they stay.
/// - at the end of a text before another kind of node, what wxXmlDocument::Save inserted: a line
///   feed and two spaces for each level; level is the source's own level in the saved document.
void CopyTree(const wxXmlNode& source, wxXmlNode& target, int level);

/// Moves the source's attributes, content and subtree to the target, which must have neither
/// attributes nor children before.
void MoveTree(wxXmlNode& source, wxXmlNode& target);
