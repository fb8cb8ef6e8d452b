// The floor: a run's essential work, done with the library's calls and nothing else.
//
//     floor FOLDERS ICON        loads each Folder.cfg three times, saves it to memory once, writes
//                               it once and waits for the disk, and copies the icon over the
//                               folder's own; FOLDERS is a file with one hot folder on each line
//     floor PRESET FROM TO      reads a preset file, replaces once, and writes it
#include <wx/convauto.h>
#include <wx/ffile.h>
#include <wx/file.h>
#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/init.h>
#include <wx/mstream.h>
#include <wx/textfile.h>
#include <wx/xml/xml.h>

namespace
{

// One for the icon, one for the template path, one before the file is rewritten.
constexpr int LoadsPerFolder = 3;

constexpr int IndentationStep = 2;

// The library must have written the file before, so that the number of bytes stays the same.
bool Rewrite(const wxString& path, const wxXmlDocument& document)
{
    wxMemoryOutputStream text;
    if (!document.Save(text, IndentationStep))
        return false;
    const auto size = static_cast<size_t>(text.GetLength());
    wxFile file(path, wxFile::read_write);
    return file.IsOpened() && file.Length() == text.GetLength() &&
           file.Write(text.GetOutputStreamBuffer()->GetBufferStart(), size) == size &&
           file.Flush() && file.Close();
}

bool Refresh(const wxString& folder, const wxString& icon)
{
    const wxString privateDir = folder + "/[_ORX_HotFolder_]/";
    const wxString cfgPath = privateDir + "Folder.cfg";
    wxXmlDocument document;
    for (int i = 0; i < LoadsPerFolder; ++i)
    {
        if (!document.Load(cfgPath, "UTF-8"))
            return false;
    }
    return Rewrite(cfgPath, document) &&
           wxCopyFile(icon, privateDir + wxFileName(icon).GetFullName(), true);
}

bool RefreshAll(const wxString& list, const wxString& icon)
{
    wxTextFile folders;
    bool isDone = folders.Open(list);
    for (size_t i = 0; isDone && i < folders.GetLineCount(); ++i)
        isDone = Refresh(folders[i], icon);
    return isDone;
}

bool MigratePreset(const wxString& path, const wxString& from, const wxString& to)
{
    wxFFile file(path, "r");
    wxString text;
    if (!file.IsOpened() || !file.ReadAll(&text, wxConvAuto()))
        return false;
    text.Replace(from, to);
    file.Close();
    return file.Open(path, "w") && file.Write(text, wxConvAuto()) && file.Close();
}

} // namespace

int main(int argc, char** argv)
{
    const wxInitializer library(argc, argv);
    const auto argument = [argv](int i)
    {
        return wxString::FromUTF8(argv[i]);
    };
    const bool isDone = argc == 3   ? RefreshAll(argument(1), argument(2))
                        : argc == 4 ? MigratePreset(argument(1), argument(2), argument(3))
                                    : false;
    return isDone ? 0 : 1;
}
