// What becomes of one Folder.cfg. Nothing is changed or logged here.
#pragma once

#include "migrate/template_folders.h"
#include "store/xml_file.h"

struct TemplateMove
{
    enum class Outcome
    {
        NoSection,   // no imposition settings
        NoTemplate,  // none of them is the template's path
        FromUnknown, // no registry value for the template folder of the version being left
        Elsewhere,   // the template is not directly in that folder
        ToUnknown,   // no registry value for the template folder of the version being installed
        Stays,       // for reasonToStay
        Moves
    };

    Outcome outcome = Outcome::NoSection;
    wxString storedPath;
    wxString newPath; // when it moves or stays
    const wchar_t* reasonToStay = nullptr;
    std::string newContent; // of Folder.cfg, when the template moves
};

/// Decides about the path that a loaded Folder.cfg stores. Asks for each folder only if the
/// decision still depends on it.
TemplateMove DecideTemplateMove(const XmlFile& cfg, TemplateFolders& folders);

/// Whether the stored path names something directly in the folder. Only names are compared, as
/// wxFileName::SameAs does on Windows, and no server is asked. Elsewhere are: a path on a server,
/// unless both are on the same share; one on another drive; one over a shortcut (.lnk); one that is
/// too long. A folder with a final separator is not the same as one without.
bool IsDirectlyIn(const wxString& stored, const wxString& folder);

/// Whether a path is longer than any that Windows has, or holds more variables than the library
/// can expand in a reasonable time.
bool IsTooLongPath(const wxString& path);
