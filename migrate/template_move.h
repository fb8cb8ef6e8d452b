// The decision about the template path that one Folder.cfg stores. Nothing is changed or logged
// here.
#pragma once

#include "store/hot_folder_settings.h"

#include <wx/string.h>
#include <wx/xml/xml.h>

#include <string>

/// What becomes of a stored template path.
struct TemplateMove
{
    enum class Outcome
    {
        NoFromFolder,    // the registry does not name the template folder of the version being left
        Elsewhere,       // the template does not lie directly in that folder
        UnknownEncoding, // the document cannot be read faithfully, so its text cannot be written
                         // again
        NoToFolder, // the registry does not name the template folder of the version being installed
        NotStorable, // the new path holds a character that XML cannot store
        Moves
    };

    Outcome outcome;
    wxString newPath; // when it moves
};

/// Decides for the path that this Folder.cfg (its bytes) stores. Each registry lookup is made only
/// when the ones before it leave the question open.
TemplateMove DecideTemplateMove(const wxString& storedPath, const std::string& folderCfg,
                                bool isUpgrade);

/// Whether both names lead to the same folder. As wxFileName::SameAs, but no stored name makes
/// anybody ask a server: one on a server, or one whose drive differs from the other's, is in
/// another folder without further ado, unless the other folder is on the same share; so is one that
/// leads over a shortcut (.lnk). A name with a final separator is not the same as one without.
bool IsSameFolder(const wxString& stored, const wxString& folder);

/// The Folder.cfg with the root's settings and this imposition table, or why the file has to stay
/// as it is. The document has to be loaded with wxXMLDOC_KEEP_WHITESPACE_NODES.
struct RewrittenFolderCfg
{
    const wchar_t* reasonToStay = nullptr;
    std::string bytes;
};
RewrittenFolderCfg RewriteFolderCfg(const wxXmlNode& root,
                                    const ImposeSettingTable& imposeSettings);
