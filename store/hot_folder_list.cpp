#include "store/hot_folder_list.h"

#include "platform/library_log.h"
#include "platform/standard_folders.h"
#include "store/xml_lookup.h"

#include <wx/filename.h>
#include <wx/hashmap.h>

#include <unordered_set>

namespace
{

const char* const DataDirName = "hotfolder";
const char* const ListName = "HotFolderList.cfg";
const char* const FolderElement = "HotFolder";
const char* const PathAttribute = "path";

// Paths in lower case. Comparing each path with every path before it (CmpNoCase) would take time
// proportional to the square of the list's length.
using PathSet = std::unordered_set<wxString, wxStringHash>;

} // namespace

wxString GetHotFolderListPath()
{
    return GetHotFolderDataDir() + ListName;
}

wxString GetHotFolderDataDir()
{
    wxFileName directory;
    directory.AssignDir(GetMachineDataFolder());
    directory.AppendDir(DataDirName);
    return directory.GetFullPath();
}

HotFolderList LoadHotFolderList()
{
    HotFolderList list;
    XmlFile file(ListLimits);
    const wxString path = GetHotFolderListPath();
    list.state = file.Load(file.file.OpenForReading(path));
    list.error = file.error;
    if (list.state == XmlFile::State::NotReadable)
        list.whyNotReadable = file.WhyNotReadable(path);
    if (list.state != XmlFile::State::Loaded)
        return list;
    PathSet known;
    const wxXmlNode* element = FirstNamed(file.Root()->GetChildren(), FolderElement);
    for (; element; element = FirstNamed(element->GetNext(), FolderElement))
    {
        const wxString folder = element->GetAttribute(PathAttribute).Trim();
        if (folder.empty())
            continue;
        if (!wxDirExists(folder))
            list.missing.Add(folder);
        else if (known.insert(folder.Lower()).second)
            list.folders.Add(folder);
        else
            list.repeated.Add(folder);
    }
    return list;
}

void ReadHotFolderList(wxArrayString& folders)
{
    const HotFolderList list = LoadHotFolderList();
    if (!list.whyNotReadable.empty())
        ReportError(list.whyNotReadable);
    PathSet known;
    for (const wxString& folder : folders)
        known.insert(folder.Lower());
    for (const wxString& folder : list.folders)
    {
        if (known.count(folder.Lower()) == 0)
            folders.Add(folder);
    }
}
