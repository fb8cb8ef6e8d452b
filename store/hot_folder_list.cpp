#include "store/hot_folder_list.h"

#include "platform/standard_folders.h"
#include "store/xml_lookup.h"

#include <wx/file.h>
#include <wx/filename.h>
#include <wx/hashmap.h>
#include <wx/xml/xml.h>

#include <unordered_set>

namespace
{

const char* const DataDirName = "hotfolder";
const char* const ListName = "HotFolderList";
const char* const ListExtension = "cfg";
const char* const FolderElement = "HotFolder";
const char* const PathAttribute = "path";

struct FoldedHash
{
    size_t operator()(const wxString& text) const
    {
        return wxStringHash()(text.Lower());
    }
};

struct EqualIgnoringCase
{
    bool operator()(const wxString& left, const wxString& right) const
    {
        return left.CmpNoCase(right) == 0;
    }
};

// A comparison with every path before it would take a time that grows with the square of the list.
using PathSet = std::unordered_set<wxString, FoldedHash, EqualIgnoringCase>;

wxString ReadPath(const wxXmlNode& element)
{
    AttributeMap attributes;
    CollectAttributes(element, attributes);
    wxString path;
    GetAttribute(attributes, PathAttribute, path);
    return path.Trim();
}

wxString GetListPath()
{
    wxFileName file;
    file.AssignDir(GetHotFolderDataDir());
    file.SetName(ListName);
    file.SetExt(ListExtension);
    return file.GetFullPath();
}

} // namespace

wxString GetHotFolderDataDir()
{
    wxFileName directory;
    directory.AssignDir(GetMachineDataFolder());
    directory.AppendDir(DataDirName);
    return directory.GetFullPath();
}

void ReadHotFolderList(wxArrayString& folders)
{
    const wxString listPath = GetListPath();
    wxXmlDocument document;
    if (!wxFile::Exists(listPath) || !document.Load(listPath, "UTF-8") || !document.GetRoot())
        return;

    PathSet known(folders.begin(), folders.end());
    const wxXmlNode* element = FirstNamed(document.GetRoot()->GetChildren(), FolderElement);
    for (; element; element = FirstNamed(element->GetNext(), FolderElement))
    {
        const wxString path = ReadPath(*element);
        if (!path.empty() && wxDirExists(path) && known.insert(path).second)
            folders.Add(path);
    }
}
