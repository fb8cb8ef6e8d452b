// Whole trees of XML nodes, at any depth and width: the library's own copy takes a time that grows
// with the square of the number of children, and a stack that grows with the depth.
#pragma once

#include <wx/xml/xml.h>

/// Makes the target a deep copy of the source, with its attributes, content and subtree. The target
/// has no children before; where it hangs stays as it is.
void CopyTree(const wxXmlNode& source, wxXmlNode& target);

/// Makes the source's attributes, content and subtree those of the target, which has neither
/// before.
void MoveTree(wxXmlNode& source, wxXmlNode& target);

/// The number of levels below the node: 0 for one without children.
int CountLevels(const wxXmlNode& root);

/// Takes out of a document loaded with wxXMLDOC_KEEP_WHITESPACE_NODES what a load without it takes
/// out: texts of nothing but white space, and the empty lines before any other text. The library
/// looks at the pieces in which the parser hands a text over, so that spaces at the beginning of a
/// text get lost before an escaped character or at a border of its read buffer; these stay here.
void RemoveIgnoredWhiteSpace(wxXmlNode& root);

/// Takes from every text that comes before another kind of node what wxXmlDocument::Save put
/// between the two, a line feed and two spaces a level; level is the root's own in the saved
/// document. So text beside elements, comments or CDATA comes out of a file as it went in.
void RemoveSavedIndentation(wxXmlNode& root, int level);
