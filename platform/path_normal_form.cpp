#include "platform/path_normal_form.h"

wxString WithoutFinalSeparators(wxString path)
{
    while (!path.empty() && wxFileName::IsPathSeparator(path.Last()))
        path.RemoveLast();
    return path;
}
