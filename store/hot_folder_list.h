// The machine-wide list of hot folders, HotFolderList.cfg, which the hot folder client keeps.
#pragma once

#include "store/xml_file.h"

#include <wx/arrstr.h>
#include <wx/string.h>

/// The list's path.
wxString GetHotFolderListPath();

/// The folder of the list: "hotfolder" in the machine-wide application data folder, with a final
/// separator.
wxString GetHotFolderDataDir();

/// What the list says.
struct HotFolderList
{
    XmlFile::State state = XmlFile::State::Missing;
    /// The folders that exist, in the order of the file and as the file spells them, less white
    /// space at their end; of paths that are equal ignoring case, the first.
    wxArrayString folders;
    wxArrayString missing;  // no directory of that name
    wxArrayString repeated; // equal to one before, ignoring case
};

/// A list that cannot be opened or parsed is reported by the library.
HotFolderList LoadHotFolderList();

/// Appends the folders of the list, but for those that are in the array already, ignoring case. A
/// list that is missing or cannot be read adds nothing.
void ReadHotFolderList(wxArrayString& folders);
