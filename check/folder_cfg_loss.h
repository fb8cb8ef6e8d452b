// What a rewrite of Folder.cfg would not carry over.
#pragma once

#include "store/root_attributes.h"

#include <string>

/// One phrase for each part of the document that the rewritten bytes lose or change. Both have the
/// same template path. Comments, white space and order are ignored. The document has to be loaded
/// with wxXMLDOC_KEEP_WHITESPACE_NODES.
std::vector<wxString> FindFolderCfgLosses(const wxXmlDocument& document,
                                          const std::string& rewritten);

/// The missing attribute that ends the chain of root attributes, if values are lost by it.
struct AttributeGap
{
    wxString missing;
    wxString reset;          // the names of those values
    bool isDisabled = false; // whether the folder was enabled, and comes out disabled
};

AttributeGap FindAttributeGap(const wxXmlNode& root);
