// The machine-wide list of hot folders, HotFolderList.cfg, which the hot folder client keeps.
#pragma once

#include "store/xml_file.h"

#include <wx/arrstr.h>

/// The list's path.
wxString GetHotFolderListPath();

/// Its folder: "hotfolder" in the machine-wide application data folder, with a final separator.
wxString GetHotFolderDataDir();

struct HotFolderList
{
    XmlFile::State state = XmlFile::State::Missing;
    wxString whyNotReadable; // in the library's words
    XmlSyntaxError error;
    /// The folders that exist, in the order and spelling of the file, without trailing white space;
    /// of paths that are equal ignoring case, only the first.
    wxArrayString folders;
    wxArrayString missing;  // no directory of that name
    wxArrayString repeated; // equal to an earlier one, ignoring case
};

HotFolderList LoadHotFolderList();

/// Appends the folders of the list, except those that are already in the array, ignoring case. A
/// list that is missing or cannot be read adds nothing; the library reports why it cannot be read.
void ReadHotFolderList(wxArrayString& folders);
