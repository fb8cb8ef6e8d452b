// What a rewrite of Folder.cfg would not carry over.
#pragma once

#include "store/root_attributes.h"

#include <wx/arrstr.h>
#include <wx/xml/xml.h>

#include <string>

/// A sentence for each thing of the document that its rewrite with the same template path (these
/// bytes) has lost or changed, but for comments, white space and order. The document has to be
/// loaded with wxXMLDOC_KEEP_WHITESPACE_NODES.
wxArrayString FindFolderCfgLosses(const wxXmlDocument& document, const std::string& rewritten);

/// The attribute without which the chain of root attributes ends before Enable, although Enable is
/// set; none otherwise.
const RootAttribute* FindGapBeforeEnable(const wxXmlNode& root);
