// What the library would report in a message box.
#pragma once

#include <wx/string.h>

/// From now on the library's errors are collected and not shown.
void KeepLibraryErrors();

/// The errors since the last call, one after another; empty if there was none.
wxString TakeLibraryErrors();
