// The machine-wide list of hot folders, HotFolderList.cfg, which the hot folder client keeps.
#pragma once

#include <wx/arrstr.h>
#include <wx/string.h>

/// The folder of the list: "hotfolder" in the machine-wide application data folder, with a final
/// separator.
wxString GetHotFolderDataDir();

/// Appends the path of every listed folder that exists, in the order of the file and as the file
/// spells it, less white space at its end; of paths that are equal ignoring case, the first. A list
/// that is missing or cannot be read adds nothing. Reports nothing itself; the library logs a file
/// that it cannot open or parse.
void ReadHotFolderList(wxArrayString& folders);
