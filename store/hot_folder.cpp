#include "store/hot_folder.h"

#include <wx/filename.h>

wxString PrivateDirPath(const wxString& hotFolder)
{
    wxFileName directory;
    directory.AssignDir(hotFolder);
    directory.AppendDir(PrivateDirName);
    return directory.GetFullPath();
}

wxString FolderCfgPath(const wxString& hotFolder)
{
    return PrivateDirPath(hotFolder) + FolderCfgName;
}

HotFolder::HotFolder(const wxString& listedPath)
    : path(listedPath), directory(path, Links::Follow),
      privateDir(directory.Reach(PrivateDirName), Links::Refuse)
{
}

XmlFile::State HotFolder::LoadCfg()
{
    return cfg.Load(cfg.file.OpenForReading(privateDir, FolderCfgName));
}
