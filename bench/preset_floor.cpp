// The floor of the preset migration: the library's read, one replacement and the write of one file.
//
//     preset_floor FILE OLD NEW
#include <wx/convauto.h>
#include <wx/ffile.h>
#include <wx/init.h>
#include <wx/string.h>

int main(int argc, char** argv)
{
    const wxInitializer library(argc, argv);
    if (argc != 4)
        return 2;
    wxFFile file(wxString::FromUTF8(argv[1]), "r");
    wxString text;
    if (!file.IsOpened() || !file.ReadAll(&text, wxConvAuto()))
        return 1;
    text.Replace(wxString::FromUTF8(argv[2]), wxString::FromUTF8(argv[3]));
    file.Close();
    return file.Open(wxString::FromUTF8(argv[1]), "w") && file.Write(text, wxConvAuto()) &&
                   file.Close()
               ? 0
               : 1;
}
