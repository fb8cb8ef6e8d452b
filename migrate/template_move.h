// The decision about the template path that one Folder.cfg stores. Nothing is changed or logged
// here.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>

/// What happens to a stored template path.
struct TemplateMove
{
    enum class Outcome
    {
        NoFromFolder,    // no registry value for the template folder of the version being left
        Elsewhere,       // the template is not directly in that folder
        UnknownEncoding, // the document cannot be read faithfully, so it cannot be rewritten
        NoToFolder,      // no registry value for the template folder of the version being installed
        NotStorable,     // the new path holds a character that XML cannot store
        Moves
    };

    Outcome outcome;
    wxString newPath; // when it moves
};

/// Decides about the path that this Folder.cfg (given as bytes) stores. Makes each registry lookup
/// only if the decision still depends on it.
TemplateMove DecideTemplateMove(const wxString& storedPath, const std::string& folderCfg,
                                bool isUpgrade);

/// Whether both names lead to the same folder. Like wxFileName::SameAs, but a stored name never
/// causes access to a server: a name on a server counts as another folder unless both are on the
/// same share, and so do a name on another drive and a name that leads over a shortcut (.lnk). A
/// name with a final separator is not the same as one without.
bool IsSameFolder(const wxString& stored, const wxString& folder);

/// The content of Folder.cfg with the root's settings and this imposition table, or why the file
/// has to stay as it is. The document has to be loaded with wxXMLDOC_KEEP_WHITESPACE_NODES.
struct RewrittenFolderCfg
{
    const wchar_t* reasonToStay = nullptr;
    std::string bytes;
};
RewrittenFolderCfg RewriteFolderCfg(const wxXmlNode& root,
                                    const ImposeSettingTable& imposeSettings);
