// The floor of a whole run: nothing but the library's loads of each Folder.cfg, the one save and
// the copy of the icon.
//
//     floor FOLDERS ICON [SAVE]
//
// FOLDERS is a text file that names a hot folder a line, ICON the icon that goes over each folder's
// own. SAVE is the library's way to the file: "buffered" on its plain file stream, as if nothing is
// given, where the buffer's end waits for the disk; "unsynced", on its stream of the C library,
// which does not and is what the tool does; "named", with its own save by file name.

#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/init.h>
#include <wx/textfile.h>
#include <wx/wfstream.h>
#include <wx/xml/xml.h>

namespace
{

// One for the icon, two for the template path, five for the settings that are written back with it.
constexpr int LoadsPerFolder = 8;

constexpr int IndentationStep = 2;
constexpr size_t WriteBufferBytes = 16 * 1024;

template <typename Stream>
bool SaveBuffered(const wxXmlDocument& document, Stream&& file)
{
    wxBufferedOutputStream buffered(file, WriteBufferBytes);
    return document.Save(buffered, IndentationStep) && buffered.Close() && file.Close();
}

bool Save(const wxXmlDocument& document, const wxString& path, const wxString& way)
{
    if (way == "named")
        return document.Save(path, IndentationStep);
    if (way == "unsynced")
        return SaveBuffered(document, wxFFileOutputStream(path, "wb"));
    return SaveBuffered(document, wxFileOutputStream(path));
}

bool Refresh(const wxString& folder, const wxString& icon, const wxString& iconName,
             const wxString& saveWay)
{
    const wxString privateDir = folder + "/[_ORX_HotFolder_]/";
    const wxString cfgPath = privateDir + "Folder.cfg";
    for (int load = 1; load < LoadsPerFolder; ++load)
    {
        wxXmlDocument document;
        if (!document.Load(cfgPath, "UTF-8"))
            return false;
    }
    wxXmlDocument document;
    if (!document.Load(cfgPath, "UTF-8"))
        return false;
    return Save(document, cfgPath, saveWay) && wxCopyFile(icon, privateDir + iconName, true);
}

} // namespace

int main(int argc, char** argv)
{
    const wxInitializer library(argc, argv);
    if (argc < 3)
        return 2;
    wxTextFile folders;
    if (!folders.Open(wxString::FromUTF8(argv[1])))
        return 1;
    const wxString icon = wxString::FromUTF8(argv[2]);
    const wxString iconName = wxFileName(icon).GetFullName();
    const wxString saveWay = argc > 3 ? argv[3] : "buffered";
    for (size_t i = 0; i < folders.GetLineCount(); ++i)
    {
        if (!Refresh(folders[i], icon, iconName, saveWay))
            return 1;
    }
    return 0;
}
